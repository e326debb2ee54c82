#include "platform/strings/KyCXString.h"

#include <climits>

#include "support/HX_TestFixture.h"

namespace {

using Units = std::u16string;

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
