#include "host/write/HX_NameTable.h"

#include <algorithm>
#include <ostream>

#include "host/base/HX_JsonWriter.h"
#include "host/base/HX_Text.h"
#include "host/write/HX_NameColumns.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

using Row = std::vector<std::string>;

std::string orDash(const std::string& text) {
  return text.empty() ? "-" : text;
}

std::string padded(const std::string& text, std::size_t width) {
  return text +
         std::string(std::max(width, HX_WidthOf(text)) - HX_WidthOf(text), ' ');
}

void widen(std::vector<std::size_t>& widths, const Row& row) {
  for (std::size_t i = 0; i < widths.size(); ++i)
    widths[i] = std::max(widths[i], HX_WidthOf(row[i]));
}

// Of all columns but the last column, which is not padded.
std::vector<std::size_t> widthsOf(const Row& row) {
  std::vector<std::size_t> widths(row.size() - 1, 0);
  widen(widths, row);
  return widths;
}

std::string aligned(const Row& row, const std::vector<std::size_t>& widths) {
  std::string line;
  for (std::size_t i = 0; i < widths.size(); ++i)
    line += padded(HX_TailOf(row[i], widths[i]), widths[i]) + "  ";
  return line + row.back();
}

// Takes from the widest column until a line fits; 0 for lines of any length.
void fit(std::vector<std::size_t>& widths, std::size_t last,
         std::size_t width) {
  constexpr std::size_t kNarrowest = 8;
  const auto need = [&] {
    std::size_t sum = last;
    for (const std::size_t each : widths) sum += each + 2;
    return sum;
  };
  if (width == 0 || widths.empty()) return;
  for (;;) {
    const auto widest = std::max_element(widths.begin(), widths.end());
    if (need() <= width || *widest <= kNarrowest) return;
    --*widest;
  }
}

// "error   17056  C keyword int used as identifier.  [path]"
std::string lineOf(const HX_Finding& finding, const std::string& knownSource) {
  const bool isKnown = finding.source.empty() || finding.source == knownSource;
  return padded(HX_MessageHandler::severityName(finding.severity), 8) +
         padded(std::to_string(finding.id), 7) + HX_Visible(finding.text) +
         (isKnown ? "" : "  [" + HX_Visible(finding.source) + "]");
}

template <class Item, class TextOf>
void writeOrder(std::ostream& out, const char* what,
                const std::vector<const Item*>& items, TextOf textOf) {
  if (items.empty()) return;
  out << '\n' << what << " in the order of their definition:\n";
  for (const Item* item : items) out << "  " << textOf(*item) << '\n';
}

}  // namespace

// In two passes, for widths and for lines: the table never stands in memory.
void HX_WriteTable(std::ostream& out, const HX_RunResult& result,
                   const std::vector<std::string>& columns, int width,
                   HX_Progress& progress) {
  progress.begin("measuring the table", result.names.size());
  const Row head(columns.begin(), columns.end());
  std::vector<std::size_t> widths = widthsOf(head);
  for (const HX_FormedName* name : result.names) {
    widen(widths, HX_RowOf(*name, columns));
    progress.step();
  }
  fit(widths, head.back().size(), static_cast<std::size_t>(width));
  progress.begin("printing", result.names.size());
  const std::string first = aligned(head, widths);
  out << first << '\n' << std::string(HX_WidthOf(first), '-') << '\n';
  for (const HX_FormedName* name : result.names) {
    out << aligned(HX_RowOf(*name, columns), widths) << '\n';
    if (!name->changes.empty())
      out << "    changed: " << HX_Visible(HX_JoinedChanges(*name, ", "))
          << '\n';
    for (const HX_Finding& finding : name->findings)
      out << "    " << lineOf(finding, name->sourcePath()) << '\n';
    progress.step();
  }
  progress.end();
  writeOrder(out, "Types", result.types,
             [](const HX_TypeItem& type) { return type.name; });
  writeOrder(out, "Variables", result.variables,
             [](const HX_FormedName& name) { return HX_ToUtf8(name.actual); });
  for (const HX_Finding& finding : result.findings)
    out << '\n' << lineOf(finding, "") << '\n';
}

void HX_WriteExplanation(std::ostream& out, const HX_FormedName& name,
                         const std::vector<HX_ExplainedMacro>& macros,
                         const std::vector<HX_ExplainedStep>& steps) {
  out << "name      " << name.wanted->id << "\ntemplate  "
      << orDash(*name.wanted->nameTemplate->shown) << '\n';
  if (name.wanted->rule != nullptr)
    out << "rule      " << *name.wanted->rule << '\n';
  out << "source    " << orDash(name.sourcePath()) << "\n\n";
  std::vector<Row> rows{{"macro", "gives", "which is"}};
  for (const HX_ExplainedMacro& step : macros)
    rows.push_back({HX_Visible(step.macro), orDash(HX_Visible(step.value)),
                    HX_Visible(step.origin)});
  std::vector<std::size_t> widths = widthsOf(rows.front());
  for (const Row& row : rows) widen(widths, row);
  for (const Row& row : rows) out << "  " << aligned(row, widths) << '\n';
  std::size_t widest = 0;
  for (const HX_ExplainedStep& step : steps)
    widest = std::max(widest, HX_WidthOf(step.what));
  if (!steps.empty()) out << '\n';
  for (const HX_ExplainedStep& step : steps)
    out << (step.isConflict ? "  ! " : "    ") << padded(step.what, widest)
        << "  " << orDash(step.text) << '\n';
  out << "\nformal    " << orDash(HX_ToUtf8(name.formal())) << "\nactual    "
      << orDash(HX_ToUtf8(name.actual)) << '\n';
  for (const HX_Change& change : name.changes)
    out << "changed   " << change.text() << '\n';
  out << "complete  " << (name.isComplete ? "yes" : "no") << '\n';
  for (const HX_Finding& finding : name.findings)
    out << lineOf(finding, "") << '\n';
}

void HX_WriteExplanationJson(std::ostream& out, const HX_FormedName& name,
                             const std::vector<HX_ExplainedMacro>& macros,
                             const std::vector<HX_ExplainedStep>& steps) {
  HX_JsonWriter json(out, 2);
  json.open('{');
  json.field("id", name.wanted->id);
  json.field("template", *name.wanted->nameTemplate->shown);
  if (name.wanted->rule != nullptr) json.field("rule", *name.wanted->rule);
  json.field("source", name.sourcePath());
  json.key("macros");
  json.open('[');
  for (const HX_ExplainedMacro& macro : macros) {
    json.next();
    json.open('{');
    json.field("macro", macro.macro);
    json.field("gives", macro.value);
    json.field("is", macro.origin);
    json.close('}');
  }
  json.close(']');
  json.key("steps");
  json.open('[');
  for (const HX_ExplainedStep& step : steps) {
    json.next();
    json.open('{');
    json.field("what", step.what);
    json.field("name", step.text);
    json.rawField("conflict", step.isConflict ? "true" : "false");
    json.close('}');
  }
  json.close(']');
  json.field("formal", HX_ToUtf8(name.formal()));
  json.field("actual", HX_ToUtf8(name.actual));
  json.rawField("complete", name.isComplete ? "true" : "false");
  json.close('}');
  json.end();
}
