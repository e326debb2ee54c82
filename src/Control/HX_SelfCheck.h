// The two self-checks of the library.
//
//   namespace { constexpr char kNodeErrorCode[] = __FILE__ "_"; }
//
//   if (!HX_Assert(field != nullptr, kNodeErrorCode)) return;  // an invariant
//   HX_DebugCheck(success, "success");                     // for developers

#ifndef CONTROL_HX_SELFCHECK_H
#define CONTROL_HX_SELFCHECK_H

#include "HX_Export.h"

namespace hx_detail {

HX_UTILS_API void failDebugCheck(const char* expression, const char* file,
                                 int line);
HX_UTILS_API void failAssertion(const char* fileCode, const char* file,
                                int line);

}  // namespace hx_detail

/// Debug check, for conditions that matter to developers only.
///
/// A false \p condition raises a debug report with \p expression and the place
/// of the caller while ShowInternalInfo() is true, and breaks into the debugger
/// if the report answers 1. Otherwise nothing happens.
/// \return \p condition
inline bool HX_DebugCheck(bool condition, const char* expression,
                          const char* file = __builtin_FILE(),
                          int line = __builtin_LINE()) {
  if (!condition) hx_detail::failDebugCheck(expression, file, line);
  return condition;
}

/// Internal assertion, for broken invariants.
///
/// A false \p condition does two things:
///   - raises the debug report with the expression "0" while ShowInternalInfo()
///     is true, as a debug check does;
///   - emits message 7 (severity 3) with \p fileCode, the text that stands for
///     the source file, and the line.
/// Then execution goes on; the caller decides how.
/// \return \p condition
inline bool HX_Assert(bool condition, const char* fileCode,
                      const char* file = __builtin_FILE(),
                      int line = __builtin_LINE()) {
  if (!condition) hx_detail::failAssertion(fileCode, file, line);
  return condition;
}

#endif  // CONTROL_HX_SELFCHECK_H
