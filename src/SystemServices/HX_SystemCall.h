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

  /// Seconds between two time stamps, negative if \p later is the earlier.
  double getDeltaTimeInSec(double earlier, double later);

  /// The local date as year-month-day (ISO 8601), for example "2007-03-14".
  /// \return a new text, owned by the caller
  KyCXString* getStandardDateString();

  /// The local time of day on the 24-hour clock, for example "09:05:07".
  /// \return a new text, owned by the caller
  KyCXString* getStandardTimeString();

  /// Sets the priority level (see platform/os/HX_OsThread.h) of the calling
  /// thread. \return true if the system accepted it
  bool setCurrentThreadPriority(int priority);

  /// Sets the calling thread to the lowest normal priority, -2.
  /// \param[out] previous  the level until now; 0 on failure
  /// \return false if the system gives no handle of the thread
  bool setLowestThreadPriorityToCurrentThread(int& previous);

  /// Replaces the text up to and including the first reference %NAME% by the
  /// value of the environment variable NAME. What stood before the reference is
  /// lost, what follows it is kept: "a%X%b%Y%" gives the value of X and "b%Y%".
  ///
  /// A text without a complete reference, or with one to a variable that is not
  /// defined, stays as it is.
  /// \return true
  bool substituteEnvVariable(KyCXString& text);
};

#endif  // SYSTEMSERVICES_HX_SYSTEMCALL_H
