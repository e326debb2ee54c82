// The commands that read model files.

#ifndef HOST_PROGRAM_HX_IMPORTCOMMANDS_H
#define HOST_PROGRAM_HX_IMPORTCOMMANDS_H

#include "host/model/HX_Document.h"
#include "host/program/HX_Commands.h"
#include "host/program/HX_Profile.h"

// All throw std::runtime_error, for model files also in a build without the
// import.

/// The document in \p file. A model file is imported, with notes on the error
/// output. Paths count from the start of \p profile.
HX_Document HX_ReadDocument(const std::string& file,
                            const HX_Arguments& arguments, HX_Profile& profile);

/// Prints the model document of a model file, notes on the error output.
HX_ExitCode HX_ImportModelFile(const HX_Arguments& arguments);

/// Prints the built-in naming rules, or the schema of rules.
HX_ExitCode HX_PrintRules(const HX_Arguments& arguments);

#endif  // HOST_PROGRAM_HX_IMPORTCOMMANDS_H
