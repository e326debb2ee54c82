// The name map of a run: where each name comes from, how the name came about,
// and where the code declares the name. An interface for other programs.
//
//   HX_WriteNameMap(json, csv, model, result, false, progress);
//
// host/name_map.schema.json describes both forms of JSON, docs/name-map.md the
// fields.

#ifndef HOST_WRITE_HX_NAMEMAP_H
#define HOST_WRITE_HX_NAMEMAP_H

#include <iosfwd>

#include "host/base/HX_Progress.h"
#include "host/model/HX_Model.h"
#include "host/names/HX_FormedName.h"

/// Grows when a field goes or changes its meaning; new fields leave the
/// version.
inline constexpr int kHxNameMapVersion = 1;

// Both write name by name: a large map never stands in memory as a whole.

/// \param asLines  a JSON document per line: head, names, end
void HX_WriteJson(std::ostream& out, const HX_Model& model,
                  const HX_RunResult& result, bool asLines);
/// The same JSON, and CSV with one line per name (RFC 4180), for people.
void HX_WriteNameMap(std::ostream& json, std::ostream& csv,
                     const HX_Model& model, const HX_RunResult& result,
                     bool asLines, HX_Progress& progress);

#endif  // HOST_WRITE_HX_NAMEMAP_H
