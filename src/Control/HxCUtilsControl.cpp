#include "Control/HxCUtilsControl.h"

#include "platform/strings/KyCXString.h"

HxCUtilsControl::~HxCUtilsControl() = default;

bool HxCUtilsControl::boot() {
  static_cast<void>(KyCXString().cstring());
  return true;
}

bool HxCUtilsControl::shutdown() { return true; }
