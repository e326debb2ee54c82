// hx_codegen lint: templates without a model.
#include <algorithm>
#include <iostream>
#include <nlohmann/json.hpp>
#include <optional>

#include "SafeNames/HX_ReservedNames.h"
#include "SafeNames/HX_TemplateLint.h"
#include "host/base/HX_Faults.h"
#include "host/base/HX_Text.h"
#include "host/program/HX_Commands.h"
#include "host/program/HX_LockFile.h"
#include "platform/model/HxCSymbol.h"

namespace {

using Json = nlohmann::json;
using nlohmann::ordered_json;

// In the order of HX_Macro::HxEStageTag.
constexpr const char* kStages[] = {"caller", "task", "template", "symbol"};

struct Problem {
  int message;  // of the library; 0 for a remark of the program
  bool isError;
  std::string text;
};

struct Checked {
  std::string place;  // a rule, or empty
  std::string form;
  HX_TemplateLint lint;
  std::vector<Problem> problems;
};

// Nothing for a template of the command line.
std::optional<std::string> templateIn(const Json& rule) {
  const auto form = rule.find("template");
  if (form == rule.end() || !form->is_string()) return {};
  return form->get<std::string>();
}

// The rules of kinds and those of types have templates.
void collect(const std::string& file, const Json& root,
             std::vector<std::pair<std::string, std::string>>& forms) {
  for (const auto& [list, rules] : root.items()) {
    if (!rules.is_array()) continue;
    for (std::size_t i = 0; i < rules.size(); ++i) {
      if (!rules[i].is_object()) continue;
      if (const auto form = templateIn(rules[i]))
        forms.emplace_back(
            file + ": /" + list + "/" + std::to_string(i) + "/template", *form);
    }
  }
}

void checkMacros(Checked& checked) {
  for (int i = 0; i < checked.lint.macroCount(); ++i) {
    const HX_TemplateLint::Macro& macro = checked.lint.macro(i);
    const std::string shown = "'" + HX_ToUtf8(macro.text) + "'";
    if (macro.row == nullptr)
      checked.problems.push_back(
          {macro.message, true, "The name macro " + shown + " is unknown."});
    else if (macro.message != 0)
      checked.problems.push_back(
          {macro.message, false,
           "The name macro " + shown + " is not supported unless the stage '" +
               kStages[macro.row->stage] + "' has replaced it."});
  }
}

void checkForm(Checked& checked, unsigned int patterns, int limit) {
  const HX_TemplateLint& lint = checked.lint;
  const auto problem = [&](bool isError, const std::string& text) {
    checked.problems.push_back({0, isError, text});
  };
  if (checked.form.empty()) problem(true, "The template is empty.");
  if (lint.partCount() > 2)
    problem(true, "The template has more than two parts; the first two count.");
  if (lint.isUnclosed())
    problem(true, "A '$(' has no ')': the rest is copied as text.");
  if (!lint.mayChange()) {
    problem(false,
            "The actual name has no $R: it can be neither shortened nor made "
            "distinct.");
    const std::string longer = "longer than " + std::to_string(limit) +
                               " characters and cannot be shortened.";
    if (std::max(lint.fixedLength(), lint.longest()) > limit)
      problem(true, "The name can be " + longer);
    else if (lint.longest() < 0)
      problem(false, "With long values the name is " + longer);
  }
  const unsigned int always = lint.alwaysMatching(patterns, true);
  for (unsigned int bit = 1; bit != 0 && bit <= always; bit <<= 1)
    if ((always & bit) != 0)
      problem(true, std::string("Every name matches the reserved pattern '") +
                        HX_ReservedNames::patternName(bit) + "'.");
}

ordered_json asJson(const Checked& checked) {
  ordered_json macros = ordered_json::array();
  for (int i = 0; i < checked.lint.macroCount(); ++i) {
    const HX_TemplateLint::Macro& macro = checked.lint.macro(i);
    ordered_json entry{{"macro", HX_ToUtf8(macro.text)},
                       {"position", macro.position}};
    if (macro.row != nullptr) {
      entry["stage"] = kStages[macro.row->stage];
      entry["meaning"] = macro.row->meaning;
    }
    if (macro.message != 0) entry["message"] = macro.message;
    macros.push_back(entry);
  }
  ordered_json problems = ordered_json::array();
  for (const Problem& problem : checked.problems)
    problems.push_back({{"severity", problem.isError ? "error" : "warning"},
                        {"message", problem.message},
                        {"text", problem.text}});
  ordered_json all;
  if (!checked.place.empty()) all["place"] = checked.place;
  all["template"] = checked.form;
  all["macros"] = macros;
  all["mayChange"] = checked.lint.mayChange();
  all["fixedLength"] = checked.lint.fixedLength();
  all["longest"] = checked.lint.longest() < 0
                       ? ordered_json(nullptr)
                       : ordered_json(checked.lint.longest());
  all["problems"] = problems;
  return all;
}

void writeText(const Checked& checked) {
  std::cout << (checked.place.empty() ? "" : checked.place + ": ")
            << HX_Visible(checked.form) << '\n';
  for (int i = 0; i < checked.lint.macroCount(); ++i) {
    const HX_TemplateLint::Macro& macro = checked.lint.macro(i);
    std::cout << "  " << HX_Visible(HX_ToUtf8(macro.text)) << "  ";
    if (macro.row == nullptr)
      std::cout << "unknown\n";
    else
      std::cout << macro.row->meaning << "  [" << kStages[macro.row->stage]
                << "]\n";
  }
  std::cout << "  longest name: ";
  if (checked.lint.longest() < 0)
    std::cout << "no bound, " << checked.lint.fixedLength()
              << " characters without values\n";
  else
    std::cout << checked.lint.longest() << " characters\n";
  for (const Problem& problem : checked.problems) {
    std::cout << "  " << (problem.isError ? "error" : "warning") << ": ";
    if (problem.message != 0) std::cout << problem.message << ": ";
    std::cout << problem.text << '\n';
  }
}

}  // namespace

HX_ExitCode HX_LintTemplates(const HX_Arguments& arguments) {
  unsigned int patterns = 0;
  for (const std::string& name : arguments.patterns)
    patterns |= HX_ReservedNames::patternOf(name.c_str());
  std::vector<std::pair<std::string, std::string>> forms;
  for (const std::string& form : arguments.templates)
    forms.emplace_back("", form);
  if (!arguments.rules.empty()) {
    const Json root = Json::parse(
        HX_ReadWholeFile(arguments.rules,
                         std::filesystem::current_path() / arguments.rules),
        nullptr, false);
    if (!root.is_object())
      throw HX_InputError(HX_Visible(arguments.rules) +
                          ": found no JSON object, expected naming rules");
    collect(HX_Visible(arguments.rules), root, forms);
  }
  ordered_json all = ordered_json::array();
  bool hasErrors = false;
  for (const auto& [place, form] : forms) {
    Checked checked;
    checked.place = place;
    checked.form = form;
    if (!checked.lint.read(HX_FromUtf8(form))) throw std::bad_alloc();
    checkMacros(checked);
    checkForm(checked, patterns, HxCSymbol::sm_MaxNameLength);
    for (const Problem& problem : checked.problems)
      hasErrors = hasErrors || problem.isError;
    if (arguments.json)
      all.push_back(asJson(checked));
    else
      writeText(checked);
  }
  if (arguments.json)
    std::cout << ordered_json{{"templates", all}}.dump(2) << '\n';
  return hasErrors ? kHxErrorsFound : kHxDone;
}
