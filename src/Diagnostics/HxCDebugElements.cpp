#include "Diagnostics/HxCDebugElements.h"

namespace {

// One row per counter and per clock, in the order of the enumerations.
constexpr const char* kCounterComments[] = {
    "free counter for common use1",
    "free counter for common use2",
    "free counter for common use3",
    "free counter for common use4",
    "free counter for common use5",
    "free counter for common use6",
    "free counter for common use7",
    "free counter for common use8",
    "free counter for common use9",
    "mexCallMatlab in HX_MlExprEvaluator::evalMlExpr",
};
static_assert(sizeof kCounterComments / sizeof *kCounterComments ==
              kDebugCounters);

constexpr const char* kClockComments[] = {
    "free clock for common use 1",           "free clock for common use 2",
    "free clock for common use 3",           "free clock for common use 4",
    "free clock for common use 5",           "free clock for common use 6",
    "free clock for common use 7",           "free clock for common use 8",
    "free clock for common use 9",           "free clock for common use 10",
    "free clock for common use 11",          "free clock for common use 12",
    "free clock for common use 13",          "free clock for common use 14",
    "free clock for common use 15",          "free clock for common use 16",
    "free clock for common use 17",          "free clock for common use 18",
    "free clock for common use 19",          "free clock for common use 20",
    "method HX_MlExprEvaluator::evalMlExpr",
};
static_assert(sizeof kClockComments / sizeof *kClockComments == kDebugClocks);

}  // namespace

const char* HxCDebugElements::getCounterComment(ScEDebugCounter counter) {
  if (counter < 0 || counter >= kDebugCounters) return "";
  return kCounterComments[counter];
}

const char* HxCDebugElements::getClockComment(ScEDebugClock clock) {
  if (clock < 0 || clock >= kDebugClocks) return "";
  return kClockComments[clock];
}
