// One emitter per catalogue row: every diagnostic that a user sees leaves the
// library through one of these.
//
// An emitter takes the source reference of the item concerned where its row
// has one (null for none), then one argument per conversion of the row's text:
// const char* (ISO-8859-1) for %s, int for %d, double for %f, %lf and %g.
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
/// its end; \p text moves behind it.
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

template <int number, class... Args>
void emit(const HxCSrcRef* srcRef, Args... args) {
  // By index: g++ 12 compares no addresses at compile time when it sanitizes.
  constexpr int index = ERR_FindIndex(number);
  static_assert(index >= 0, "no such row");
  constexpr ERR_CatalogueRow row = kErrCatalogue[index];
  static_assert(fits<Args...>(row.text), "arguments do not fit the text");
  ERR_EmitErrorMessage(row.severity, srcRef, number, args...);
}

template <int number, class... Args>
void emitAt(const HxCSrcRef* srcRef, Args... args) {
  static_assert(kErrCatalogue[ERR_FindIndex(number)].hasSrcRef);
  emit<number>(srcRef, args...);
}

template <int number, class... Args>
void emitPlain(Args... args) {
  static_assert(!kErrCatalogue[ERR_FindIndex(number)].hasSrcRef);
  emit<number>(nullptr, args...);
}

}  // namespace err_detail

/// The emitters. Each reports the row of its number, with the severity that the
/// row has; times are in seconds.
inline void ERR_Msg2(const char* label, double seconds) {
  err_detail::emitPlain<2>(label, seconds);
}
inline void ERR_Msg7(const char* fileCode, int line) {
  err_detail::emitPlain<7>(fileCode, line);
}
inline void ERR_Msg90(const char* fileName) {
  err_detail::emitPlain<90>(fileName);
}
inline void ERR_Msg403(const char* kind, const char* list) {
  err_detail::emitPlain<403>(kind, list);
}
inline void ERR_Msg408(const char* name) { err_detail::emitPlain<408>(name); }
inline void ERR_Msg409(const char* name) { err_detail::emitPlain<409>(name); }
inline void ERR_Msg410(const char* name) { err_detail::emitPlain<410>(name); }
inline void ERR_Msg503(const HxCSrcRef* srcRef) {
  err_detail::emitAt<503>(srcRef);
}
inline void ERR_Msg1202(const HxCSrcRef* srcRef, const char* macro,
                        const char* nameTemplate) {
  err_detail::emitAt<1202>(srcRef, macro, nameTemplate);
}
inline void ERR_Msg1203(const HxCSrcRef* srcRef, const char* macro,
                        const char* nameTemplate) {
  err_detail::emitAt<1203>(srcRef, macro, nameTemplate);
}
inline void ERR_Msg1204(const HxCSrcRef* srcRef, const char* nameTemplate) {
  err_detail::emitAt<1204>(srcRef, nameTemplate);
}
inline void ERR_Msg1205(const HxCSrcRef* srcRef, const char* nameTemplate) {
  err_detail::emitAt<1205>(srcRef, nameTemplate);
}
inline void ERR_Msg1206(const HxCSrcRef* srcRef, const char* macro,
                        const char* timeBase, double period, double offset) {
  err_detail::emitAt<1206>(srcRef, macro, timeBase, period, offset);
}
inline void ERR_Msg1207(const HxCSrcRef* srcRef, const char* kind,
                        const char* value) {
  err_detail::emitAt<1207>(srcRef, kind, value);
}
inline void ERR_Msg1209(const HxCSrcRef* srcRef) {
  err_detail::emitAt<1209>(srcRef);
}
inline void ERR_Msg1210(const HxCSrcRef* srcRef, const char* firstProperty,
                        const char* firstComponent, const char* secondProperty,
                        const char* secondComponent) {
  err_detail::emitAt<1210>(srcRef, firstProperty, firstComponent,
                           secondProperty, secondComponent);
}
inline void ERR_Msg1272(const HxCSrcRef* srcRef, const char* text) {
  err_detail::emitAt<1272>(srcRef, text);
}
inline void ERR_Msg1273(const HxCSrcRef* srcRef, const char* text) {
  err_detail::emitAt<1273>(srcRef, text);
}
inline void ERR_Msg1274(const HxCSrcRef* srcRef, const char* text) {
  err_detail::emitAt<1274>(srcRef, text);
}
inline void ERR_Msg1275(const HxCSrcRef* srcRef, const char* text) {
  err_detail::emitAt<1275>(srcRef, text);
}
inline void ERR_Msg1292(const char* text) { err_detail::emitPlain<1292>(text); }

#endif  // CONTROL_ERR_MESSAGES_H
