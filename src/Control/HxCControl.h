// Switches of the process, and profiling timers that nest.
//
//   HxCControl::setProfiling(1.0);
//   HxCControl control;
//   control.startTimer();
//   ...
//   KyCXString label("Optimisation");
//   control.stopTimeAndEmitMessage(label);   // note 2: "Optimisation  in ..."

#ifndef CONTROL_HXCCONTROL_H
#define CONTROL_HXCCONTROL_H

#include "Control/HX_Allocated.h"
#include "Control/HxCTimeStamp.h"
#include "HX_Export.h"
#include "platform/containers/stack.h"

class KyCXString;

/// The switches belong to the process and are off at load. A change takes
/// effect with the next call that reads the switch.
/// Copying copies the running timers. If memory runs out, a copy has no timers
/// and an assignment changes nothing.
class HX_UTILS_API HxCControl : public HX_Allocated {
 public:
  HxCControl() = default;
  HxCControl(const HxCControl& other);
  HxCControl& operator=(const HxCControl& other);
  virtual ~HxCControl();

  /// Starts a timer of this object while profiling is on. If memory runs out,
  /// no timer starts, and the next stop ends the timer before.
  void startTimer();

  /// Ends the latest timer of this object and reports the time as message 2.
  ///
  /// While profiling is off nothing happens and the timer keeps running. If no
  /// timer runs, the time counts from one millisecond before the origin of the
  /// process clock.
  virtual void stopTimeAndEmitMessage(KyCXString& label);

  /// Reports an early exit through HxCTraceFallThrough::throwError() while the
  /// fall-through switch is on. The switch of the tracer must be on as well.
  /// \return false, so that a caller can return the result
  bool traceFallThrough();
  bool traceFallThrough(const KyCXString& file, int line);
  bool traceFallThrough(const KyCXString& file, int line,
                        const KyCXString& reason);

  /// True while no error was reported (error status below 2).
  bool checkErrorLevel();

  /// On for every value but 0.0 and NaN.
  static void setProfiling(double value);
  static void setFallThrough(double value);
  /// Both switches on.
  static void setDevelopBehaviour();
  /// Both switches off.
  static void setProductionCodeBehaviour();

 private:
  static void reinit();

  static bool s_ProfilingOn;
  static bool s_TraceFallThrough;

  HxCTimeStamp m_TimeStamp;
  leda::stack<double> m_Timers;  // start times, milliseconds
};

#endif  // CONTROL_HXCCONTROL_H
