// The names of a model: items of the tree, chosen by the rules.

#ifndef HOST_IMPORT_HX_NAMEITEMS_H
#define HOST_IMPORT_HX_NAMEITEMS_H

#include <deque>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "host/import/HX_ModelTree.h"
#include "host/import/HX_Rules.h"
#include "host/import/HX_TypeTable.h"

class HX_Dictionary;
class HX_Notes;

/// Fields without a comment: see a name in the document's schema.
struct HX_ImportedName {
  std::string id;
  const HX_Rule* rule;
  const char* kind;
  std::string source;
  std::string dd;
  std::string label;
  std::string x;
  std::string type;  ///< empty for a name without a type
  std::string scope;
  std::string task;
  std::optional<double> period;
  double offset = 0;
  std::vector<double> initial;
  double lsb = 1;
  double zero = 0;
};

/// A function with a scope for the body.
struct HX_ImportedBody {
  std::string scope;
  std::string function;
};

/// Ids of names: the block's id, '#' and the part of the block ("27#out:1",
/// "27#state", "27#Gain", "27#function"); the id of the chart object; "task:"
/// and the times; "variable:" and the variable's name.
class HX_NameItems {
 public:
  HX_NameItems(const HX_Rules& rules, const HX_Dictionary& dictionary,
               HX_TypeTable& types, HX_Notes& notes)
      : m_Rules(rules),
        m_Dictionary(dictionary),
        m_Types(types),
        m_Notes(notes) {}

  /// Adds the names of \p root and everything below, in the order of the tree;
  /// a task before the first item of the task.
  void collect(const HX_ModelBlock& root);

  const std::deque<HX_ImportedName>& names() const { return m_Names; }
  const std::deque<HX_ImportedBody>& bodies() const { return m_Bodies; }

 private:
  // The surroundings of a block.
  struct Context {
    std::string path;  // below the model
    std::string body;  // scope of the innermost function; empty for none
    std::string task;
    const HX_ModelBlock* parent;
  };

  /// Statements of the model about a variable, before a type is chosen.
  struct Value {
    std::string_view type;
    std::string_view number;  // the literal; empty for none
    std::string_view dimensions;
  };

  void visit(const HX_ModelBlock& block, const Context& around);
  void addFunction(const HX_ModelBlock& block, Context& inner);
  void addPort(const HX_ModelBlock& block, const Context& place);
  void addSignals(const HX_ModelBlock& block, const Context& place);
  void addState(const HX_ModelBlock& block, const Context& place);
  void addParameters(const HX_ModelBlock& block, const Context& place);
  void addParameter(const HX_ModelBlock& block, const Context& place,
                    std::string_view parameter, std::string_view text);
  void addChartObject(const HX_ChartObject& object, const Context& place);
  void addChartData(const HX_ChartObject& object, const Context& place,
                    HX_RuleItem item);
  std::string taskOf(const HX_ModelBlock& block, const Context& place);

  HX_ImportedName* add(const HX_RuleItem& item, const char* kind,
                       const std::string& id, const std::string& source,
                       const Context& place);
  void setType(HX_ImportedName& name, const Value& value, const Context& place);
  void setVariable(HX_ImportedName& name, const std::string& variable,
                   const Value& value, const Context& place);

  const HX_Rules& m_Rules;
  const HX_Dictionary& m_Dictionary;
  HX_TypeTable& m_Types;
  HX_Notes& m_Notes;
  std::deque<HX_ImportedName> m_Names;
  std::deque<HX_ImportedBody> m_Bodies;
  std::set<std::string> m_Shared;  // ids of tasks and variables
};

#endif  // HOST_IMPORT_HX_NAMEITEMS_H
