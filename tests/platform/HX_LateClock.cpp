// A module; a test loads the module long after the start of the test.
#include "platform/os/HX_OsClock.h"

extern "C" __attribute__((visibility("default"))) std::int64_t
HX_LateProcessClock() {
  return HX_ProcessClock();
}
