// Boots and shuts down the library.
//
//   HxCUtilsControl control;
//   control.boot();
//   HxCNames::boot();            // each server that the host uses
//   ...
//   HxCNames::shutdown();
//   control.shutdown();

#ifndef CONTROL_HXCUTILSCONTROL_H
#define CONTROL_HXCUTILSCONTROL_H

#include "Control/HxCControl.h"
#include "HX_Export.h"

/// Created by the host. Boots no server: each has its own boot and shutdown.
class HX_UTILS_API HxCUtilsControl : public HxCControl {
 public:
  HxCUtilsControl() = default;
  HxCUtilsControl(const HxCUtilsControl&) = default;
  HxCUtilsControl& operator=(const HxCUtilsControl&) = default;
  ~HxCUtilsControl() override;

  /// Touches the string library once. \return true
  bool boot();
  /// \return true
  bool shutdown();
};

#endif  // CONTROL_HXCUTILSCONTROL_H
