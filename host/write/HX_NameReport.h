// Shows formed names: as a table for people, as JSON and CSV for programs.

#ifndef HOST_WRITE_HX_NAMEREPORT_H
#define HOST_WRITE_HX_NAMEREPORT_H

#include <iosfwd>
#include <string>
#include <vector>

#include "host/names/HX_NameRun.h"

/// What a run found; UTF-8 throughout.
struct HX_RunResult {
  std::vector<const HX_Name*> names;      // in the order of the report
  std::vector<const HX_TypeItem*> types;  // ordered, as below
  std::vector<const HX_Name*> variables;
  std::vector<HX_Finding> findings;  // of the whole run, not of one name

  /// Whether any finding is an error.
  bool hasErrors() const;
};

/// A table of names with their findings below each, then the orders.
void HX_WriteTable(std::ostream& out, const HX_RunResult& result);
/// Name by name, so that a large map never stands in memory as a whole.
void HX_WriteJson(std::ostream& out, const HX_RunResult& result);
/// One line per name (RFC 4180): id, template, formal, actual, changes, source.
void HX_WriteCsv(std::ostream& out, const HX_RunResult& result);

/// Macro by macro, then what happened to the expanded name.
void HX_WriteExplanation(std::ostream& out, const HX_Name& name,
                         const std::vector<HX_ExplainedMacro>& steps);

/// Every finding on a line of its own, those of names after their ids.
void HX_WriteFindings(std::ostream& out, const HX_RunResult& result);

#endif  // HOST_WRITE_HX_NAMEREPORT_H
