#include "Strings/STR_StringSupport.h"

#include <climits>
#include <clocale>
#include <cstdio>
#include <cstring>
#include <limits>

#include "support/HX_TestFixture.h"

namespace {

class StringSupportTest : public HX_TestFixture {
 protected:
  // The text of a new string, which is given back; "(null)" for null.
  std::string taken(char* text) {
    const std::string result = text == nullptr ? "(null)" : text;
    m_Controller.freeMemBlock(text);
    return result;
  }

  HX_CountingController m_Controller;
};

TEST_F(StringSupportTest, NullSidesCountAsAbsent) {
  const char* end = nullptr;
  EXPECT_THAT(
      (std::vector{taken(STR_ConcatenateStrings("ab", "cd")),
                   taken(STR_ConcatenateStrings("ab", nullptr)),
                   taken(STR_ConcatenateStrings(nullptr, "cd")),
                   taken(STR_ConcatenateStrings(nullptr, nullptr)),
                   taken(STR_ConcatenateNStrings("a", "", "b", "c", end)),
                   taken(STR_ConcatenateNStrings(nullptr, "x", end)),
                   taken(STR_ConcatenateNStrings(nullptr, end)),
                   taken(STR_Concatenate3Strings("a", "b", "c")),
                   taken(STR_Concatenate3Strings("a", nullptr, "c")),
                   taken(STR_DuplicateString(nullptr))}),
      testing::ElementsAre("abcd", "ab", "cd", "(null)", "abc", "x", "(null)",
                           "abc", "a", "(null)"));
  EXPECT_EQ(m_Controller.liveBlocks(), 0) << "an intermediate string leaks";
  m_Controller.fail();
  for (char* text : {STR_Concatenate3Strings("a", "b", "c"), STR_IntToString(1),
                     STR_DoubleToString(1, 1)})
    EXPECT_EQ(text, nullptr);
}

TEST_F(StringSupportTest, NumbersAreWrittenInFull) {
  EXPECT_EQ(taken(STR_IntToString(0)), "0");
  EXPECT_EQ(taken(STR_IntToString(INT_MIN)), "-2147483648");
  EXPECT_EQ(taken(STR_IntToString(INT_MAX)), "2147483647");
  using Limits = std::numeric_limits<double>;
  for (double value :
       {Limits::max(), -Limits::min(), -Limits::infinity(), Limits::quiet_NaN(),
        -Limits::quiet_NaN(), 2.5, 1e22, -0.0, 9.996, 4294967296.0})
    for (int precision : {-1, 0, 1, 2, 17, 1080}) {
      char expected[1500];
      std::snprintf(expected, sizeof expected, "%.*f", precision, value);
      // A locale with a decimal comma must not show; skipped where none is
      // there.
      std::setlocale(LC_NUMERIC, "de_DE.UTF-8");
      EXPECT_EQ(taken(STR_DoubleToString(value, precision)), expected);
      std::setlocale(LC_NUMERIC, "C");
    }
}

TEST_F(StringSupportTest, EqualityKnowsNullAndAsciiCase) {
  const struct {
    const char *a, *b;
    bool equal, equalWithoutCase;
  } rows[] = {{nullptr, nullptr, true, true}, {nullptr, "", false, false},
              {"", nullptr, false, false},    {"Abc", "aBC", false, true},
              {"abc", "abc", true, true},     {"abc", "abcd", false, false},
              {"abcd", "abc", false, false},  {"\xC4", "\xE4", false, false},
              {"[", "{", false, false},       {"@", "`", false, false}};
  for (const auto& row : rows) {
    SCOPED_TRACE(row.a == nullptr ? "(null)" : row.a);
    EXPECT_EQ(STR_StringsAreEqual(row.a, row.b, STR_CASE_SENSITIVE), row.equal);
    for (int mode : {1, 2, -1, INT_MAX})
      EXPECT_EQ(STR_StringsAreEqual(row.a, row.b,
                                    static_cast<STR_case_sensitive_etp>(mode)),
                row.equalWithoutCase);
  }
  EXPECT_TRUE(STR_IsNullOrEmpty(nullptr));
  EXPECT_TRUE(STR_IsNullOrEmpty(""));
  EXPECT_FALSE(STR_IsNullOrEmpty(" "));
}

TEST_F(StringSupportTest, EachByteIsValidOrReplaced) {
  const std::string valid =
      "_0123456789abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ";
  for (int code = 1; code < 256; ++code) {
    SCOPED_TRACE(code);
    const char ch = static_cast<char>(code);
    const bool isValid = valid.find(ch) != std::string::npos;
    const bool isWhite = std::strchr("\n\t ", ch) != nullptr;
    EXPECT_EQ(STR_IsValidCharForCIdentifier(ch), isValid);
    const auto processed = [ch](int mode) {
      char text[] = {ch, 'x', 0};
      STR_ProcessString(text, text, static_cast<STR_process_mode_tp>(mode));
      EXPECT_STREQ(text + 1, "x");
      return text[0];
    };
    EXPECT_EQ(processed(STR_INVALID_TO_UNDERSCORE), isValid ? ch : '_');
    EXPECT_EQ(processed(STR_WHITESPACE_TO_UNDERSCORE), isWhite ? '_' : ch);
    for (int mode : {int{STR_WHITESPACE_TO_BLANK}, 3, -1})
      EXPECT_EQ(processed(mode), isWhite ? ' ' : ch);
  }
}

}  // namespace
