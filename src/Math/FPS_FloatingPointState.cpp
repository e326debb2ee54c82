// Sets the state of the floating-point unit when the library is loaded.
//
// No other file refers to this file. A linker option (see CMakeLists.txt) makes
// users of the static library link the file.

#include <cfenv>

#if defined(__i386__) && defined(__GLIBC__)
#include <fpu_control.h>
#elif defined(_M_IX86)
#include <float.h>
#endif

namespace {

// On 64 bits the SSE unit alone computes doubles, and the x87 precision stays,
// because a change would only spoil the host's long double.
int setFloatingPointState() {
#if defined(__i386__) && defined(__GLIBC__)
  fpu_control_t control;
  _FPU_GETCW(control);
  control = static_cast<fpu_control_t>(
      (control & ~(_FPU_EXTENDED | _FPU_RC_ZERO)) | _FPU_DOUBLE);
  _FPU_SETCW(control);
#elif defined(_M_IX86)
  unsigned int control;
  _controlfp_s(&control, _PC_53, _MCW_PC);
#endif
  return std::fesetround(FE_TONEAREST);
}

}  // namespace

// 0 if the state could be set.
extern "C" {
extern const int hx_utils_floatingPointState;
const int hx_utils_floatingPointState = setFloatingPointState();
}
