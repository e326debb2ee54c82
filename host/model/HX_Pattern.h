// A pattern of the schema: a sequence of characters, '.', and classes such as
// [A-Za-z_], with '*' or '+' behind. Nothing else of regular expressions.
//
//   HX_Pattern("[a-z]+").fits("speed");   // true

#ifndef HOST_MODEL_HX_PATTERN_H
#define HOST_MODEL_HX_PATTERN_H

#include <bitset>
#include <string_view>
#include <vector>

class HX_Pattern {
 public:
  /// A '\' or an open class makes the pattern invalid; an invalid pattern fits
  /// no text.
  explicit HX_Pattern(std::string_view pattern);

  bool isValid() const { return m_IsValid; }
  /// Whether the pattern fits the whole text, byte by byte.
  /// COST: linear in the text; no recursion.
  bool fits(std::string_view text) const;

 private:
  struct Item {
    std::bitset<256> bytes;
    bool isOptional = false;  // with '*'
    bool isRepeated = false;  // with '*' or '+'
  };
  static constexpr std::size_t kMostItems = 63;

  std::vector<Item> m_Items;
  bool m_IsValid = true;
};

#endif  // HOST_MODEL_HX_PATTERN_H
