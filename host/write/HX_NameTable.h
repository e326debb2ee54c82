// Shows formed names and findings to people.

#ifndef HOST_WRITE_HX_NAMETABLE_H
#define HOST_WRITE_HX_NAMETABLE_H

#include <iosfwd>
#include <vector>

#include "host/base/HX_Progress.h"
#include "host/names/HX_FormedName.h"
#include "host/names/HX_NameForming.h"

/// A table of names with their findings, then types and variables in the order
/// of definition.
void HX_WriteTable(std::ostream& out, const HX_RunResult& result,
                   HX_Progress& progress);

/// The macros of the template, then the changes of the expanded name.
void HX_WriteExplanation(std::ostream& out, const HX_FormedName& name,
                         const std::vector<HX_ExplainedMacro>& steps);

/// One line per finding; findings of a name begin with the id of the name.
void HX_WriteFindings(std::ostream& out, const HX_RunResult& result);

#endif  // HOST_WRITE_HX_NAMETABLE_H
