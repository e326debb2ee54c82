// Symbols for inline functions.
//
// C++ callers compile the body of an inline function into their own code. A
// caller in another language, or an object file from before the function became
// inline, needs a symbol in the library. The source beside the header names the
// functions once:
//
//   template struct HX_ExportInline<&FLAG_ClearAll, &FLAG_SetFlag>;
//
// Each function named is declared with HX_UTILS_INLINE_API. The list of
// exported names, tests/project/exported_symbols.txt, notices a lost symbol.

#ifndef CONTROL_HX_EXPORTINLINE_H
#define CONTROL_HX_EXPORTINLINE_H

#include <algorithm>
#include <initializer_list>

/// An explicit instantiation makes the compiler emit all \p functions.
template <auto... functions>
struct HX_ExportInline {
  /// True if \p function is one of the functions named.
  static bool has(void (*function)()) {
    const auto named = {reinterpret_cast<void (*)()>(functions)...};
    return std::find(named.begin(), named.end(), function) != named.end();
  }
};

#endif  // CONTROL_HX_EXPORTINLINE_H
