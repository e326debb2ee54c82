#include "host/write/HX_NameReport.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <ostream>

#include "host/base/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"

using nlohmann::ordered_json;

namespace {

using Row = std::vector<std::string>;

std::string orDash(const std::string& text) {
  return text.empty() ? "-" : text;
}

// Columns as a reader counts them: UTF-8 continuation bytes take none.
std::size_t widthOf(const std::string& text) {
  return static_cast<std::size_t>(std::count_if(
      text.begin(), text.end(), [](char c) { return (c & '\xC0') != '\x80'; }));
}

std::string padded(const std::string& text, std::size_t width) {
  return text +
         std::string(std::max(width, widthOf(text)) - widthOf(text), ' ');
}

// The lines of a table; the last column is not padded.
std::vector<std::string> aligned(const std::vector<Row>& rows) {
  std::vector<std::size_t> widths(rows.front().size() - 1, 0);
  for (const Row& row : rows) {
    for (std::size_t i = 0; i < widths.size(); ++i)
      widths[i] = std::max(widths[i], widthOf(row[i]));
  }
  std::vector<std::string> lines(rows.size());
  for (std::size_t line = 0; line < rows.size(); ++line) {
    for (std::size_t i = 0; i < widths.size(); ++i)
      lines[line] += padded(rows[line][i], widths[i]) + "  ";
    lines[line] += rows[line].back();
  }
  return lines;
}

std::string joined(const std::vector<std::string>& texts,
                   const char* separator) {
  std::string all;
  for (const std::string& text : texts)
    all += (all.empty() ? "" : separator) + text;
  return all;
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
  const std::string id =
      finding.id != 0 ? std::to_string(finding.id) : std::string("host");
  const bool isKnown = finding.source.empty() || finding.source == knownSource;
  return padded(HX_MessageHandler::severityName(finding.severity), 8) +
         padded(id, 7) + finding.text +
         (isKnown ? "" : "  [" + finding.source + "]");
}

bool isError(const HX_Finding& finding) { return finding.severity % 4 >= 2; }

ordered_json asJson(const std::vector<HX_Finding>& findings) {
  ordered_json messages = ordered_json::array();
  for (const HX_Finding& finding : findings)
    messages.push_back(
        {{"id", finding.id},
         {"severity", HX_MessageHandler::severityName(finding.severity)},
         {"text", finding.text},
         {"source", finding.source}});
  return messages;
}

// Line feeds inside a text are escaped: each one here ends a line.
std::string indented(const std::string& json, const std::string& indent) {
  std::string text;
  for (const char c : json) {
    text += c;
    if (c == '\n') text += indent;
  }
  return text;
}

// Field by field: to build the object first takes half as long again.
void writeJson(std::ostream& out, const HX_Name& name) {
  ordered_json sources = ordered_json::array();
  name.sources.forEach(
      [&](const HxCSrcRef* srcRef) { sources.push_back(HX_PathOf(srcRef)); });
  const std::pair<const char*, ordered_json> fields[] = {
      {"id", name.id},
      {"source", name.sourcePath},
      {"sources", sources},
      {"template", name.nameTemplate},
      {"formal", name.formal},
      {"actual", name.actual},
      {"complete", name.isComplete},
      {"defined", name.isDefined},
      {"changes", name.changes},
      {"messages", asJson(name.findings)}};
  const char* separator = "    {\n      \"";
  for (const auto& [key, value] : fields) {
    out << separator << key << "\": " << indented(value.dump(2), "      ");
    separator = ",\n      \"";
  }
  out << "\n    }";
}

// Doubled quotes inside quotes, where the text needs them.
std::string csvField(const std::string& text) {
  if (text.find_first_of(",\"\r\n") == std::string::npos) return text;
  std::string quoted = "\"";
  for (const char c : text) quoted += c == '"' ? "\"\"" : std::string(1, c);
  return quoted + '"';
}

template <class Item>
std::vector<std::string> namesOf(const std::vector<const Item*>& items,
                                 std::string Item::*name) {
  std::vector<std::string> names;
  names.reserve(items.size());
  for (const Item* item : items) names.push_back(item->*name);
  return names;
}

void writeOrder(std::ostream& out, const char* what,
                const std::vector<std::string>& names) {
  if (names.empty()) return;
  out << '\n'
      << what << " in the order of their definition:\n  "
      << joined(names, "\n  ") << '\n';
}

}  // namespace

bool HX_RunResult::hasErrors() const {
  const auto hasError = [](const std::vector<HX_Finding>& all) {
    return std::any_of(all.begin(), all.end(), isError);
  };
  return hasError(findings) ||
         std::any_of(names.begin(), names.end(), [&](const HX_Name* name) {
           return hasError(name->findings);
         });
}

void HX_WriteTable(std::ostream& out, const HX_RunResult& result) {
  std::vector<Row> rows{
      {"name", "source", "template", "formal", "actual", "complete"}};
  for (const HX_Name* name : result.names)
    rows.push_back({name->id, shortPath(name->sourcePath),
                    orDash(name->nameTemplate), orDash(name->formal),
                    orDash(name->actual), name->isComplete ? "yes" : "no"});
  const std::vector<std::string> lines = aligned(rows);
  out << lines[0] << '\n' << std::string(widthOf(lines[0]), '-') << '\n';
  for (std::size_t i = 0; i < result.names.size(); ++i) {
    const HX_Name& name = *result.names[i];
    out << lines[i + 1] << '\n';
    if (!name.changes.empty())
      out << "    changed: " << joined(name.changes, ", ") << '\n';
    for (const HX_Finding& finding : name.findings)
      out << "    " << lineOf(finding, name.sourcePath) << '\n';
  }
  writeOrder(out, "Types", namesOf(result.types, &HX_TypeItem::name));
  writeOrder(out, "Variables", namesOf(result.variables, &HX_Name::actual));
  for (const HX_Finding& finding : result.findings)
    out << '\n' << lineOf(finding, "") << '\n';
}

void HX_WriteJson(std::ostream& out, const HX_RunResult& result) {
  out << "{\n  \"names\": [";
  const char* separator = "\n";
  for (const HX_Name* name : result.names) {
    out << separator;
    writeJson(out, *name);
    separator = ",\n";
  }
  const ordered_json rest{
      {"types", namesOf(result.types, &HX_TypeItem::name)},
      {"variables", namesOf(result.variables, &HX_Name::actual)},
      {"messages", asJson(result.findings)}};
  out << (result.names.empty() ? "]," : "\n  ],") << rest.dump(2).substr(1)
      << '\n';  // its brace is there already
}

void HX_WriteCsv(std::ostream& out, const HX_RunResult& result) {
  out << "id,template,formal,actual,changes,source\r\n";
  for (const HX_Name* name : result.names)
    out << csvField(name->id) << ',' << csvField(name->nameTemplate) << ','
        << csvField(name->formal) << ',' << csvField(name->actual) << ','
        << csvField(joined(name->changes, "; ")) << ','
        << csvField(name->sourcePath) << "\r\n";
}

void HX_WriteExplanation(std::ostream& out, const HX_Name& name,
                         const std::vector<HX_ExplainedMacro>& steps) {
  out << "name      " << name.id << "\ntemplate  " << orDash(name.nameTemplate)
      << "\nsource    " << orDash(name.sourcePath) << "\n\n";
  std::vector<Row> rows{{"macro", "gives", "which is"}};
  for (const HX_ExplainedMacro& step : steps)
    rows.push_back({step.macro, orDash(step.value), step.origin});
  for (const std::string& line : aligned(rows)) out << "  " << line << '\n';
  out << "\nformal    " << orDash(name.formal) << "\nactual    "
      << orDash(name.actual) << '\n';
  for (const std::string& change : name.changes)
    out << "changed   " << change << '\n';
  out << "complete  " << (name.isComplete ? "yes" : "no") << '\n';
  for (const HX_Finding& finding : name.findings)
    out << lineOf(finding, "") << '\n';
}

void HX_WriteFindings(std::ostream& out, const HX_RunResult& result) {
  for (const HX_Name* name : result.names) {
    for (const HX_Finding& finding : name->findings)
      out << name->id << ": " << lineOf(finding, "") << '\n';
  }
  for (const HX_Finding& finding : result.findings)
    out << lineOf(finding, "") << '\n';
}
