#include "host/base/HX_NameText.h"

#include <algorithm>
#include <string>

#include "host/base/HX_Text.h"

namespace {

/// Consecutive characters and their texts, separated by blanks.
struct Letters {
  char32_t first;
  std::string_view texts;
};

// Latin letters lose their marks; Greek letters get their names, as engineers
// speak them; Cyrillic letters as in passports (ICAO 9303), without the signs
// of hardness. Texts by code point, '-' for a punctuation mark.
constexpr Letters kLetters[] = {
    {0x00B5, "u"},
    {0x00C0,
     "A A A A A A AE C E E E E I I I I D N O O O O O - O U U U U Y TH ss "
     "a a a a a a ae c e e e e i i i i d n o o o o o - o u u u u y th y"},
    {0x0100,
     "A a A a A a C c C c C c C c D d D d E e E e E e E e E e G g G g G g G g "
     "H h H h I i I i I i I i I i IJ ij J j K k k L l L l L l L l L l N n N n "
     "N n n N n O o O o O o OE oe R r R r R r S s S s S s S s T t T t T t U u "
     "U u U u U u U u U u W w Y y Y Z z Z z Z z s"},
    {0x0386, "Alpha - Epsilon Eta Iota"},
    {0x038C, "Omicron"},
    {0x038E,
     "Upsilon Omega iota Alpha Beta Gamma Delta Epsilon Zeta Eta Theta Iota "
     "Kappa Lambda Mu Nu Xi Omicron Pi Rho"},
    {0x03A3,
     "Sigma Tau Upsilon Phi Chi Psi Omega Iota Upsilon alpha epsilon eta iota "
     "upsilon alpha beta gamma delta epsilon zeta eta theta iota kappa lambda "
     "mu nu xi omicron pi rho sigma sigma tau upsilon phi chi psi omega iota "
     "upsilon omicron upsilon omega"},
    {0x0400,
     "E E D G Ye Z I I J L N C K I U Dz A B V G D E Zh Z I I K L M N O P R S T "
     "U F Kh Ts Ch Sh Shch Ie Y _ E Iu Ia a b v g d e zh z i i k l m n o p r s "
     "t u f kh ts ch sh shch ie y _ e iu ia e e d g ye z i i j l n c k i u dz"},
    {0x0490, "G g"},
    {0x1E9E, "SS"},
    {0x2126, "Omega"},
    {0x212A, "K A"},
};

constexpr bool isIn(char32_t code, char32_t first, char32_t last) {
  return code >= first && code <= last;
}

constexpr bool isCombining(char32_t code) {
  return isIn(code, 0x0300, 0x036F) || isIn(code, 0xFE00, 0xFE0F);
}

constexpr bool isPunctuation(char32_t code) {
  return isIn(code, 0x0080, 0x00BF) || isIn(code, 0x2000, 0x206F) ||
         isIn(code, 0x3000, 0x3003) || isIn(code, 0x3008, 0x3011) ||
         code == 0xFEFF;
}

// Empty for a character without a text.
std::string_view letterText(char32_t code) {
  for (const Letters& row : kLetters) {
    if (code < row.first) break;
    std::string_view rest = row.texts;
    for (char32_t at = row.first; !rest.empty(); ++at) {
      const std::size_t end = std::min(rest.find(' '), rest.size());
      if (at == code) return rest.substr(0, end);
      rest.remove_prefix(std::min(end + 1, rest.size()));
    }
  }
  return {};
}

void append(std::string& text, char32_t code) {
  if (code < 0x80) {
    text += static_cast<char>(code);
  } else if (const std::string_view letters = letterText(code);
             !letters.empty()) {
    text += letters == "-" ? "_" : letters;
  } else if (isPunctuation(code)) {
    text += '_';
  } else if (!isCombining(code)) {
    constexpr char kDigits[] = "0123456789ABCDEF";
    text += "_u";
    for (int shift = code > 0xFFFFF  ? 20
                     : code > 0xFFFF ? 16
                                     : 12;
         shift >= 0; shift -= 4)
      text += kDigits[code >> shift & 0xF];
    text += '_';
  }
}

}  // namespace

bool HX_IsForeign(std::string_view utf8) {
  return std::any_of(utf8.begin(), utf8.end(),
                     [](char c) { return (c & '\x80') != 0; });
}

KyCXString HX_NameText(std::string_view utf8) {
  if (!HX_IsForeign(utf8)) return HX_FromUtf8(utf8);
  std::string text;
  for (std::size_t at = 0; at < utf8.size();)
    append(text, HX_DecodeUtf8(utf8, at));
  if (text.empty()) text = "_";
  return HX_FromUtf8(text);
}
