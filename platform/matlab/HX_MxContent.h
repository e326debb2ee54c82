// Structure arrays, and the contents of arrays: for hosts and tests.
//
//   mxArray* info = mxCreateStructMatrix(1, 1, {"Version"});
//   mxSetField(info, 0, "Version", mxCreateString("6.1"));
//   ...
//   mxDestroyArray(info);   // and the text inside

#ifndef PLATFORM_MATLAB_HX_MXCONTENT_H
#define PLATFORM_MATLAB_HX_MXCONTENT_H

#include <initializer_list>

#include "platform/HX_PlatformExport.h"
#include "platform/matlab/HX_MxArray.h"

class KyCXString;

/// A text with all its 16-bit units.
/// OWNERSHIP: the caller's.
HX_PLATFORM_API mxArray* mxCreateText(const KyCXString& text);

/// A structure array of rows * columns elements with the fields \p names, all
/// without a value.
/// OWNERSHIP: the caller's.
HX_PLATFORM_API mxArray* mxCreateStructMatrix(
    int rows, int columns, std::initializer_list<const char*> names);

/// The kind of an array; false for null.
HX_PLATFORM_API bool mxIsChar(const mxArray* array);
HX_PLATFORM_API bool mxIsDouble(const mxArray* array);
HX_PLATFORM_API bool mxIsStruct(const mxArray* array);

/// RETURNS: the value of a double scalar, NaN for all other arrays.
HX_PLATFORM_API double mxGetScalar(const mxArray* array);

/// RETURNS: the text of a text array; null for all other arrays.
/// OWNERSHIP: the array's.
HX_PLATFORM_API const KyCXString* mxGetText(const mxArray* array);

/// RETURNS: the value of a field of element \p index (from 0). Null if \p array
/// is no structure array, has no such element or field, or the field has no
/// value.
/// OWNERSHIP: the structure array's.
HX_PLATFORM_API mxArray* mxGetField(const mxArray* array, int index,
                                    const char* name);

/// Gives \p value, which may be null, to the structure array as the value of a
/// field; destroys the former value. Where the structure array has no such
/// element or field, \p value is destroyed.
HX_PLATFORM_API void mxSetField(mxArray* array, int index, const char* name,
                                mxArray* value);

/// The number of arrays that were created and not yet destroyed.
HX_PLATFORM_API int HX_LiveMxArrays();

#endif  // PLATFORM_MATLAB_HX_MXCONTENT_H
