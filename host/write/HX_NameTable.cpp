#include "host/write/HX_NameTable.h"

#include <algorithm>
#include <ostream>

#include "host/base/HX_Text.h"
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
    line += padded(row[i], widths[i]) + "  ";
  return line + row.back();
}

// The end of a path tells more than its beginning.
std::string shortPath(const std::string& path) {
  constexpr int kWidth = 40;
  KyCXString text = HX_FromUtf8(path);
  if (text.length() <= kWidth) return orDash(path);
  return "..." + HX_ToUtf8(text.sub(text.length() - kWidth + 3, text.length()));
}

// "error   17056  C keyword int used as identifier.  [path]"
std::string lineOf(const HX_Finding& finding, const std::string& knownSource) {
  const bool isKnown = finding.source.empty() || finding.source == knownSource;
  return padded(HX_MessageHandler::severityName(finding.severity), 8) +
         padded(std::to_string(finding.id), 7) + HX_Visible(finding.text) +
         (isKnown ? "" : "  [" + HX_Visible(finding.source) + "]");
}

Row rowOf(const HX_FormedName& name) {
  return {HX_Visible(name.wanted->id),
          shortPath(HX_Visible(name.sourcePath())),
          orDash(HX_Visible(*name.wanted->nameTemplate->shown)),
          orDash(HX_ToUtf8(name.formal())),
          orDash(HX_ToUtf8(name.actual)),
          name.isComplete ? "yes" : "no"};
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
                   HX_Progress& progress) {
  progress.begin("measuring the table", result.names.size());
  const Row head = {"name",   "source", "template",
                    "formal", "actual", "complete"};
  std::vector<std::size_t> widths = widthsOf(head);
  for (const HX_FormedName* name : result.names) {
    widen(widths, rowOf(*name));
    progress.step();
  }
  progress.begin("printing", result.names.size());
  const std::string first = aligned(head, widths);
  out << first << '\n' << std::string(HX_WidthOf(first), '-') << '\n';
  for (const HX_FormedName* name : result.names) {
    out << aligned(rowOf(*name), widths) << '\n';
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
                         const std::vector<HX_ExplainedMacro>& steps) {
  out << "name      " << name.wanted->id << "\ntemplate  "
      << orDash(*name.wanted->nameTemplate->shown) << '\n';
  if (name.wanted->rule != nullptr)
    out << "rule      " << *name.wanted->rule << '\n';
  out << "source    " << orDash(name.sourcePath()) << "\n\n";
  std::vector<Row> rows{{"macro", "gives", "which is"}};
  for (const HX_ExplainedMacro& step : steps)
    rows.push_back({HX_Visible(step.macro), orDash(HX_Visible(step.value)),
                    HX_Visible(step.origin)});
  std::vector<std::size_t> widths = widthsOf(rows.front());
  for (const Row& row : rows) widen(widths, row);
  for (const Row& row : rows) out << "  " << aligned(row, widths) << '\n';
  out << "\nformal    " << orDash(HX_ToUtf8(name.formal())) << "\nactual    "
      << orDash(HX_ToUtf8(name.actual)) << '\n';
  for (const HX_Change& change : name.changes)
    out << "changed   " << change.text() << '\n';
  out << "complete  " << (name.isComplete ? "yes" : "no") << '\n';
  for (const HX_Finding& finding : name.findings)
    out << lineOf(finding, "") << '\n';
}

void HX_WriteFindings(std::ostream& out, const HX_RunResult& result) {
  for (const HX_FormedName* name : result.names) {
    for (const HX_Finding& finding : name->findings)
      out << name->wanted->id << ": " << lineOf(finding, "") << '\n';
  }
  for (const HX_Finding& finding : result.findings)
    out << lineOf(finding, "") << '\n';
}
