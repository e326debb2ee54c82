// Sets of names that the program compares: a document, a model file, a lock or
// a name map of an older run.
//
//   HX_NameDiff diff;
//   HX_AddNames(diff, HX_NameDiff::eOld, "names.lock", arguments);

#ifndef HOST_PROGRAM_HX_NAMESETS_H
#define HOST_PROGRAM_HX_NAMESETS_H

#include <string>

#include "SafeNames/HX_NameDiff.h"
#include "host/names/HX_FormedName.h"
#include "host/program/HX_Commands.h"

/// Adds the names of \p file to one side. A document is run through the
/// generator, so no other run may be alive.
/// Throws HX_InputError, and std::bad_alloc without memory.
void HX_AddNames(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
                 const std::string& file, const HX_Arguments& arguments);

/// Adds the names of a run to one side.
void HX_AddFormedNames(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
                       const HX_RunResult& result);

/// Why the item of \p row is renamed, for example "template $B -> $S_$B"; empty
/// where the facts do not tell.
std::string HX_ReasonOf(const HX_NameDiff::Row& row);

#endif  // HOST_PROGRAM_HX_NAMESETS_H
