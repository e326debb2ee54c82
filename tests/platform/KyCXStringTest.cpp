#include "platform/strings/KyCXString.h"

#include <climits>
#include <random>

#include "support/HX_TestFixture.h"

namespace {

using Units = std::u16string;

// A random text of up to 60 units around the inline capacity, a third of them
// with units above 255. Few different units make matches likely.
Units randomUnits(std::mt19937& random) {
  static const Units kAlphabet = u"ab_1 \tZ\u00E4<>\u20AC";
  const std::size_t kinds = kAlphabet.size() - (random() % 3 == 0 ? 0 : 1);
  Units units(random() % 4 == 0 ? random() % 60 : random() % 6, u'a');
  for (char16_t& unit : units) unit = kAlphabet[random() % kinds];
  return units;
}

KyCXString textOf(const Units& units) {
  const std::vector<unsigned short> copy(units.begin(), units.end());
  return KyCXString(copy.data(), static_cast<int>(copy.size()));
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

int plainFind(const Units& units, const Units& text, int from) {
  // No place becomes -1.
  return static_cast<int>(units.find(text, static_cast<std::size_t>(from)));
}

Units plainReplace(Units units, const Units& what, const Units& by) {
  for (std::size_t at = 0; !what.empty(); at += by.size()) {
    at = units.find(what, at);
    if (at == Units::npos) break;
    units.replace(at, what.size(), by);
  }
  return units;
}

// Two texts and their plain models; each step changes or asks the first, with
// the second or the first itself as argument.
struct Walk {
  std::mt19937 random;
  KyCXString text[2];
  Units plain[2];

  explicit Walk(unsigned int seed) : random(seed) {}

  void step() {
    if (plain[0].size() > 500) text[0] = "", plain[0].clear();
    const std::size_t other = random() % 2;
    const KyCXString& argument = text[other];
    const Units argumentUnits = plain[other];
    const int from = static_cast<int>(random() % 50) - 5;
    const int to = static_cast<int>(random() % 50) - 5;
    const Units old = plain[0];
    switch (random() % 11) {
      case 0:
        text[0] = argument, plain[0] = argumentUnits;
        break;
      case 1:
        text[0] += argument, plain[0] += argumentUnits;
        break;
      case 2:
        text[0] = text[0].sub(from, to), plain[0] = plainSub(old, from, to);
        break;
      case 3:
        text[0].appendSub(argument, from, to);
        plain[0] += plainSub(argumentUnits, from, to);
        break;
      case 4:
        text[0].replace(argument, text[1]);
        plain[0] = plainReplace(old, argumentUnits, plain[1]);
        break;
      case 5:
        text[0].replace("a", text[0]).trim(true, true);
        plain[0] = plainReplace(old, u"a", old);
        while (!plain[0].empty() && plain[0][0] <= u' ') plain[0].erase(0, 1);
        while (!plain[0].empty() && plain[0].back() <= u' ')
          plain[0].pop_back();
        break;
      case 6: {
        KyCXString moved(std::move(text[0]));
        EXPECT_TRUE(text[0].isEmpty());
        text[0] += 'x';
        text[0] = std::move(moved);
        break;
      }
      case 7:
        std::swap(text[0], text[1]), std::swap(plain[0], plain[1]);
        break;
      case 8:
        text[0] = text[0].cstring() + std::min(text[0].length(), 3);
        plain[0] = plainSub(old, 3, INT_MAX - 1);
        for (char16_t& unit : plain[0]) unit = unit > 0xFF ? u'?' : unit;
        break;
      default:
        plain[0] = randomUnits(random), text[0] = textOf(plain[0]);
    }
  }

  void check() {
    EXPECT_EQ(unitsOf(text[0]), plain[0]);
    std::string narrow;
    for (char16_t unit : plain[0])
      narrow += static_cast<char>(unit > 0xFF ? u'?' : unit);
    EXPECT_EQ(text[0].cstring(), narrow);
    const int from = static_cast<int>(random() % 4);
    EXPECT_EQ(text[0].find(text[1], from), plainFind(plain[0], plain[1], from));
    EXPECT_EQ(text[0].find('\xE4', from), plainFind(plain[0], u"\u00E4", from));
    EXPECT_EQ(text[0].startsWith(text[1]), plain[0].starts_with(plain[1]));
    EXPECT_EQ(text[0] == text[1], plain[0] == plain[1]);
    EXPECT_EQ(text[0] < text[1], plain[0] < plain[1]);
    EXPECT_EQ(text[0].compareWith(text[1]) > 0, plain[0] > plain[1]);
    EXPECT_EQ(unitsOf(text[0] + text[1]), plain[0] + plain[1]);
  }
};

TEST(CXStringTest, WalksAsThePlainTextDoes) {
  const unsigned int seed = std::random_device()();
  SCOPED_TRACE(testing::Message() << "seed " << seed);
  Walk walk(seed);
  for (int i = 0; i < 5000 && !testing::Test::HasFailure(); ++i) {
    walk.step();
    walk.check();
  }
}

TEST(CXStringTest, DerivedTextsKeepTheirPromises) {
  const unsigned int seed = std::random_device()();
  SCOPED_TRACE(testing::Message() << "seed " << seed);
  std::mt19937 random(seed);
  for (int i = 0; i < 1000 && !testing::Test::HasFailure(); ++i) {
    const KyCXString text = textOf(randomUnits(random));
    SCOPED_TRACE(text.cstring());
    for (bool collapse : {false, true}) {
      KyCXString name(text);
      name.makeCIdentifier(collapse);
      EXPECT_EQ(name.isValidCIdentifier(), !text.isEmpty());
      if (text.isValidCIdentifier()) {
        EXPECT_EQ(name, text);
      }
    }

    leda::array<KyCXString> parts;
    text.split('_', parts);
    KyCXString joined = parts[0];
    for (int part = 1; part < parts.size(); ++part) joined += "_" + parts[part];
    EXPECT_EQ(joined, text);
    for (const KyCXString& part : parts) EXPECT_FALSE(part.contains("_"));

    const int limit = static_cast<int>(random() % 40);
    KyCXString shortened(text);
    shortened.shortenString(limit, 2, '_', KyCXString::ePositionMiddle);
    EXPECT_EQ(shortened.length(), std::min(limit, text.length()));
    // The end tells derived names apart.
    const int kept = limit > 2 ? (limit - 2) / 2 : limit;
    EXPECT_EQ(shortened.sub(shortened.length() - kept, INT_MAX),
              text.sub(text.length() - kept, INT_MAX));
    if (text.length() <= limit) {
      EXPECT_EQ(shortened, text);
    }
  }
}

KyCXString& toIdentifier(KyCXString& t) { return t.makeCIdentifier(false); }
KyCXString& toCollapsed(KyCXString& t) { return t.makeCIdentifier(true); }
template <int limit, int marks, KyCXString::ScEPosition position>
KyCXString& shorten(KyCXString& t) {
  return t.shortenString(limit, marks, '_', position);
}
template <bool front, bool back>
KyCXString& trim(KyCXString& t) {
  return t.trim(front, back);
}
template <char by, bool collapse>
KyCXString& whiteSpaceTo(KyCXString& t) {
  return t.replaceWhiteSpace(by, collapse);
}
KyCXString& bare(KyCXString& t) { return t.filterAngleBrackets(); }
KyCXString& twoToThree(KyCXString& t) { return t.replace("aa", "aaa"); }
KyCXString& lower(KyCXString& t) { return t.toLower(); }
KyCXString& upper(KyCXString& t) { return t.toUpper(); }

TEST(CXStringTest, ChangesOfTheText) {
  constexpr auto kFront = KyCXString::ePositionFront;
  constexpr auto kMiddle = KyCXString::ePositionMiddle;
  constexpr auto kBack = KyCXString::ePositionBack;
  // A character above 127 is a unit of its own, not a negative number.
  const struct {
    Units before;
    KyCXString& (*change)(KyCXString&);
    Units after;
  } rows[] = {
      {u"1a b  c-\u00E4", toIdentifier, u"_1a_b__c__"},
      {u"A\u20AC\u0141Z", toIdentifier, u"A__Z"},
      {u"", toIdentifier, u""},
      {u"a  -b _", toCollapsed, u"a_b__"},
      {u"A\u20AC\u0141Z", toCollapsed, u"A_Z"},
      {u"abcdefghij", shorten<7, 2, kMiddle>, u"abc__ij"},
      {u"abcdefghij", shorten<7, 2, kFront>, u"__fghij"},
      {u"abcdefghij", shorten<7, 2, kBack>, u"abcde__"},
      {u"abcdefghij", shorten<10, 2, kBack>, u"abcdefghij"},
      {u"abcde", shorten<2, 2, kFront>, u"de"},
      {u"abc", shorten<-1, -1, kBack>, u""},
      {u" \t\n\v\f\ra b ", trim<true, false>, u"a b "},
      {u" a b ", trim<false, true>, u" a b"},
      {u" \t ", trim<true, true>, u""},
      {u"<<a>>", bare, u"<a>"},
      {u"<\u20AC>", bare, u"\u20AC"},
      {u"<a", bare, u"<a"},
      {u"<", bare, u"<"},
      {u"a \n b", whiteSpaceTo<'.', false>, u"a...b"},
      {u"\u20AC \t\u0120", whiteSpaceTo<'.', true>, u"\u20AC.\u0120"},
      {u"a \n b ", whiteSpaceTo<'\xB7', true>, u"a\u00B7b\u00B7"},
      {u"\u20AC \t", whiteSpaceTo<'\xB7', false>, u"\u20AC\u00B7\u00B7"},
      {u"aaa", twoToThree, u"aaaa"},
      {u"Az[\u00C4{`@", lower, u"az[\u00C4{`@"},
      {u"A\u20ACZ\u0100", lower, u"a\u20ACz\u0100"},
      {u"Az[\u00E4{`@", upper, u"AZ[\u00E4{`@"},
  };
  for (const auto& [before, change, after] : rows) {
    KyCXString text = textOf(before);
    SCOPED_TRACE(text.cstring());
    EXPECT_EQ(unitsOf(change(text)), after);
  }
}

TEST(CXStringTest, NumbersAreWrittenInTheWidthAsked) {
  EXPECT_EQ(KyCXString(-5, false, true), "-5");
  EXPECT_EQ(KyCXString(INT_MIN, false, false), "-2147483648");
  EXPECT_EQ(KyCXString(42, false, false), "0000000042");
  EXPECT_EQ(KyCXString(-1, true, true), "FFFFFFFF");
  EXPECT_EQ(KyCXString(0xABC, true, false), "00000ABC");
  EXPECT_EQ(KyCXString(0UL, false, true), "0");
  EXPECT_EQ(KyCXString(~0UL, true, false).length(),
            static_cast<int>(2 * sizeof(long)));
  EXPECT_EQ(KyCXString(1UL, false, false).length(),
            sizeof(long) == 4 ? 10 : 20);
}

TEST(CXStringTest, PositionsOutsideTheTextFindNothing) {
  const KyCXString text("abc");
  for (int position : {INT_MIN, -1, 3, INT_MAX}) EXPECT_EQ(text[position], 0);
  EXPECT_EQ(text.sub(INT_MIN, INT_MAX), "abc");
  for (int from : {INT_MIN, 0, 3, INT_MAX}) {
    EXPECT_EQ(text.sub(from, INT_MIN), "");
  }
  EXPECT_EQ(text.head(INT_MIN), "");
  EXPECT_EQ(text.find("", INT_MIN), 0);
  EXPECT_EQ(text.find("", 3), 3);
  EXPECT_EQ(text.find("", 4), -1);
  EXPECT_EQ(text.find("c", INT_MAX), -1);
  EXPECT_EQ(text.find('a', INT_MIN), 0);
  EXPECT_EQ(KyCXString(static_cast<const char*>(nullptr)), "");
  EXPECT_EQ(KyCXString(nullptr, -1), "");
  EXPECT_EQ(leda::compare(KyCXString("a\xE4"), KyCXString("az")) > 0, true);
}

}  // namespace
