#include "host/write/HX_DiagnosticLog.h"

#include <algorithm>
#include <ostream>

#include "host/base/HX_JsonWriter.h"
#include "host/base/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

constexpr int kWarning = 1;
constexpr int kSeverities = 4;  // and as many internal severities

std::string padded(std::string text, std::size_t width) {
  if (text.size() < width) text.resize(width, ' ');
  return text;
}

// Messages about the run have no place in the model.
bool isAboutRun(int number) {
  return HX_FindMessage(number) != nullptr && (number < 300 || number >= 600);
}

std::string severityOf(const HX_Diagnostic& diagnostic,
                       const HX_Terminal& terminal) {
  const std::string word = HX_MessageHandler::severityName(diagnostic.severity);
  constexpr const char* kColors[] = {"36", "33", "31", "31"};
  if (!terminal.hasColors) return padded(word, 8);
  return "\x1B[1;" + std::string(kColors[diagnostic.severity % kSeverities]) +
         "m" + word + "\x1B[0m" +
         std::string(padded(word, 8).substr(word.size()));
}

std::string headOf(const HX_Diagnostic& diagnostic,
                   const HX_Terminal& terminal) {
  return (diagnostic.item.empty() ? "" : diagnostic.item + ": ") +
         severityOf(diagnostic, terminal) +
         padded(std::to_string(diagnostic.number), 7);
}

std::string lineOf(const HX_DiagnosticLog::Entry& entry,
                   const HX_Terminal& terminal) {
  HX_Diagnostic first = entry.first;
  for (std::string* text : {&first.text, &first.item, &first.source})
    *text = HX_Visible(*text);
  const std::string number = " [" + std::to_string(first.number) + "]";
  std::string line;
  if (first.number == kHxMoreFaults)
    line = HX_PlaceOf(first) + first.text;
  else if (!first.file.empty())
    line = HX_PlaceOf(first) + first.text + number;
  else if (isAboutRun(first.number))
    line = "hx_codegen: " + first.text + number;
  else
    line = headOf(first, terminal) + first.text +
           (first.source.empty() ? "" : "  [" + first.source + "]");
  if (entry.further > 0)
    line += "  (and " + std::to_string(entry.further) + " more)";
  return line;
}

// Breaks at blanks; a word that is longer than the line stays whole.
void writeWrapped(std::ostream& out, const std::string& line, int width) {
  const auto most = static_cast<std::size_t>(width);
  std::size_t begin = 0;
  std::string indent;
  while (width > 0 && HX_WidthOf(line.substr(begin)) + indent.size() > most) {
    std::size_t end = std::min(begin + most - indent.size(), line.size());
    const std::size_t blank = line.rfind(' ', end);
    if (blank == line.npos || blank <= begin) {
      end = line.find(' ', end);
      if (end == line.npos) break;
    } else {
      end = blank;
    }
    out << indent << line.substr(begin, end - begin) << '\n';
    begin = line.find_first_not_of(' ', end);
    if (begin == line.npos) return;
    indent = "    ";
  }
  out << indent << line.substr(begin) << '\n';
}

}  // namespace

bool HX_DiagnosticLog::isSilenced(int number, int severity) const {
  return severity % kSeverities <= kWarning && silenced.count(number) > 0;
}

int HX_DiagnosticLog::chosenSeverity(int severity) const {
  const bool isRaised = warningsAreErrors && severity % kSeverities == kWarning;
  return isRaised ? severity + 1 : severity;
}

void HX_DiagnosticLog::choose(HX_RunResult& result) const {
  const auto chooseAmong = [this](std::vector<HX_Finding>& findings) {
    std::erase_if(findings, [this](const HX_Finding& finding) {
      return isSilenced(finding.id, finding.severity);
    });
    for (HX_Finding& finding : findings)
      finding.severity = chosenSeverity(finding.severity);
  };
  for (HX_FormedName& name : result.formed) chooseAmong(name.findings);
  chooseAmong(result.findings);
}

void HX_DiagnosticLog::add(const HX_RunResult& result) {
  const auto addAll = [this](const std::vector<HX_Finding>& findings,
                             const std::string& item) {
    for (const HX_Finding& finding : findings)
      add({finding.id, finding.severity, finding.text, item, finding.source});
  };
  // In the order of the document, whatever is shown.
  for (const HX_FormedName& name : result.formed)
    addAll(name.findings, name.wanted->id);
  addAll(result.findings, "");
}

bool HX_DiagnosticLog::add(HX_Diagnostic diagnostic) {
  if (isSilenced(diagnostic.number, diagnostic.severity)) return false;
  diagnostic.severity = chosenSeverity(diagnostic.severity);
  const bool isError = diagnostic.isError();
  if (diagnostic.file.empty()) {
    const Cause cause{{diagnostic.number, diagnostic.severity},
                      diagnostic.text};
    const auto [known, isNew] = m_Known.try_emplace(cause, m_Entries.size());
    if (!isNew) {
      ++m_Entries[known->second].further;
      return isError;
    }
  }
  m_Entries.push_back({std::move(diagnostic)});
  return isError;
}

void HX_DiagnosticLog::write(std::ostream& out, int exitCode,
                             const HX_Terminal& terminal) const {
  switch (format) {
    case eText:
      return writeText(out, terminal);
    case eJson:
      return writeJson(out, exitCode);
    case eSarif:
      return HX_WriteSarif(out, m_Entries, model, exitCode);
  }
}

void HX_DiagnosticLog::writeText(std::ostream& out,
                                 const HX_Terminal& terminal) const {
  for (const Entry& entry : m_Entries)
    writeWrapped(out, lineOf(entry, terminal), terminal.width);
}

void HX_DiagnosticLog::writeJson(std::ostream& out, int exitCode) const {
  HX_JsonWriter json(out, 2);
  json.open('{');
  json.rawField("exitCode", std::to_string(exitCode));
  json.key("diagnostics");
  json.open('[');
  for (const Entry& entry : m_Entries) {
    const HX_Diagnostic& first = entry.first;
    json.next();
    json.open('{');
    json.rawField("number", std::to_string(first.number));
    json.field("severity", HX_MessageHandler::severityName(first.severity));
    json.field("text", first.text);
    if (!first.item.empty()) json.field("item", first.item);
    if (!first.source.empty()) json.field("source", first.source);
    if (!first.file.empty()) json.field("file", first.file);
    if (first.line > 0) json.rawField("line", std::to_string(first.line));
    if (first.column > 0) json.rawField("column", std::to_string(first.column));
    json.rawField("further", std::to_string(entry.further));
    json.close('}');
  }
  json.close(']');
  json.close('}');
  json.end();
}
