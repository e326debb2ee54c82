// Reads the process clock and reports elapsed times.
//
//   HxCTimeStamp clock;
//   const double start = clock.getTimeStamp();
//   ...
//   KyCXString label("Reading the model");
//   clock.emitElapsedTime(start, label);   // note 2

#ifndef CONTROL_HXCTIMESTAMP_H
#define CONTROL_HXCTIMESTAMP_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class KyCXString;

/// Class without data.
class HX_UTILS_API HxCTimeStamp : public HX_Allocated {
 public:
  HxCTimeStamp() = default;
  HxCTimeStamp(const HxCTimeStamp&) = default;
  HxCTimeStamp& operator=(const HxCTimeStamp&) = default;
  virtual ~HxCTimeStamp();

  /// Milliseconds of the process clock.
  double getTimeStamp() const;

  /// Emits message 2 (note): \p label in a column of 30 characters, and the
  /// seconds from \p start to now.
  /// \param start  milliseconds of the process clock, as of getTimeStamp()
  /// \return true
  bool emitElapsedTime(double start, KyCXString& label);
};

#endif  // CONTROL_HXCTIMESTAMP_H
