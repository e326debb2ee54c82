#include "host/HX_NameReport.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <ostream>

#include "host/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"

using nlohmann::ordered_json;

namespace {

constexpr int kError = 2;
using Row = std::vector<std::string>;

// Columns as a reader counts them: UTF-8 continuation bytes take none.
std::size_t widthOf(const std::string& text) {
  return static_cast<std::size_t>(std::count_if(
      text.begin(), text.end(), [](char c) { return (c & '\xC0') != '\x80'; }));
}

std::string padded(const std::string& text, std::size_t width) {
  const std::size_t own = widthOf(text);
  return own < width ? text + std::string(width - own, ' ') : text;
}

// The last column is not padded.
std::string lineOf(const Row& row, const std::vector<std::size_t>& widths) {
  std::string line;
  for (std::size_t i = 0; i + 1 < row.size(); ++i)
    line += padded(row[i], widths[i]) + "  ";
  return line + row.back() + "\n";
}

std::vector<std::size_t> widthsOf(const std::vector<Row>& rows) {
  std::vector<std::size_t> widths(rows.front().size(), 0);
  for (const Row& row : rows) {
    for (std::size_t i = 0; i < row.size(); ++i)
      widths[i] = std::max(widths[i], widthOf(row[i]));
  }
  return widths;
}

std::string joined(const std::vector<std::string>& texts,
                   const char* separator) {
  std::string all;
  for (const std::string& text : texts)
    all += (all.empty() ? "" : separator) + text;
  return all;
}

std::string orDash(const std::string& text) {
  return text.empty() ? "-" : text;
}

// The end of a path tells more than its beginning.
std::string shortPath(const std::string& path) {
  constexpr int kWidth = 40;
  KyCXString text = HX_FromUtf8(path);
  if (text.length() <= kWidth) return path;
  return "..." + HX_ToUtf8(text.sub(text.length() - kWidth + 3, text.length()));
}

ordered_json findingAsJson(const HX_Finding& finding) {
  return {{"id", finding.id},
          {"severity", HX_MessageHandler::severityName(finding.severity)},
          {"text", finding.text},
          {"source", finding.source}};
}

ordered_json nameAsJson(const HX_FormedName& name) {
  ordered_json sources = ordered_json::array();
  name.sources.forEach([&](const HxCSrcRef* srcRef) {
    KyCXString text;
    srcRef->toString(text);
    sources.push_back(HX_ToUtf8(text));
  });
  ordered_json messages = ordered_json::array();
  for (const HX_Finding& finding : name.findings)
    messages.push_back(findingAsJson(finding));
  return {{"id", name.item->id},         {"source", name.sourcePath},
          {"sources", sources},          {"template", name.item->nameTemplate},
          {"formal", name.formal},       {"actual", name.actual},
          {"complete", name.isComplete}, {"defined", name.isDefined},
          {"changes", name.changes},     {"messages", messages}};
}

// Line feeds inside a text are escaped: each one here ends a line.
std::string indented(const std::string& json, const std::string& indent) {
  std::string text = indent;
  for (const char c : json) {
    text += c;
    if (c == '\n') text += indent;
  }
  return text;
}

// Doubled quotes inside quotes, where the text needs them.
std::string csvField(const std::string& text) {
  if (text.find_first_of(",\"\r\n") == std::string::npos) return text;
  std::string quoted = "\"";
  for (const char c : text) quoted += c == '"' ? "\"\"" : std::string(1, c);
  return quoted + '"';
}

std::string orderLine(const char* title,
                      const std::vector<std::string>& names) {
  if (names.empty()) return {};
  return std::string("\n") + title + ":\n  " + joined(names, "\n  ") + "\n";
}

std::vector<std::string> typeNames(const HX_RunResult& result) {
  std::vector<std::string> names;
  for (const HX_TypeItem* type : result.types) names.push_back(type->name);
  return names;
}

std::vector<std::string> variableNames(const HX_RunResult& result) {
  std::vector<std::string> names;
  for (const HX_FormedName* name : result.variables)
    names.push_back(name->actual);
  return names;
}

bool isError(const HX_Finding& finding) {
  return finding.severity % 4 >= kError;
}

}  // namespace

bool HX_RunResult::hasErrors() const {
  if (std::any_of(findings.begin(), findings.end(), isError)) return true;
  return std::any_of(names.begin(), names.end(), [](const auto& name) {
    return std::any_of(name.findings.begin(), name.findings.end(), isError);
  });
}

std::string HX_FindingAsLine(const HX_Finding& finding) {
  const std::string id =
      finding.id != 0 ? std::to_string(finding.id) : std::string("host");
  return padded(HX_MessageHandler::severityName(finding.severity), 8) +
         padded(id, 7) + finding.text +
         (finding.source.empty() ? "" : "  [" + finding.source + "]") + "\n";
}

std::string HX_NamesAsTable(const HX_RunResult& result) {
  std::vector<Row> rows{
      {"name", "source", "template", "formal", "actual", "complete"}};
  for (const HX_FormedName& name : result.names)
    rows.push_back({name.item->id, orDash(shortPath(name.sourcePath)),
                    orDash(name.item->nameTemplate), orDash(name.formal),
                    orDash(name.actual), name.isComplete ? "yes" : "no"});

  const std::vector<std::size_t> widths = widthsOf(rows);
  std::size_t total = 2 * (widths.size() - 1);
  for (const std::size_t width : widths) total += width;
  std::string table = lineOf(rows[0], widths) + std::string(total, '-') + "\n";
  for (std::size_t i = 0; i < result.names.size(); ++i) {
    const HX_FormedName& name = result.names[i];
    table += lineOf(rows[i + 1], widths);
    if (!name.changes.empty())
      table += "    changed: " + joined(name.changes, ", ") + "\n";
    for (HX_Finding finding : name.findings) {
      if (finding.source == name.sourcePath) finding.source.clear();
      table += "    " + HX_FindingAsLine(finding);
    }
  }
  table +=
      orderLine("Types in the order of their definition", typeNames(result));
  table += orderLine("Variables in the order of their definition",
                     variableNames(result));
  for (const HX_Finding& finding : result.findings)
    table += "\n" + HX_FindingAsLine(finding);
  return table;
}

void HX_WriteNamesAsJson(std::ostream& out, const HX_RunResult& result) {
  out << "{\n  \"names\": [";
  const char* separator = "\n";
  for (const HX_FormedName& name : result.names) {
    out << separator << indented(nameAsJson(name).dump(2), "    ");
    separator = ",\n";
  }
  out << (result.names.empty() ? "]," : "\n  ],");

  ordered_json rest{{"types", typeNames(result)},
                    {"variables", variableNames(result)},
                    {"messages", ordered_json::array()}};
  for (const HX_Finding& finding : result.findings)
    rest["messages"].push_back(findingAsJson(finding));
  out << rest.dump(2).substr(1) << '\n';  // its own brace is written already
}

void HX_WriteNamesAsCsv(std::ostream& out, const HX_RunResult& result) {
  out << "id,template,formal,actual,changes,source\r\n";
  for (const HX_FormedName& name : result.names)
    out << csvField(name.item->id) << ',' << csvField(name.item->nameTemplate)
        << ',' << csvField(name.formal) << ',' << csvField(name.actual) << ','
        << csvField(joined(name.changes, "; ")) << ','
        << csvField(name.sourcePath) << "\r\n";
}

std::string HX_ExplanationAsText(const HX_FormedName& name,
                                 const std::vector<HX_ExplainedMacro>& steps) {
  std::string text = "name      " + name.item->id + "\ntemplate  " +
                     orDash(name.item->nameTemplate) + "\nsource    " +
                     orDash(name.sourcePath) + "\n\n";
  std::vector<Row> rows{{"macro", "gives", "which is"}};
  for (const HX_ExplainedMacro& step : steps)
    rows.push_back({step.macro, orDash(step.value), step.origin});
  for (const Row& row : rows) text += "  " + lineOf(row, widthsOf(rows));
  text += "\nformal    " + orDash(name.formal) + "\nactual    " +
          orDash(name.actual) + "\n";
  for (const std::string& change : name.changes)
    text += "changed   " + change + "\n";
  text += std::string("complete  ") + (name.isComplete ? "yes" : "no") + "\n";
  for (const HX_Finding& finding : name.findings)
    text += HX_FindingAsLine(finding);
  return text;
}
