// Which program this is.

#ifndef HOST_PROGRAM_HX_VERSION_H
#define HOST_PROGRAM_HX_VERSION_H

#include <string>

#include "SystemServices/HX_BuildNumber.h"

HX_BuildNumber HX_BuildOfProgram();

/// What hx_codegen --version prints: from the version resource, the build and
/// the product.
std::string HX_VersionText();

#endif  // HOST_PROGRAM_HX_VERSION_H
