// Values of the MATLAB workspace: texts, double scalars and structure arrays.
//
//   mxArray* speed = mxCreateScalarDouble(6.0);
//   mxArray* info = mxCreateStructMatrix(1, 1, {"Version"});
//   mxSetField(info, 0, "Version", mxCreateString("6.1"));
//   ...
//   mxDestroyArray(info);   // and the texts inside
//   mxDestroyArray(speed);

#ifndef PLATFORM_MATLAB_HX_MXARRAY_H
#define PLATFORM_MATLAB_HX_MXARRAY_H

#include <initializer_list>

#include "platform/HX_PlatformExport.h"

/// A value; created and destroyed only through the functions below.
class mxArray;

/// A text of ISO-8859-1; null gives an empty text. Owned by the caller.
HX_PLATFORM_API mxArray* mxCreateString(const char* text);

/// A 1-by-1 double. Owned by the caller.
HX_PLATFORM_API mxArray* mxCreateScalarDouble(double value);

/// A structure array of rows * columns elements with the fields \p names, all
/// without a value. Owned by the caller.
HX_PLATFORM_API mxArray* mxCreateStructMatrix(
    int rows, int columns, std::initializer_list<const char*> names);

/// Destroys \p array with the values of its fields; null is ignored.
HX_PLATFORM_API void mxDestroyArray(mxArray* array);

/// False for null, like the next two.
HX_PLATFORM_API bool mxIsChar(const mxArray* array);
HX_PLATFORM_API bool mxIsDouble(const mxArray* array);
HX_PLATFORM_API bool mxIsStruct(const mxArray* array);

/// The value of a double scalar, NaN for every other array.
HX_PLATFORM_API double mxGetScalar(const mxArray* array);

/// The characters of a text, zero-terminated and owned by \p array; null for
/// every other array.
HX_PLATFORM_API const char* mxGetText(const mxArray* array);

/// The value of a field of element \p index (from 0), owned by \p array. Null
/// if \p array is not a structure array, has no such element or field, or the
/// field has no value.
HX_PLATFORM_API mxArray* mxGetField(const mxArray* array, int index,
                                    const char* name);

/// Gives \p value, which may be null, to the structure array as the value of a
/// field; the value that was there is destroyed. Where the structure array has
/// no such element or field, \p value is destroyed.
HX_PLATFORM_API void mxSetField(mxArray* array, int index, const char* name,
                                mxArray* value);

/// The number of arrays that were created and not yet destroyed.
HX_PLATFORM_API int HX_LiveMxArrays();

#endif  // PLATFORM_MATLAB_HX_MXARRAY_H
