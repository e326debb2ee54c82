// A MATLAB session without MATLAB: a host registers the functions that the
// library calls, and receives the texts of the command window.
//
//   HX_RegisterMatlabFunction("hx_config", [](int outputs, mxArray** output,
//                                             int inputs, mxArray** input) {
//     if (outputs < 1 || inputs < 1) return 1;
//     output[0] = describe(mxGetScalar(input[0]));   // owned by the caller
//     return 0;
//   });

#ifndef PLATFORM_MATLAB_HX_MATLABSESSION_H
#define PLATFORM_MATLAB_HX_MATLABSESSION_H

#include <functional>

#include "platform/HX_PlatformExport.h"
#include "platform/matlab/HX_MxArray.h"

/// Receives each printed text; the text is valid during the call only.
using HX_CommandWindow = std::function<void(const char* text)>;

/// Makes \p window the command window. An empty \p window stands for the
/// standard output, the command window at start.
HX_PLATFORM_API void HX_SetCommandWindow(HX_CommandWindow window);

/// Fills \p output, whose places are null at the call, with at most \p outputs
/// arrays; reads \p inputs arrays.
/// RETURNS: 0 on success.
/// OWNERSHIP: the caller owns the outputs and keeps the inputs.
using HX_MatlabFunction = std::function<int(int outputs, mxArray** output,
                                            int inputs, mxArray** input)>;

/// Makes \p function the MATLAB function \p name, in place of an earlier one;
/// an empty \p function removes the earlier one.
HX_PLATFORM_API void HX_RegisterMatlabFunction(const char* name,
                                               HX_MatlabFunction function);

#endif  // PLATFORM_MATLAB_HX_MATLABSESSION_H
