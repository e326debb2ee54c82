#include "platform/matlab/HX_MxArrayConverter.h"

#include "platform/strings/KyCXString.h"

bool HX_MxArrayConverter::mxArrayToString(const mxArray* array,
                                          KyCXString& text) const {
  const char* characters = mxGetText(array);
  if (characters == nullptr) return false;
  text = characters;
  return true;
}

bool HX_MxArrayConverter::mxArrayToDouble(const mxArray* array,
                                          double& value) const {
  if (!mxIsDouble(array)) return false;
  value = mxGetScalar(array);
  return true;
}
