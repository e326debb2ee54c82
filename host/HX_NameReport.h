// Shows formed names: as a table for people, as JSON and CSV for programs.

#ifndef HOST_HX_NAMEREPORT_H
#define HOST_HX_NAMEREPORT_H

#include <iosfwd>
#include <string>
#include <vector>

#include "host/HX_NameRun.h"
#include "host/HX_Ordering.h"

/// What a run found; UTF-8 throughout.
struct HX_RunResult {
  std::vector<HX_FormedName> names;
  std::vector<const HX_TypeItem*> types;        // ordered
  std::vector<const HX_FormedName*> variables;  // ordered
  std::vector<HX_Finding> findings;  // of the whole run, not of one name

  /// Whether any finding is an error.
  bool hasErrors() const;
};

/// A table of names with their findings below each, then the orders.
std::string HX_NamesAsTable(const HX_RunResult& result);
/// Name by name, so that a large map never stands in memory as a whole.
void HX_WriteNamesAsJson(std::ostream& out, const HX_RunResult& result);
/// One line per name by id (RFC 4180): id, template, formal, actual, changes,
/// source.
void HX_WriteNamesAsCsv(std::ostream& out, const HX_RunResult& result);

/// Macro by macro, then what happened to the expanded name.
std::string HX_ExplanationAsText(const HX_FormedName& name,
                                 const std::vector<HX_ExplainedMacro>& steps);

/// "error   17056  C keyword int used as identifier.  [path]" and a line feed.
std::string HX_FindingAsLine(const HX_Finding& finding);

#endif  // HOST_HX_NAMEREPORT_H
