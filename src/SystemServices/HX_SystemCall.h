// Services of the operating system: clock, date, thread priority, environment.
//
//   HX_SystemCall system;
//   const double start = system.getTimeStamp();
//   ...
//   const double end = system.getTimeStamp();
//   const double seconds = system.getDeltaTimeInSec(start, end);

#ifndef SYSTEMSERVICES_HX_SYSTEMCALL_H
#define SYSTEMSERVICES_HX_SYSTEMCALL_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class KyCXString;

/// Holds no data; acts on the process and the calling thread.
class HX_UTILS_API HX_SystemCall : public HX_Allocated {
 public:
  HX_SystemCall() = default;

  /// Milliseconds of the process clock.
  double getTimeStamp() const;

  /// Seconds from \p earlier to \p later; negative if \p later comes first.
  double getDeltaTimeInSec(double earlier, double later);

  // Date and time ask for the time zone (TZ) in each call.
  // OWNERSHIP: the caller deletes the text. RETURNS: null without memory.

  /// The local date as year-month-day (ISO 8601), for example "2007-03-14".
  KyCXString* getStandardDateString();

  /// The local time of day on the 24-hour clock, for example "09:05:07".
  KyCXString* getStandardTimeString();

  // Linux lets ordinary users lower a priority, but not raise the priority
  // again (RLIMIT_NICE, capability CAP_SYS_NICE): in such a process the calling
  // thread keeps a lowered priority until the end.

  /// Sets the priority level (see platform/os/HX_OsThread.h) of the calling
  /// thread.
  /// RETURNS: true if the system accepted the level. Restoring a higher level
  /// without the right to do so gives false.
  bool setCurrentThreadPriority(int priority);

  /// Sets the calling thread to the lowest normal priority, -2.
  /// \param[out] previous  the level until now; 0 on failure
  /// RETURNS: false if the system gives no handle of the thread, otherwise
  /// true. A thread below -2 without the right to raise its level keeps the
  /// level.
  bool setLowestThreadPriorityToCurrentThread(int& previous);

  /// Replaces the text up to the end of the first reference %NAME% by the value
  /// of the environment variable NAME. Text before the reference is lost, text
  /// after the reference stays: "a%X%b%Y%" becomes the value of X and "b%Y%".
  ///
  /// A text without a complete reference stays, and a text whose first
  /// reference names an undefined variable.
  /// RETURNS: true; false without memory, and the text stays.
  bool substituteEnvVariable(KyCXString& text);
};

#endif  // SYSTEMSERVICES_HX_SYSTEMCALL_H
