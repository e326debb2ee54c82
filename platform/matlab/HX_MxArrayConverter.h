// Converts values of the MATLAB workspace to values of the generator.

#ifndef PLATFORM_MATLAB_HX_MXARRAYCONVERTER_H
#define PLATFORM_MATLAB_HX_MXARRAYCONVERTER_H

#include "platform/HX_PlatformExport.h"
#include "platform/matlab/HX_MxArray.h"

class KyCXString;

/// Holds no data.
/// RETURNS: false, with the value unchanged, for an array of a different kind
/// and for null.
class HX_PLATFORM_API HX_MxArrayConverter {
 public:
  /// The characters of a text array.
  bool mxArrayToString(const mxArray* array, KyCXString& text) const;
  /// The number in an array of double.
  bool mxArrayToDouble(const mxArray* array, double& value) const;
};

#endif  // PLATFORM_MATLAB_HX_MXARRAYCONVERTER_H
