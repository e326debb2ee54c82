// The name map: formed names for programs, as JSON and CSV.

#ifndef HOST_WRITE_HX_NAMEMAP_H
#define HOST_WRITE_HX_NAMEMAP_H

#include <iosfwd>

#include "host/names/HX_FormedName.h"

/// Writes name by name: a large map never stands in memory as a whole.
void HX_WriteJson(std::ostream& out, const HX_RunResult& result);
/// One line per name (RFC 4180): id, template, formal, actual, changes, source.
void HX_WriteCsv(std::ostream& out, const HX_RunResult& result);

#endif  // HOST_WRITE_HX_NAMEMAP_H
