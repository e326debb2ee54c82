// Values of the MATLAB workspace, as far as the library makes them.
//
//   mxArray* speed = mxCreateScalarDouble(6.0);
//   mxArray* path = mxCreateString("cruise/Gain 1");
//   ...
//   mxDestroyArray(path);
//   mxDestroyArray(speed);
//
// A host's own header may declare mxArray as a class, a struct or a typedef.
// What the stand-in can do with arrays beyond that: HX_MxContent.h.

#ifndef PLATFORM_MATLAB_HX_MXARRAY_H
#define PLATFORM_MATLAB_HX_MXARRAY_H

#include "platform/HX_PlatformExport.h"

/// A value; created and destroyed only through functions.
class mxArray;

/// A text of ISO-8859-1; null gives an empty text.
/// OWNERSHIP: the caller's.
HX_PLATFORM_API mxArray* mxCreateString(const char* text);

/// A 1-by-1 double.
/// OWNERSHIP: the caller's.
HX_PLATFORM_API mxArray* mxCreateScalarDouble(double value);

/// Destroys \p array with the values of its fields; null is ignored.
HX_PLATFORM_API void mxDestroyArray(mxArray* array);

#endif  // PLATFORM_MATLAB_HX_MXARRAY_H
