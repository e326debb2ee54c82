// The model that a document describes, built from the platform's stand-ins.
//
//   const HX_Document document("cruise_control.json");
//   HX_Model model(document.root());
//   for (const auto& name : model.names()) form(*name);
//
// While a model lives it is the one that the library sees: options, model
// names, data type server and data dictionary are those of the process.

#ifndef HOST_HX_MODEL_H
#define HOST_HX_MODEL_H

#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "SourceRef/HxCDdSrcRef.h"
#include "platform/datatypes/HX_DataType.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/datatypes/HX_NumericalType.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCSymbol.h"
#include "platform/model/SC_Chart.h"
#include "platform/model/SC_State.h"

class HX_DocumentNode;

/// A data type of the generated code.
struct HX_TypeItem {
  explicit HX_TypeItem(const KyCXString& nameInCode) : type(nameInCode) {}

  std::string id;
  std::string name;   // in the code
  std::string kind;   // as the schema lists them
  std::string cType;  // of a base type
  int bits = 0;       // of a bit field
  int length = 0;     // of an array
  bool isNameless = false;
  HX_TypeItem* of = nullptr;
  std::vector<std::pair<std::string, HX_TypeItem*>> fields;
  std::vector<std::pair<std::string, int>> values;
  std::optional<HX_NumericalType> numerical;  // range of base and bit field
  HX_DataType type;

  /// The type at the end of the chain of `of`: what a value of this type, or
  /// an element of it, is stored as. Null where the chain closes a circle.
  const HX_TypeItem* scalar() const;
  /// 1 for what is no array; elements of nested arrays are counted in all.
  std::size_t elementCount() const;
  bool isFloating() const { return cType == "float" || cType == "double"; }
};

struct HX_NameItem;

struct HX_ScopeItem {
  std::string id;
  std::string kind;  // file, function, block, flat
  const HX_ScopeItem* parent = nullptr;
  const HX_NameItem* function = nullptr;  // whose body a function scope is
};

/// A symbol that knows the name it stands for.
struct HX_HostSymbol : HxCSymbol {
  using HxCSymbol::HxCSymbol;
  std::string id;
};

/// One name to form, and what it is for. Fields without a comment are those of
/// the schema.
struct HX_NameItem {
  struct Substitution {
    std::string macro;
    std::string value;
    int kind;  // HxCNames::tagMacroKindEnum
  };

  std::string id;
  std::string nameTemplate;
  std::string kind;
  const HxCSrcRef* source = nullptr;
  const HxCSrcRef* dd = nullptr;
  std::vector<const HxCSrcRef*> alsoFrom;
  std::optional<std::string> ivBlock;
  std::string label;
  std::string x;
  HX_TypeItem* type = nullptr;
  const HX_ScopeItem* scope = nullptr;
  unsigned int retained = 0;  // macro bits
  unsigned int provisional = 0;
  bool modelContext = false;
  std::unique_ptr<HxCSymbol> symbol;  // null for none
  std::vector<Substitution> substitutions;
  const HX_NameItem* task = nullptr;
  const HX_NameItem* isr = nullptr;
  std::map<std::string, std::string> osTexts;  // event, counter, ...
  double period = 0;
  double offset = 0;
  bool cyclic = true;
  std::vector<double> initial;
  double lsb = 1;
  double zero = 0;
  std::vector<const HX_NameItem*> dependsOn;

  bool isTask() const { return kind == "task" || kind == "isr"; }
};

/// Owns everything that the document describes. Not copied: parts point to
/// each other.
class HX_Model {
 public:
  /// Throws HX_DocumentError for an id that repeats or leads nowhere.
  explicit HX_Model(const HX_DocumentNode& root);
  HX_Model(const HX_Model&) = delete;
  HX_Model& operator=(const HX_Model&) = delete;
  ~HX_Model();

  const std::string& name() const { return m_Name; }
  const std::vector<std::string>& keywordLists() const { return m_Keywords; }
  /// In the order of the document, also below.
  const std::vector<std::unique_ptr<HX_TypeItem>>& types() const {
    return m_Types;
  }
  const std::vector<std::unique_ptr<HX_ScopeItem>>& scopes() const {
    return m_Scopes;
  }
  const std::vector<std::unique_ptr<HX_NameItem>>& names() const {
    return m_Names;
  }

 private:
  void readModel(const HX_DocumentNode& root);
  void readBlock(const HX_DocumentNode& node, HX_Block* parent);
  void readChart(const HX_DocumentNode& node, HX_StateflowBlock& block);
  void readChartObject(const HX_DocumentNode& node, SC_State& chart,
                       const std::string& path, const std::string& hierarchy);
  void readDataDictionary(const HX_DocumentNode& node);
  void readTypes(const HX_DocumentNode& root);
  void completeType(const HX_DocumentNode& node, HX_TypeItem& item);
  HX_TypeItem* findNamedType(const HX_DocumentNode& id) const;
  void takeCodeName(const HX_DocumentNode& name);
  void readScopes(const HX_DocumentNode& root);
  void readScope(const HX_DocumentNode& node, const HX_ScopeItem* parent);
  void completeScope(const HX_DocumentNode& node, std::size_t& index);
  void readNames(const HX_DocumentNode& root);
  void readName(const HX_DocumentNode& node, HX_NameItem& item);
  void readSymbol(const HX_DocumentNode& node, HX_NameItem& item);
  void readMultirate(const HX_DocumentNode& node, HX_NameItem& item);
  void readVariable(const HX_DocumentNode& node, HX_NameItem& item);
  void addSource(const HX_DocumentNode& node, const HxCSrcRef* srcRef);

  std::string m_Name;
  std::vector<std::string> m_Keywords;
  HX_OptionsExt m_Options;
  HX_DataTypeServer m_TypeServer;
  std::vector<std::unique_ptr<HX_Block>> m_Blocks;  // parents first
  std::vector<std::unique_ptr<SC_Chart>> m_Charts;
  std::vector<std::unique_ptr<SC_State>> m_ChartObjects;
  std::vector<std::unique_ptr<HxCDdSrcRef>> m_DdRefs;
  std::vector<std::unique_ptr<HX_TypeItem>> m_Types;
  std::vector<std::unique_ptr<HX_ScopeItem>> m_Scopes;
  std::vector<std::unique_ptr<HX_NameItem>> m_Names;
  std::map<std::string, const HxCSrcRef*> m_SourcesById;
  std::map<std::string, HX_TypeItem*> m_TypesById;
  std::map<std::string, const HX_ScopeItem*> m_ScopesById;
  std::map<std::string, HX_NameItem*> m_NamesById;
  std::set<std::string> m_CodeNames;      // of types and constants
  std::set<const HX_NameItem*> m_Bodies;  // functions that have a scope
  const HX_ScopeItem* m_DefaultScope = nullptr;
};

#endif  // HOST_HX_MODEL_H
