// What the library calls of a host's string class, KyCXString.
//
// Positions count from 0; a range includes both ends. A unit has 16 bits.
// Results of changes are not used: a change may return the text or nothing.
// Faster forms that the library uses where a class has them:
// Control/HX_TextCalls.h.

#ifndef CONTRACT_HX_STRINGCONTRACT_H
#define CONTRACT_HX_STRINGCONTRACT_H

#include <concepts>

/// Texts are made of C strings, characters and numbers. The flags of numbers
/// are passed as false, true: decimal digits without zeros in front.
template <class Text>
concept HX_TextConstruction = std::default_initializable<Text> &&
    std::copyable<Text> && std::convertible_to<const char*, Text> &&
    requires(char character, int number, unsigned long large) {
  Text(character);
  Text(number, false, true);
  Text(large, false, true);
};

/// Questions. find() returns -1 for a text that does not occur; sub() and
/// head() give the part inside of a range that reaches outside.
template <class Text>
concept HX_TextQueries = requires(const Text text, const Text other, int at,
                                  char character, const unsigned short unit) {
  { text.length() } -> std::convertible_to<int>;
  { text.isEmpty() } -> std::convertible_to<bool>;
  { text[at] } -> std::convertible_to<unsigned short>;
  { text.cstring() } -> std::convertible_to<const char*>;
  { text.find(other, at) } -> std::convertible_to<int>;
  { text.find(character, at) } -> std::convertible_to<int>;
  { text.contains(other) } -> std::convertible_to<bool>;
  { text.startsWith(other) } -> std::convertible_to<bool>;
  { text.compareWith(other) } -> std::convertible_to<int>;
  { text.sub(at, at) } -> std::convertible_to<Text>;
  { text.head(at) } -> std::convertible_to<Text>;
  { text == other } -> std::convertible_to<bool>;
  { text + other } -> std::convertible_to<Text>;
  { text + "literal" } -> std::convertible_to<Text>;
  { "literal" + text } -> std::convertible_to<Text>;
  { text.isValidCIdentifier() } -> std::convertible_to<bool>;
  { Text::isValidForCIdentifier(unit) } -> std::convertible_to<bool>;
};

/// Changes. Value 1 of ScEPosition shortens a text in the middle.
template <class Text>
concept HX_TextChanges = requires(Text text, const Text other, char character,
                                  int count, bool flag,
                                  typename Text::ScEPosition position) {
  text = other;
  text += other;
  text += "literal";
  text += character;
  text.toLower();
  text.toUpper();
  text.trim(flag, flag);
  text.filterAngleBrackets();
  text.replaceWhiteSpace(character, flag);
  text.replace(other, other);
  text.makeCIdentifier(flag);
  text.shortenString(count, count, character, position);
};

/// The string class of a host, with the array that split() fills.
template <class Text, class Array>
concept HX_StringContract = HX_TextConstruction<Text> && HX_TextQueries<Text> &&
    HX_TextChanges<Text> &&
    requires(const Text text, char separator, Array parts) {
  text.split(separator, parts);
};

#endif  // CONTRACT_HX_STRINGCONTRACT_H
