// A host may declare mxArray as a typedef. The headers of the library take the
// name from platform/matlab/HX_MxArray.h, replaced here, and declare no class.
#define PLATFORM_MATLAB_HX_MXARRAY_H
using mxArray = struct HX_HostArray;

#include "SourceRef/HxCInputBlockSrcRef.h"
