// The string class against std::u16string.
#include <climits>

#include "fuzz/HX_Fuzz.h"

namespace {

using Units = std::u16string;

const Units kWhite = u" \t\n\v\f\r";
const Units kLower = u"abcdefghijklmnopqrstuvwxyz";
const Units kUpper = u"ABCDEFGHIJKLMNOPQRSTUVWXYZ";
const Units kDigits = u"0123456789";
const Units kNameUnits = kLower + kUpper + kDigits + u"_";

bool isOneOf(const Units& set, char16_t unit) {
  return set.find(unit) != Units::npos;
}

Units unitsOf(const KyCXString& text) {
  Units units;
  for (int i = 0; i < text.length(); ++i)
    units += static_cast<char16_t>(text[i]);
  return units;
}

Units plainSub(const Units& units, int from, int to) {
  Units part;
  for (int i = std::max(from, 0); i <= to && i < static_cast<int>(units.size());
       ++i)
    part += units[static_cast<std::size_t>(i)];
  return part;
}

Units plainReplace(Units units, const Units& what, const Units& by) {
  for (std::size_t at = 0; !what.empty(); at += by.size()) {
    at = units.find(what, at);
    if (at == Units::npos) break;
    units.replace(at, what.size(), by);
  }
  return units;
}

Units plainTrim(Units units, bool leading, bool trailing) {
  while (leading && !units.empty() && isOneOf(kWhite, units[0]))
    units.erase(0, 1);
  while (trailing && !units.empty() && isOneOf(kWhite, units.back()))
    units.pop_back();
  return units;
}

Units plainIdentifier(const Units& units, bool collapse) {
  Units result;
  for (std::size_t i = 0; i < units.size(); ++i) {
    if (isOneOf(kNameUnits, units[i]))
      result += units[i];
    else if (!collapse || i == 0 || isOneOf(kNameUnits, units[i - 1]))
      result += u'_';
  }
  return isOneOf(kDigits, result[0]) ? u"_" + result : result;
}

Units plainShorten(const Units& units, int limit, int marks, int position) {
  const int length = static_cast<int>(units.size());
  if (length <= limit) return units;
  const int room = limit - marks;
  if (room <= 0) return plainSub(units, length - limit, length);
  const int tail = position == 0 ? room : position == 1 ? room / 2 : 0;
  return plainSub(units, 0, room - tail - 1) +
         Units(static_cast<std::size_t>(marks), u'.') +
         plainSub(units, length - tail, length);
}

// Two texts and their plain models; each step changes the first, with the
// second or the first itself as argument.
struct Walk {
  KyCXString text[2];
  Units plain[2];

  void step(HX_Bytes& bytes) {
    if (plain[0].size() > 500) text[0] = "", plain[0].clear();
    const int operation = bytes.below(14);
    const int choice = bytes.number();
    const int from = choice % 50 - 5;
    const int to = bytes.number() % 50 - 5;
    const bool first = choice % 2 != 0;
    const bool second = to % 2 != 0;
    const KyCXString& argument = text[first];
    const Units argumentUnits = plain[first];
    KyCXString& t = text[0];
    Units& p = plain[0];
    switch (operation) {
      case 0:
        return t = argument, p = argumentUnits, void();
      case 1:
        return t += argument, p += argumentUnits, void();
      case 2:
        return t = t.sub(from, to), p = plainSub(p, from, to), void();
      case 3:
        t.appendSub(argument, from, to);
        return p += plainSub(argumentUnits, from, to), void();
      case 4:
        p = plainReplace(p, argumentUnits, plain[second]);
        return t.replace(argument, text[second]), void();
      case 5:
        return t.trim(first, second), p = plainTrim(p, first, second), void();
      case 6: {
        KyCXString moved(std::move(t));
        HX_Require(t.isEmpty(), "a text moved from is empty");
        t += 'x';
        return t = std::move(moved), void();
      }
      case 7:
        return std::swap(t, text[1]), std::swap(p, plain[1]);
      case 8:  // a tail of its own memory
        t = t.cstring() + std::min(t.length(), 3);
        p = plainSub(p, 3, INT_MAX - 1);
        for (char16_t& unit : p) unit = unit > 0xFF ? u'?' : unit;
        return p = p.c_str(), void();
      case 9:
        t += static_cast<char>(choice);
        return p += static_cast<char16_t>(choice), void();
      case 10:
        t.makeCIdentifier(first), p = plainIdentifier(p, first);
        return HX_Require(t.isValidCIdentifier() != p.empty(), "identifier");
      case 11: {
        first ? t.toUpper() : t.toLower();
        const Units& before = first ? kLower : kUpper;
        for (char16_t& unit : p)
          if (const std::size_t at = before.find(unit); at != Units::npos)
            unit = (first ? kUpper : kLower)[at];
        return;
      }
      case 12: {
        const int position = (to + 5) % 3;
        p = plainShorten(p, std::max(from, 0), choice % 4, position);
        t.shortenString(from, choice % 4, '.',
                        static_cast<KyCXString::ScEPosition>(position));
        return;
      }
      default:
        t = bytes.text(), p = unitsOf(t);
    }
  }

  void check(HX_Bytes& bytes) {
    const int from = bytes.below(4);
    const auto found = [&](const Units& what) {
      return static_cast<int>(plain[0].find(what, std::size_t(from)));
    };
    HX_Require(unitsOf(text[0]) == plain[0], "the units agree");
    std::string narrow;
    for (char16_t unit : plain[0])
      narrow += static_cast<char>(unit > 0xFF ? u'?' : unit);
    HX_Require(
        std::string(text[0].cstring(), narrow.size() + 1) == narrow + '\0',
        "the 8-bit form agrees");
    HX_Require(text[0].find(text[1], from) == found(plain[1]) &&
                   text[0].find('\xE4', from) == found(u"\u00E4"),
               "find");
    HX_Require(text[0].startsWith(text[1]) == plain[0].starts_with(plain[1]),
               "startsWith");
    HX_Require((text[0] == text[1]) == (plain[0] == plain[1]) &&
                   (text[0] < text[1]) == (plain[0] < plain[1]) &&
                   (text[0].compareWith(text[1]) > 0) == (plain[0] > plain[1]),
               "comparison");
    HX_Require(unitsOf(text[0] + text[1]) == plain[0] + plain[1], "sum");
    leda::array<KyCXString> parts;
    text[0].split('_', parts);
    KyCXString joined(parts[0]);
    for (int i = 1; i < parts.size(); ++i) joined += "_" + parts[i];
    const auto separators = std::count(plain[0].begin(), plain[0].end(), u'_');
    HX_Require(joined == text[0] && parts.size() == 1 + separators,
               "split texts joined give the text");
  }
};

}  // namespace

void HX_CheckString(HX_Bytes& bytes) {
  Walk walk;
  while (!bytes.isEmpty()) {
    walk.step(bytes);
    walk.check(bytes);
  }
}
