// Shows formed names and findings to people.

#ifndef HOST_WRITE_HX_NAMETABLE_H
#define HOST_WRITE_HX_NAMETABLE_H

#include <iosfwd>
#include <string>
#include <vector>

#include "host/base/HX_Progress.h"
#include "host/names/HX_FormedName.h"
#include "host/names/HX_NameForming.h"

/// A table of names with their findings, then types and variables in the order
/// of definition.
/// \param columns  see HX_NameColumns()
/// \param width    of the terminal: long texts lose their beginnings; 0 for
///                 lines of any length
void HX_WriteTable(std::ostream& out, const HX_RunResult& result,
                   const std::vector<std::string>& columns, int width,
                   HX_Progress& progress);

/// The macros of the template, then the steps from the expanded template to the
/// name, conflicts with '!'.
void HX_WriteExplanation(std::ostream& out, const HX_FormedName& name,
                         const std::vector<HX_ExplainedMacro>& macros,
                         const std::vector<HX_ExplainedStep>& steps);
void HX_WriteExplanationJson(std::ostream& out, const HX_FormedName& name,
                             const std::vector<HX_ExplainedMacro>& macros,
                             const std::vector<HX_ExplainedStep>& steps);

#endif  // HOST_WRITE_HX_NAMETABLE_H
