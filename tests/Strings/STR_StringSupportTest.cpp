#include "Strings/STR_StringSupport.h"

#include <cctype>
#include <climits>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <limits>
#include <tuple>
#include <utility>

#include "support/HX_ForeignLocale.h"
#include "support/HX_TestFixture.h"

namespace {

class StringSupportTest : public HX_TestFixture {
 protected:
  // Text of a new string, whose block is freed; "(null)" for null.
  std::string taken(char* text) {
    const std::string result = text == nullptr ? "(null)" : text;
    m_Controller.freeMemBlock(text);
    return result;
  }

  HX_CountingController m_Controller;
};

TEST_F(StringSupportTest, NullSidesCountAsAbsent) {
  const char* end = nullptr;
  const std::pair<std::string, const char*> rows[] = {
      {taken(STR_ConcatenateStrings("ab", "cd")), "abcd"},
      {taken(STR_ConcatenateStrings("ab", nullptr)), "ab"},
      {taken(STR_ConcatenateStrings(nullptr, "cd")), "cd"},
      {taken(STR_ConcatenateStrings(nullptr, nullptr)), "(null)"},
      {taken(STR_ConcatenateNStrings("a", "", "b", "c", end)), "abc"},
      {taken(STR_ConcatenateNStrings(nullptr, "x", end)), "x"},
      {taken(STR_ConcatenateNStrings(nullptr, end)), "(null)"},
      {taken(STR_Concatenate3Strings("a", "b", "c")), "abc"},
      {taken(STR_Concatenate3Strings("a", nullptr, "c")), "a"}};
  for (const auto& [text, expected] : rows) EXPECT_EQ(text, expected);
  EXPECT_EQ(m_Controller.liveBlocks(), 0) << "an intermediate string leaks";
  m_Controller.fail();
  for (char* text : {STR_Concatenate3Strings("a", "b", "c"), STR_IntToString(1),
                     STR_DoubleToString(1, 1)})
    EXPECT_EQ(text, nullptr);
}

TEST_F(StringSupportTest, NumbersAreWrittenInFull) {
  EXPECT_EQ(taken(STR_IntToString(INT_MIN)), "-2147483648");
  EXPECT_EQ(taken(STR_IntToString(INT_MAX)), "2147483647");
  using Limits = std::numeric_limits<double>;
  for (double value :
       {Limits::max(), -Limits::min(), -Limits::infinity(), Limits::quiet_NaN(),
        -Limits::quiet_NaN(), 2.5, 1e22, -0.0, 9.996, 4294967296.0})
    for (int precision : {-1, 0, 1, 2, 17, 1080}) {
      char expected[1500];
      std::snprintf(expected, sizeof expected, "%.*f", precision, value);
      if (value != value)
        std::strcpy(expected, std::signbit(value) ? "-nan" : "nan");
      const HX_ForeignLocale foreign;
      EXPECT_EQ(taken(STR_DoubleToString(value, precision)), expected);
    }
}

// Asks how large the blocks are.
struct MeasuringController : HxCMemController {
  MeasuringController() { pHXMemory = this; }
  ~MeasuringController() override { pHXMemory = nullptr; }
  void* allocMemBlock(unsigned long size) override {
    asked = size;
    return HxCMemController::allocMemBlock(size);
  }
  unsigned long asked = 0;
};

TEST(StringSupportBlockTest, BlocksHoldDigitsDecimalsPointAndSpare) {
  MeasuringController memory;
  const struct {
    double value;
    int precision;
    unsigned long size;
  } rows[] = {
      {0.0, 2, 6},
      {-0.5, 1, 6},
      {9.999, 2, 6},
      {9.5, 0, 4},
      {-9.99, 1, 6},
      {10.0, 0, 5},
      {2147483647.9, 0, 13},
      {-2147483648.9, 0, 14},
      // Outside the 32-bit range, and of negative precision: as measured.
      {2147483648.0, 0, 11},
      {-2147483649.0, 0, 12},
      {1.5, -1, 9},
      {std::numeric_limits<double>::quiet_NaN(), 3, 4},
      {-std::numeric_limits<double>::infinity(), 3, 5}};
  for (const auto& row : rows) {
    SCOPED_TRACE(testing::Message() << row.value << " " << row.precision);
    char* const text = STR_DoubleToString(row.value, row.precision);
    EXPECT_EQ(memory.asked, row.size);
    EXPECT_LT(std::strlen(text), row.size);
    memory.freeMemBlock(text);
  }
}

TEST_F(StringSupportTest, EqualityKnowsNullAndAsciiCase) {
  // Two texts, equal with case, equal without case.
  const std::tuple<const char*, const char*, bool, bool> rows[] = {
      {nullptr, nullptr, true, true}, {nullptr, "", false, false},
      {"", nullptr, false, false},    {"Abc", "aBC", false, true},
      {"abc", "abc", true, true},     {"abc", "abcd", false, false},
      {"abcd", "abc", false, false},  {"\xC4", "\xE4", false, false},
      {"[", "{", false, false},       {"@", "`", false, false},
      {"I", "i", false, true}};
  const HX_ForeignLocale foreign;
  for (const auto& [a, b, equal, equalWithoutCase] : rows) {
    SCOPED_TRACE(testing::PrintToString(a) + testing::PrintToString(b));
    EXPECT_EQ(STR_StringsAreEqual(a, b, STR_CASE_SENSITIVE), equal);
    for (int mode : {1, 2, -1, INT_MAX})
      EXPECT_EQ(
          STR_StringsAreEqual(a, b, static_cast<STR_case_sensitive_etp>(mode)),
          equalWithoutCase);
  }
  EXPECT_TRUE(STR_IsNullOrEmpty(nullptr));
  EXPECT_TRUE(STR_IsNullOrEmpty(""));
  EXPECT_FALSE(STR_IsNullOrEmpty(" "));
}

TEST_F(StringSupportTest, EachByteIsValidOrReplaced) {
  const HX_ForeignLocale foreign;
  std::string all, valid, underscored, blanked;
  for (int code = 1; code < 256; ++code) {
    const char ch = static_cast<char>(code);
    const bool isValid = ch == '_' || (code < 128 && std::isalnum(code));
    const bool isWhite = ch == '\n' || ch == '\t' || ch == ' ';
    EXPECT_EQ(STR_IsValidCharForCIdentifier(ch), isValid) << code;
    all += ch;
    valid += isValid ? ch : '_';
    underscored += isWhite ? '_' : ch;
    blanked += isWhite ? ' ' : ch;
  }
  const auto processed = [&all](int mode) {
    std::string text = all;
    STR_ProcessString(text.data(), text.data(),
                      static_cast<STR_process_mode_tp>(mode));
    return text;
  };
  EXPECT_EQ(processed(STR_INVALID_TO_UNDERSCORE), valid);
  EXPECT_EQ(processed(STR_WHITESPACE_TO_UNDERSCORE), underscored);
  for (int mode : {int{STR_WHITESPACE_TO_BLANK}, 3, -1})
    EXPECT_EQ(processed(mode), blanked);
}

}  // namespace
