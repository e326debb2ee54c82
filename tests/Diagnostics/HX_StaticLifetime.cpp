// Program whose static objects use stop watches until the end of the process.
// The exit code is 0 if the register of the watches outlives them all.

#include <memory>

#include "Diagnostics/HX_StopWatch.h"

namespace {

// Constructed before the first watch, hence destroyed after all static objects
// of the library.
std::unique_ptr<HX_StopWatch> s_watch;

struct LateUser {
  ~LateUser() {
    HX_StopWatch late("late");
    late.start();
    late.stop();
  }
};
const LateUser s_lateUser;

}  // namespace

int main() {
  s_watch.reset(new HX_StopWatch("x"));
  s_watch->start();
}
