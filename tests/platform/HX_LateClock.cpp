// A module that a test loads long after its start.
#include "platform/os/HX_OsClock.h"

extern "C" __attribute__((visibility("default"))) std::int64_t
HX_LateProcessClock() {
  return HX_ProcessClock();
}
