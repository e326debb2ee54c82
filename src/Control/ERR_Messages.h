// One emitter per row of the catalogue. Every diagnostic that a user sees
// leaves the library through an emitter.
//
// ERR_Msg<number> reports the row of this number with the severity of the row.
// The parameters stand in ERR_Catalogue.h: a source reference of the item
// concerned (null for none) if the row has such a parameter, then one parameter
// per conversion of the text: const char* (ISO-8859-1) for %s, int for %d,
// double for %f, %lf and %g.
//
//   ERR_Msg408(name.cstring());   // "C keyword int used as identifier."

#ifndef CONTROL_ERR_MESSAGES_H
#define CONTROL_ERR_MESSAGES_H

#include <type_traits>

#include "Control/ERR_Catalogue.h"
#include "platform/messages/ERR_MessageHandler.h"

namespace err_detail {

template <class T>
constexpr char kindOf() {
  if (std::is_same_v<T, const char*>) return 's';
  if (std::is_same_v<T, int>) return 'd';
  return std::is_same_v<T, double> ? 'f' : '?';
}

/// The next conversion of the printf format \p text as 's', 'd' or 'f', 0 at
/// the end of the text; \p text moves behind the conversion.
constexpr char nextConversion(const char*& text) {
  for (; *text != 0; ++text) {
    if (*text != '%') continue;
    ++text;
    if (*text == '%') continue;
    while ((*text >= '0' && *text <= '9') || *text == '-' || *text == '.' ||
           *text == 'l')
      ++text;
    const char conversion = *text++;
    if (conversion == 'i') return 'd';
    return conversion == 'g' ? 'f' : conversion;
  }
  return 0;
}

template <class... Args>
constexpr bool fits(const char* text) {
  constexpr char kinds[] = {kindOf<Args>()..., 0};
  for (const char* kind = kinds;; ++kind) {
    if (nextConversion(text) != *kind) return false;
    if (*kind == 0) return true;
  }
}

// By index: g++ 12 compares no addresses at compile time when it sanitizes.
template <int number, class... Args>
void emitAt(const HxCSrcRef* srcRef, Args... args) {
  constexpr ERR_CatalogueRow row = kErrCatalogue[ERR_FindIndex(number)];
  static_assert(fits<Args...>(row.text), "parameters do not fit the text");
  ERR_EmitErrorMessage(row.severity, srcRef, number, args...);
}

// A first parameter that is a source reference is no argument of the text.
template <int number, class... Args>
void emit(const HxCSrcRef* srcRef, Args... args) {
  emitAt<number>(srcRef, args...);
}
template <int number, class... Args>
void emit(Args... args) {
  emitAt<number>(nullptr, args...);
}

constexpr bool isAscending() {
  int last = -1;
  for (const ERR_CatalogueRow& row : kErrCatalogue) {
    if (row.number <= last) return false;
    last = row.number;
  }
  return true;
}
static_assert(isAscending(), "each number stands once, in ascending order");

}  // namespace err_detail

/// A message as an emitter. Times are in seconds.
#define ERR_EMITTER(number, id, category, severity, parameters, arguments, \
                    text)                                                  \
  inline void ERR_Msg##number parameters { err_detail::emit<number> arguments; }
ERR_MESSAGES(ERR_EMITTER)
#undef ERR_EMITTER

#endif  // CONTROL_ERR_MESSAGES_H
