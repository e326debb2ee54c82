// Counters and clocks of the debug server, and their names in reports.
//
//   HxCDebugElements::getClockComment(eClockEvalMlExpr);
//   // "method HX_MlExprEvaluator::evalMlExpr"

#ifndef DIAGNOSTICS_HXCDEBUGELEMENTS_H
#define DIAGNOSTICS_HXCDEBUGELEMENTS_H

#include "HX_Export.h"

/// Counters. Common counters are free for debugging; the last counter counts
/// evaluated MATLAB expressions.
enum ScEDebugCounter : int {
  eCounterCommon1 = 0,
  eCounterCommon2 = 1,
  eCounterCommon3 = 2,
  eCounterCommon4 = 3,
  eCounterCommon5 = 4,
  eCounterCommon6 = 5,
  eCounterCommon7 = 6,
  eCounterCommon8 = 7,
  eCounterCommon9 = 8,
  eCounterEvalMlExpr = 9
};
/// Number of counters.
inline constexpr int kDebugCounters = 10;

/// Clocks. Common clocks are free for debugging; the last clock measures the
/// evaluation of MATLAB expressions.
enum ScEDebugClock : int {
  eClockCommon1 = 0,
  eClockCommon2 = 1,
  eClockCommon3 = 2,
  eClockCommon4 = 3,
  eClockCommon5 = 4,
  eClockCommon6 = 5,
  eClockCommon7 = 6,
  eClockCommon8 = 7,
  eClockCommon9 = 8,
  eClockCommon10 = 9,
  eClockCommon11 = 10,
  eClockCommon12 = 11,
  eClockCommon13 = 12,
  eClockCommon14 = 13,
  eClockCommon15 = 14,
  eClockCommon16 = 15,
  eClockCommon17 = 16,
  eClockCommon18 = 17,
  eClockCommon19 = 18,
  eClockCommon20 = 19,
  eClockEvalMlExpr = 20
};
/// Number of clocks.
inline constexpr int kDebugClocks = 21;

/// Names in reports. The texts are constant, empty for a value outside the
/// enumeration.
class HX_UTILS_API HxCDebugElements {
 public:
  /// RETURNS: the name of the counter, or of the clock.
  static const char* getCounterComment(ScEDebugCounter counter);
  static const char* getClockComment(ScEDebugClock clock);
};

#endif  // DIAGNOSTICS_HXCDEBUGELEMENTS_H
