// Naming rules: the items of a model with a name, and the form of the name.
//
//   HX_Rules rules("project.rules.json");
//   HX_RuleItem item{HX_Rule::eSignal, block.type, "Controller/Gain"};
//   if (const HX_Rule* rule = rules.find(item)) use(rule->nameTemplate);
//
// rules.schema.json describes the form. The schema is part of the program and
// checks the file.

#ifndef HOST_IMPORT_HX_RULES_H
#define HOST_IMPORT_HX_RULES_H

#include <filesystem>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

/// Fields without a comment: see the schema.
struct HX_Rule {
  enum Kind {
    eInput,
    eOutput,
    eSignal,
    eState,
    eParameter,
    eFunction,
    eChartState,
    eChartData,
    eChartEvent,
    eChartFunction,
    eTask,
    eType,
    eKinds  ///< the number of kinds
  };

  std::string name;
  Kind kind = eSignal;
  std::vector<std::string> blockTypes;
  std::string path;
  std::vector<std::string> parameters;
  std::vector<std::string> dataScopes;
  std::optional<bool> labelled;
  std::optional<bool> several;
  std::optional<bool> variable;
  std::string nameTemplate;
  bool hasTemplate = false;
  std::string type;
  bool inFunction = false;
};

/// The properties of an item for the choice of a rule.
struct HX_RuleItem {
  HX_Rule::Kind kind;
  std::string_view blockType = {};
  std::string_view path = {};
  std::string_view parameter = {};
  std::string_view dataScope = {};
  bool labelled = false;
  bool several = false;
  bool variable = false;
};

class HX_Rules {
 public:
  /// The built-in rules.
  HX_Rules();
  /// Throws HX_ImportError for a file that cannot be read, is no JSON, or does
  /// not have the form of the schema.
  explicit HX_Rules(const std::filesystem::path& file);

  /// RETURNS: the first fitting rule; null if none fits, or if the rule gives
  /// no name.
  const HX_Rule* find(const HX_RuleItem& item) const;

  /// RETURNS: the C name of the type with the text \p text in the model.
  /// \param name  the value of $X; a template of a type knows no further macro
  std::string typeName(std::string_view text, const std::string& name) const;

  /// The parameters that rules list.
  const std::set<std::string, std::less<>>& parameters() const {
    return m_Parameters;
  }

  std::string systemId = "a";
  bool limitNames = true;
  std::vector<std::string> keywords;

  /// The built-in rules as a rules file, and the schema.
  static const char* defaultText();
  static const char* schemaText();

 private:
  void read(const std::string& file, const std::string& text);

  std::vector<HX_Rule> m_ByKind[HX_Rule::eKinds];
  std::set<std::string, std::less<>> m_Parameters;
};

/// True if \p path has the form of \p pattern: '*' stands for any characters
/// but '/', "**" for any characters.
/// COST: at most the square of the path times the pattern; linear with a
/// single star.
bool HX_MatchesPath(std::string_view pattern, std::string_view path);

#endif  // HOST_IMPORT_HX_RULES_H
