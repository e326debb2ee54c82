// The messages of a run: chosen, gathered by cause, and written as text, JSON
// or SARIF.
//
//   HX_DiagnosticLog log;
//   log.format = HX_DiagnosticLog::eSarif;
//   log.silenced = {412};
//   log.choose(result);              // before the result decides anything
//   log.add(result);
//   log.write(std::cerr, exitCode);

#ifndef HOST_WRITE_HX_DIAGNOSTICLOG_H
#define HOST_WRITE_HX_DIAGNOSTICLOG_H

#include <iosfwd>
#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "host/base/HX_System.h"
#include "host/messages/HX_Diagnostic.h"
#include "host/names/HX_FormedName.h"

/// Messages with equal number, severity and text have one cause: the log keeps
/// the first place and counts further places. A fault of a text file is a
/// message of its own.
class HX_DiagnosticLog {
 public:
  enum HxEFormatTag { eText, eJson, eSarif };

  HxEFormatTag format = eText;
  bool warningsAreErrors = false;
  std::set<int> silenced;  ///< numbers of warnings and notes to leave out
  std::string model;       ///< the file that messages without a file are about

  /// Leaves silenced findings out and makes errors of the remaining warnings.
  /// Further calls change nothing. Errors cannot be silenced.
  void choose(HX_RunResult& result) const;

  /// Adds the findings of all names, then the findings about no name.
  /// REQUIRES: choose() was called for \p result.
  void add(const HX_RunResult& result);
  /// Adds a message that no result holds, with the same choice.
  /// RETURNS: whether the message is an error now.
  bool add(HX_Diagnostic diagnostic);

  /// The number of causes.
  std::size_t size() const { return m_Entries.size(); }

  /// Text: a line per cause, wrapped for a terminal. JSON: an object with the
  /// list "diagnostics". SARIF: version 2.1.0, a run with rules and results.
  /// JSON and SARIF are written without messages too.
  void write(std::ostream& out, int exitCode,
             const HX_Terminal& terminal) const;

  struct Entry {
    HX_Diagnostic first;
    int further = 0;
  };

 private:
  using Cause = std::pair<std::pair<int, int>, std::string>;

  bool isSilenced(int number, int severity) const;
  int chosenSeverity(int severity) const;
  void writeText(std::ostream& out, const HX_Terminal& terminal) const;
  void writeJson(std::ostream& out, int exitCode) const;

  std::vector<Entry> m_Entries;
  std::map<Cause, std::size_t> m_Known;  // index of the entry
};

/// Writes SARIF 2.1.0. Rule ids are "HX" and the number.
/// \param model  file of messages without a file; may be empty
void HX_WriteSarif(std::ostream& out,
                   const std::vector<HX_DiagnosticLog::Entry>& entries,
                   const std::string& model, int exitCode);

#endif  // HOST_WRITE_HX_DIAGNOSTICLOG_H
