// Writes a report of a run as one HTML page that opens from disk.
//
//   HX_ReportInput input{model, result, explain, runs, "hx_codegen 1.0.0"};
//   HX_WriteReport(file, input);
//
// The page is host/report/report_page.html with the data of the run in place of
// a comment; host/report/page/data.js describes the data.

#ifndef HOST_WRITE_HX_REPORT_H
#define HOST_WRITE_HX_REPORT_H

#include <functional>
#include <iosfwd>
#include <map>
#include <string>
#include <vector>

#include "host/model/HX_Model.h"
#include "host/names/HX_FormedName.h"
#include "host/names/HX_NameForming.h"
#include "host/write/HX_TimedRun.h"

/// The name of an item in an older run, and why the name differs.
struct HX_OlderName {
  std::string name;
  std::string reason;
};

struct HX_ReportInput {
  const HX_Model& model;
  const HX_RunResult& result;
  /// The macros of one name; called once per name.
  std::function<std::vector<HX_ExplainedMacro>(const HX_WantedName&)> explain;
  const std::vector<HX_TimedRun>& runs;
  std::string program;  ///< name and version
  std::string since;    ///< the older run; empty for none
  std::map<std::string, HX_OlderName> renamed;  ///< by id
};

/// Texts of the model appear as data only, never as HTML.
/// COST: linear in the number of names, beside the expansions of `explain`.
void HX_WriteReport(std::ostream& out, const HX_ReportInput& input);

#endif  // HOST_WRITE_HX_REPORT_H
