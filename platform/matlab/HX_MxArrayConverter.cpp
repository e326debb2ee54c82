#include "platform/matlab/HX_MxArrayConverter.h"

#include "platform/matlab/HX_MxContent.h"
#include "platform/strings/KyCXString.h"

bool HX_MxArrayConverter::mxArrayToString(const mxArray* array,
                                          KyCXString& text) const {
  const KyCXString* found = mxGetText(array);
  if (found == nullptr) return false;
  text = *found;
  return true;
}

bool HX_MxArrayConverter::mxArrayToDouble(const mxArray* array,
                                          double& value) const {
  if (!mxIsDouble(array)) return false;
  value = mxGetScalar(array);
  return true;
}
