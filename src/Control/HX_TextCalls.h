// Calls on texts that a host's string class need not have.
//
// A string class must have the operations of the string contract. Our class
// has faster forms of some combinations; each helper uses the faster form where
// the class has one, and the operations of the contract elsewhere.

#ifndef CONTROL_HX_TEXTCALLS_H
#define CONTROL_HX_TEXTCALLS_H

#include <algorithm>

/// Appends the units of \p source in the closed range [\p from, \p to] to
/// \p text; of a range that reaches outside \p source the part inside.
template <class Text>
void HX_AppendSub(Text& text, const Text& source, int from, int to) {
  if constexpr (requires { text.appendSub(source, from, to); }) {
    text.appendSub(source, from, to);
  } else {
    from = std::max(from, 0);
    to = std::min(to, source.length() - 1);
    if (from <= to) text += source.sub(from, to);
  }
}

/// Appends the unit at \p position of \p source to \p text.
/// REQUIRES: \p position lies inside \p source.
template <class Text>
void HX_AppendUnit(Text& text, const Text& source, int position) {
  if constexpr (requires { text.appendUnit(source[position]); })
    text.appendUnit(source[position]);
  else
    text += source.sub(position, position);
}

/// True if \p part stands at \p position of \p text, which may lie outside.
template <class Text>
bool HX_MatchesAt(const Text& text, int position, const Text& part) {
  if constexpr (requires { text.matchesAt(position, part); }) {
    return text.matchesAt(position, part);
  } else {
    const int length = part.length();
    if (position < 0 || position > text.length() - length) return false;
    return length == 0 || text.sub(position, position + length - 1) == part;
  }
}

/// Makes room for \p length units in \p text, if the class has such a call.
template <class Text>
void HX_Reserve(Text& text, int length) {
  if constexpr (requires { text.reserve(length); }) text.reserve(length);
}

#endif  // CONTROL_HX_TEXTCALLS_H
