// The steps of reading a model; private to the readers of HX_Model.
//
// First step, while HX_DocumentReader reads the text: every value that fits the
// schema goes through the binding of its place into a record. Ids are numbers
// of HX_IdTable, because a document may use an id before the definition.
// Second step, resolve...(): records become items of the model; faults that no
// schema can state are found here.

#ifndef HOST_MODEL_HX_MODELREADING_H
#define HOST_MODEL_HX_MODELREADING_H

#include <cstdint>
#include <deque>
#include <map>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "host/base/HX_Faults.h"
#include "host/base/HX_JsonReader.h"
#include "host/base/HX_NameText.h"
#include "host/base/HX_Text.h"
#include "host/model/HX_IdTable.h"
#include "host/model/HX_Model.h"

struct HX_Document;

/// A value that fits the schema.
struct HX_BoundValue : HX_JsonValue {
  HX_TokenEnd place = 0;

  int integer() const { return static_cast<int>(number); }
  KyCXString nameText() const { return HX_NameText(text); }
};

/// The use of an id.
struct HX_Use {
  int entry = -1;  // of the table; -1 for a missing field
  HX_TokenEnd place = 0;

  bool isGiven() const { return entry >= 0; }
};

/// The items of one kind by id, and the uses that have no item.
struct HX_Ids : HX_IdTable {
  using HX_IdTable::HX_IdTable;

  HX_Use use(const HX_BoundValue& value) {
    return {entry(value.text), value.place};
  }
  /// The index of the item; -1 for a missing field and for an unknown id, which
  /// is then noted.
  int find(const HX_Use& use);
  /// Reports every unknown id once, unless an item lost its id to a fault.
  void report(HX_Faults& faults) const;

  bool isWhole = true;  // no item lost its id

 private:
  struct Unknown {
    HX_TokenEnd first;
    int uses;
  };
  std::map<int, Unknown> m_Unknown;  // by number
};

struct HX_BlockRecord {
  HX_Use id;
  int parent = -1;
  KyCXString name;
  int subsystem = -1;  // index in `subsystems`
  int chart = -1;      // index in `charts`
  bool isNamedThroughParent = false;
};

struct HX_SubsystemRecord {
  KyCXString id;
  unsigned int number = 0;
};

struct HX_ChartObjectRecord {
  HX_Use id;
  int parent = -1;  // index of the object around; -1 in the chart itself
  KyCXString name;
  int number = 0;
};

struct HX_ChartRecord {
  int number = 0;
  std::deque<HX_ChartObjectRecord> objects;  // outer objects first
};

struct HX_ComponentRecord {
  struct Related {
    std::string property;
    std::string path;
  };
  KyCXString name;
  HX_TokenEnd namePlace = 0;
  std::vector<Related> related;
};

/// Blocks, charts and the data dictionary.
struct HX_SourceRecords {
  struct DdRecord {
    HX_Use id;
    std::string path;
    std::string shownPath;  // empty for a path in ASCII
  };

  HX_Ids ids{"a block, a chart object or a dictionary object"};
  std::deque<HX_BlockRecord> blocks;  // outer blocks first
  std::vector<HX_SubsystemRecord> subsystems;
  std::vector<HX_ChartRecord> charts;
  std::vector<DdRecord> ddObjects;
  std::vector<HX_ComponentRecord> components;
  std::map<int, std::string> foreignNames;  // of blocks, by index
  std::map<std::pair<int, int>, std::string> foreignObjects;  // chart, object

  std::vector<int> openBlocks;  // those whose end has not come, as below
  std::vector<int> openObjects;
  std::vector<const HxCSrcRef*> items;  // by index in `ids`
};

struct HX_TypeRecord {
  struct Field {
    std::string name;
    HX_TokenEnd namePlace = 0;
    HX_Use type;
  };
  struct Constant {
    std::string name;
    HX_TokenEnd namePlace = 0;
    int value = 0;
  };
  HX_Use id;
  std::string name;
  HX_TokenEnd namePlace = 0;
  HX_TokenEnd place = 0;
  HX_TypeKind kind = HX_TypeKind::eBase;
  std::optional<HX_CType> cType;
  std::optional<KyCXString> cut;
  HX_Use of;
  int bits = 0;
  int length = 0;
  bool isSigned = true;
  bool isNameless = false;
  bool isFaulty = false;
  std::vector<Field> fields;
  std::vector<Constant> values;
};

struct HX_ScopeRecord {
  HX_Use id;
  int parent = -1;
  HX_ScopeKind kind = HX_ScopeKind::eFile;
  HX_TokenEnd kindPlace = 0;
  HX_Use function;
  bool isFaulty = false;
};

/// What a wanted name needs until ids are resolved.
struct HX_NameRecord {
  HX_Use id;
  HX_Use source;
  HX_Use dd;
  HX_Use type;
  HX_Use scope;
  HX_TokenEnd place = 0;
  HX_TokenEnd initialPlace = 0;  // of the last initial value, 0 for none
  bool isFaulty = false;
};

/// An element of a list of ids in a name.
struct HX_ListedUse {
  std::size_t name;
  HX_Use use;
};

/// Where a variable wishes qualifiers and a place in memory; 0 for nowhere.
struct HX_PlacementPlaces {
  HX_TokenEnd any = 0;  // the last wish
  HX_TokenEnd isStatic = 0;
  HX_TokenEnd section = 0;
  HX_TokenEnd alignment = 0;
};

/// Uses of a name that few names have.
struct HX_RareUses {
  HX_PlacementPlaces placement;
  HX_Use symbolType;
  HX_Use task;
  HX_Use isr;
  // Of the symbol, before it is made.
  KyCXString symbolName;
  int symbolKind = 0;
  std::string symbolX;
};

/// Everything that the two steps share.
struct HX_ModelReading {
  HX_ModelReading(HX_Model& wanted, HX_Faults& list,
                  const std::vector<std::string>& foldersOfWords)
      : model(wanted), faults(list), keywordFolders(foldersOfWords) {}

  HX_Model& model;
  HX_Faults& faults;
  const std::vector<std::string> keywordFolders;

  HX_SourceRecords sources;
  HX_Ids typeIds{"a type"};
  std::deque<HX_TypeRecord> types;
  HX_Ids scopeIds{"a scope"};
  std::deque<HX_ScopeRecord> scopes;  // outer scopes first
  std::vector<int> openScopes;
  HX_Ids nameIds{"a name"};
  std::deque<HX_NameRecord> names;
  std::map<std::size_t, HX_RareUses> rareUses;  // by index of the name
  std::vector<HX_ListedUse> alsoFrom;
  std::vector<HX_ListedUse> dependsOn;
  bool areChainsShort = true;  // those of types, so that following one is cheap

  /// Enters an item; an id that another item has is a fault.
  void define(HX_Ids& ids, const HX_Use& id, std::size_t item);
};

/// Where values of the schema go. A place without a function is not read.
struct HX_FieldBinding {
  const char* path;  // see HX_SchemaField::path
  /// Takes a value, also each value of a list.
  void (*set)(HX_ModelReading&, const HX_BoundValue&) = nullptr;
  /// Begins an object, also each object of a list.
  void (*begin)(HX_ModelReading&, HX_TokenEnd place) = nullptr;
  /// Ends the object; \p isFaulty if there was a fault in the object.
  void (*end)(HX_ModelReading&, bool isFaulty) = nullptr;
};

template <class Row>
struct HX_Rows {
  const Row* first;
  std::size_t count;
  const Row* begin() const { return first; }
  const Row* end() const { return first + count; }
};
using HX_Bindings = HX_Rows<HX_FieldBinding>;

HX_Bindings HX_OptionBindings();
HX_Bindings HX_SourceBindings();
HX_Bindings HX_TypeBindings();
HX_Bindings HX_ScopeBindings();
HX_Bindings HX_NameBindings();

// In this order.
void HX_ResolveSources(HX_ModelReading& reading);
void HX_ResolveTypes(HX_ModelReading& reading);
void HX_ResolveScopes(HX_ModelReading& reading);
void HX_ResolveNames(HX_ModelReading& reading);

/// The type of \p use if the code can declare a variable of the type; else a
/// fault, and null.
HX_TypeItem* HX_FindDeclarableType(HX_ModelReading& reading, const HX_Use& use);

/// Checks the initial values of a variable whose type is whole.
/// \param place  of the last value; 0 for no value
void HX_CheckInitial(HX_ModelReading& reading, HX_TokenEnd place,
                     const HX_WantedName& name);

/// Checks sections, alignments and static variables of all names.
void HX_CheckPlacements(HX_ModelReading& reading);

/// Reads the text of \p document by the schema; faults go to \p reading.
/// \return false if the reading stopped before the end of the document
bool HX_ReadDocument(HX_Document& document, HX_ModelReading& reading,
                     HX_Progress& progress);

/// The limits of the schema that no single value can show.
struct HX_ModelLimits {
  std::size_t elements;  // of nested arrays and structures
  std::size_t chain;     // of types that stand on each other
};
HX_ModelLimits HX_LimitsOfSchema();

#endif  // HOST_MODEL_HX_MODELREADING_H
