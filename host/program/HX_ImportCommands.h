// The commands that read model files.

#ifndef HOST_PROGRAM_HX_IMPORTCOMMANDS_H
#define HOST_PROGRAM_HX_IMPORTCOMMANDS_H

#include "host/program/HX_Commands.h"

// Both throw std::runtime_error, also in a build without the import.

/// Prints the model document of a model file, notes on the error output.
HX_ExitCode HX_ImportModelFile(const HX_Arguments& arguments);

/// Prints the built-in naming rules, or the schema of rules.
HX_ExitCode HX_PrintRules(const HX_Arguments& arguments);

#endif  // HOST_PROGRAM_HX_IMPORTCOMMANDS_H
