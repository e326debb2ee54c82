// The model that a document describes, built from the platform's stand-ins, and
// what becomes of its names.
//
//   HX_Document document("cruise_control.json", folder);
//   HX_Model model(document, "data/keywords");
//   for (HX_Name& name : model.names) form(name);
//
// While a model lives it is the one that the library sees: options, model
// names, data type server and data dictionary are those of the process.

#ifndef HOST_MODEL_HX_MODEL_H
#define HOST_MODEL_HX_MODEL_H

#include <deque>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCSrcRefSet.h"
#include "platform/datatypes/HX_DataType.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/datatypes/HX_NumericalType.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCSymbol.h"
#include "platform/model/SC_Chart.h"
#include "platform/model/SC_State.h"

struct HX_Document;

/// A data type of the generated code. Fields without a comment are those of the
/// schema, here and below.
struct HX_TypeItem {
  explicit HX_TypeItem(const KyCXString& nameInCode) : type(nameInCode) {}

  std::string id;
  std::string name;
  std::string kind;
  std::string cType;
  int bits = 0;
  int length = 0;
  bool isNameless = false;
  HX_TypeItem* of = nullptr;
  std::vector<std::pair<std::string, HX_TypeItem*>> fields;
  std::vector<std::pair<std::string, int>> values;
  std::optional<HX_NumericalType> numerical;  // range of the kinds without `of`
  HX_DataType type;

  /// The type at the end of the chain of `of`: what a value of this type, or
  /// an element of it, is stored as. Null where the chain closes a circle.
  const HX_TypeItem* scalar() const;
  bool isFloating() const { return cType == "float" || cType == "double"; }
};

struct HX_ScopeItem {
  std::string id;
  std::string kind;
  HX_ScopeItem* parent = nullptr;
  std::map<std::string, const HX_ScopeItem*> blocks;  // in it, by id
};

/// A message of the library, or a remark of the host itself.
struct HX_Finding {
  int id;  ///< what a user sees; 0 for a remark of the host
  int severity;
  std::string text;    // UTF-8, as below
  std::string source;  // may be empty
};

struct HX_Substitution {
  std::string macro;
  std::string value;
  int kind;  // HxCNames::tagMacroKindEnum
};

/// One name: what the document wants, and what became of it.
struct HX_Name {
  std::string id;
  std::string nameTemplate;
  std::string kind = "object";
  const HxCSrcRef* source = nullptr;
  const HxCSrcRef* dd = nullptr;
  HxCSrcRefSet sources;  // these two, and `alsoFrom`
  std::optional<std::string> ivBlock;
  std::string label;
  std::string x;
  HX_TypeItem* type = nullptr;
  const HX_ScopeItem* scope = nullptr;
  unsigned int retained = 0;  // macro bits
  unsigned int provisional = 0;
  bool modelContext = false;
  std::unique_ptr<HxCSymbol> symbol;  // null for none
  std::vector<HX_Substitution> substitutions;
  const HX_Name* task = nullptr;
  const HX_Name* isr = nullptr;
  std::map<std::string, std::string> osTexts;  // event, counter, ...
  double period = 0;
  double offset = 0;
  bool cyclic = true;
  std::vector<double> initial;
  double lsb = 1;
  double zero = 0;
  std::vector<const HX_Name*> dependsOn;

  const HX_ScopeItem* body = nullptr;  // of a function that has one

  std::string sourcePath;  // of the best of the sources
  std::string formal;
  std::string actual;
  bool isComplete = false;
  bool isDefined = false;  // stands in its scope and may be written into code
  std::vector<std::string> changes;  // why the expanded text was changed
  std::vector<HX_Finding> findings;

  bool isTask() const { return kind == "task" || kind == "isr"; }
  bool isFunction() const { return isTask() || kind == "function"; }
  /// The task or isr whose times the macros take; null for none.
  const HX_Name* timed() const {
    if (isTask()) return this;
    return task != nullptr ? task : isr;
  }
};

/// Owns everything that the document describes, in its order.
struct HX_Model {
  /// Throws HX_DocumentError for an id that repeats or leads nowhere, and for a
  /// word list that is not in \p keywordFolder. Frees the parts of the document
  /// that there may be many of as it reads them.
  HX_Model(HX_Document& document, const std::string& keywordFolder);
  HX_Model(const HX_Model&) = delete;
  HX_Model& operator=(const HX_Model&) = delete;
  ~HX_Model();

  std::string name;
  std::set<std::string> words;  // of the word lists
  std::deque<HX_TypeItem> types;
  std::deque<HX_ScopeItem> scopes;  // parents first
  HX_ScopeItem* fileScope = nullptr;
  std::deque<HX_Name> names;

  // Seen through the library.
  HX_OptionsExt options;
  HX_DataTypeServer typeServer;
  std::vector<std::unique_ptr<HX_Block>> blocks;
  std::deque<SC_Chart> charts;
  std::deque<SC_State> chartObjects;
  std::deque<HxCDdSrcRef> ddRefs;
};

#endif  // HOST_MODEL_HX_MODEL_H
