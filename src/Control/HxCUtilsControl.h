// Boots and shuts down the library.
//
//   HxCUtilsControl control;
//   control.boot();
//   HxCNames::boot();            // and the other servers of the host
//   ...
//   HxCNames::shutdown();
//   control.shutdown();

#ifndef CONTROL_HXCUTILSCONTROL_H
#define CONTROL_HXCUTILSCONTROL_H

#include "Control/HxCControl.h"
#include "HX_Export.h"

/// The host creates one object. Boots no server: a host boots and shuts down
/// every server through the operations of the server.
class HX_UTILS_API HxCUtilsControl : public HxCControl {
 public:
  HxCUtilsControl() = default;
  HxCUtilsControl(const HxCUtilsControl&) = default;
  HxCUtilsControl& operator=(const HxCUtilsControl&) = default;
  ~HxCUtilsControl() override;

  /// Calls the string class once: a string library missing at run time fails
  /// here. \return true
  bool boot();
  /// Does nothing. \return true
  bool shutdown();
};

#endif  // CONTROL_HXCUTILSCONTROL_H
