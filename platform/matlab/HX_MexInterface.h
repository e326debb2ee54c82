// Calls into MATLAB: the command window and MATLAB functions.
//
// Without MATLAB a host answers the calls itself: HX_MatlabSession.h.

#ifndef PLATFORM_MATLAB_HX_MEXINTERFACE_H
#define PLATFORM_MATLAB_HX_MEXINTERFACE_H

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
/// RETURNS: the number of bytes printed; negative for a format that fails
/// and without memory.
HX_PLATFORM_API int mexPrintf(const char* format, ...) HX_PRINTF_LIKE(1, 2);

/// Calls the MATLAB function \p name. The \p outputs places of \p output are
/// set to null and then filled by the function.
/// RETURNS: 0 on success; not 0 if no such function exists or the function
/// failed.
/// OWNERSHIP: arrays in \p output belong to the caller, also after a failure.
HX_PLATFORM_API int MEXCallMATLAB(int outputs, mxArray** output, int inputs,
                                  mxArray** input, const char* name);

/// A new double scalar.
/// OWNERSHIP: the caller's.
HX_PLATFORM_API mxArray* MXCreateInitializedScalarMxArray(double value);

/// Destroys \p array; null is ignored.
HX_PLATFORM_API void MXDestroyArray(mxArray* array);

/// RETURNS: the value of a field of element \p index (from 0); null if the
/// structure array has no such field or the field has no value.
/// OWNERSHIP: the structure array's.
HX_PLATFORM_API mxArray* MXGetField(mxArray* array, int index,
                                    const char* name);

/// Copies the characters of a text array to \p text.
/// RETURNS: false, with \p text unchanged, if \p array holds no text.
HX_PLATFORM_API bool MXCopyMXArrayToString(const mxArray* array,
                                           KyCXString& text);

#endif  // PLATFORM_MATLAB_HX_MEXINTERFACE_H
