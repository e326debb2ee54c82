// Calls into MATLAB: its command window and its functions.
//
// Without MATLAB a host registers the functions that the library calls:
//
//   HX_RegisterMatlabFunction("hx_config", [](int outputs, mxArray** output,
//                                             int inputs, mxArray** input) {
//     if (outputs < 1 || inputs < 1) return 1;
//     output[0] = describe(mxGetScalar(input[0]));   // owned by the caller
//     return 0;
//   });

#ifndef PLATFORM_MATLAB_HX_MEXINTERFACE_H
#define PLATFORM_MATLAB_HX_MEXINTERFACE_H

#include <functional>

#include "platform/HX_PlatformExport.h"
#include "platform/matlab/HX_MxArray.h"

class KyCXString;

#if defined(__GNUC__)
/// Lets the compiler check a printf format: the positions of the format and of
/// its first argument, counted from 1.
#define HX_PRINTF_LIKE(text, first) __attribute__((format(printf, text, first)))
#else
#define HX_PRINTF_LIKE(text, first)
#endif

/// Prints to the command window, formatted as by printf().
/// \return the number of bytes printed, negative for a format that fails
HX_PLATFORM_API int mexPrintf(const char* format, ...) HX_PRINTF_LIKE(1, 2);

/// Receives each printed text; it is valid during the call only.
using HX_CommandWindow = std::function<void(const char* text)>;

/// Makes \p window the command window; an empty one stands for the standard
/// output, which it is at start.
HX_PLATFORM_API void HX_SetCommandWindow(HX_CommandWindow window);

/// Fills \p output, whose places are null at the call, with at most \p outputs
/// arrays that the caller then owns; reads \p inputs arrays, which it does not
/// own. \return 0 on success
using HX_MatlabFunction = std::function<int(int outputs, mxArray** output,
                                            int inputs, mxArray** input)>;

/// Makes \p function the MATLAB function \p name, in place of an earlier one;
/// an empty \p function removes it.
HX_PLATFORM_API void HX_RegisterMatlabFunction(const char* name,
                                               HX_MatlabFunction function);

/// Calls the MATLAB function \p name. The \p outputs places of \p output are
/// set to null and then filled by the function; the caller owns what it finds
/// there, also after a failure.
/// \return 0 on success; not 0 if there is no such function or it failed
HX_PLATFORM_API int MEXCallMATLAB(int outputs, mxArray** output, int inputs,
                                  mxArray** input, const char* name);

/// A new double scalar, owned by the caller.
HX_PLATFORM_API mxArray* MXCreateInitializedScalarMxArray(double value);

/// Destroys \p array; null is ignored.
HX_PLATFORM_API void MXDestroyArray(mxArray* array);

/// The value of a field, owned by the structure array; null as mxGetField().
HX_PLATFORM_API mxArray* MXGetField(mxArray* array, int index,
                                    const char* name);

/// Copies the characters of a text array to \p text.
/// \return false, with \p text unchanged, if \p array holds no text
HX_PLATFORM_API bool MXCopyMXArrayToString(const mxArray* array,
                                           KyCXString& text);

#endif  // PLATFORM_MATLAB_HX_MEXINTERFACE_H
