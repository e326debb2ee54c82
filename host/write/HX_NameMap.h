// The name map: formed names for programs, as JSON and CSV.

#ifndef HOST_WRITE_HX_NAMEMAP_H
#define HOST_WRITE_HX_NAMEMAP_H

#include <iosfwd>

#include "host/base/HX_Progress.h"
#include "host/names/HX_FormedName.h"

// Both write name by name: a large map never stands in memory as a whole.

void HX_WriteJson(std::ostream& out, const HX_RunResult& result);
/// The same JSON, and CSV with one line per name (RFC 4180): id, template,
/// formal, actual, changes, source.
void HX_WriteNameMap(std::ostream& json, std::ostream& csv,
                     const HX_RunResult& result, HX_Progress& progress);

#endif  // HOST_WRITE_HX_NAMEMAP_H
