// Texts of model files: UTF-8, numbers, names in labels, order.
#include <gmock/gmock.h>

#include "host/base/HX_NaturalOrder.h"
#include "host/import/HX_ChartReader.h"
#include "host/import/HX_Literals.h"
#include "host/import/HX_PartText.h"

using testing::ElementsAre;

namespace {

// The definition: decode, then ask whether the code point needs the length.
bool isPlainUtf8(const std::string& text) {
  for (std::size_t at = 0; at < text.size();) {
    const auto byte = [&](std::size_t i) {
      return i < text.size() ? static_cast<unsigned char>(text[i]) : 0U;
    };
    const unsigned first = byte(at);
    const std::size_t length = first < 0x80             ? 1
                               : (first & 0xE0) == 0xC0 ? 2
                               : (first & 0xF0) == 0xE0 ? 3
                               : (first & 0xF8) == 0xF0 ? 4
                                                        : 0;
    if (length == 0) return false;
    unsigned code = length == 1 ? first : first & (0x7FU >> length);
    for (std::size_t i = 1; i < length; ++i) {
      if ((byte(at + i) & 0xC0) != 0x80) return false;
      code = code << 6 | (byte(at + i) & 0x3F);
    }
    constexpr unsigned kLeast[] = {0, 0, 0x80, 0x800, 0x10000};
    if (code < kLeast[length] || code > 0x10FFFF) return false;
    if (code >= 0xD800 && code <= 0xDFFF) return false;
    at += length;
  }
  return true;
}

TEST(TextsTest, Utf8IsAsDefined) {
  // All pairs, and behind each a choice of third and fourth bytes.
  const std::string ends[] = {"",         "\x7F",     "\x80",    "\xBF",
                              "\x80\x80", "\xBF\xBF", "\x80\xC0"};
  for (unsigned pair = 0; pair < 0x10000; ++pair) {
    for (const std::string& end : ends) {
      const std::string text = std::string{static_cast<char>(pair >> 8),
                                           static_cast<char>(pair & 0xFF)} +
                               end;
      ASSERT_EQ(isPlainUtf8(text),
                HX_FindBadUtf8(text) == std::string_view::npos)
          << std::hex << pair << " + " << end.size();
      ASSERT_EQ(std::string_view::npos, HX_FindBadUtf8(HX_OneLine(text)));
    }
  }
  // The step over eight bytes finds the same place at every offset.
  for (std::size_t at = 0; at < 20; ++at)
    EXPECT_EQ(at, HX_FindBadUtf8(std::string(at, 'a') + "\xFF" +
                                 std::string(9, 'b')));
}

TEST(TextsTest, PlacesCountFromOne) {
  EXPECT_EQ("1:1", HX_PlaceOf("ab\ncd", 0));
  EXPECT_EQ("1:3", HX_PlaceOf("ab\ncd", 2));
  EXPECT_EQ("2:1", HX_PlaceOf("ab\ncd", 3));
}

TEST(TextsTest, NumbersCompareByValue) {
  const char* ascending[] = {"",
                             "a",
                             "a b",
                             "a/b",
                             "v",
                             "v0",
                             "v1",
                             "v01",
                             "v2",
                             "v2.9",
                             "v2.10",
                             "v10",
                             "v10a",
                             "va",
                             "x99999999999999999999",
                             "x100000000000000000000",
                             "\xE4\xBD\xA0"};
  for (const char* const& a : ascending) {
    for (const char* const& b : ascending) {
      // "v01" and "v1" have equal values: the byte decides.
      const bool isLess =
          std::string(a) == "v01" && std::string(b) == "v1"   ? true
          : std::string(a) == "v1" && std::string(b) == "v01" ? false
                                                              : &a < &b;
      EXPECT_EQ(isLess, HX_NaturalLess(a, b)) << a << " < " << b;
    }
  }
}

TEST(TextsTest, LiteralsGiveNumbers) {
  const struct {
    const char* text;
    std::vector<double> numbers;  // empty: no literal
  } rows[] = {
      {"5", {5}},
      {" -1.5e3 ", {-1500}},
      {"+.5", {0.5}},
      {"[1 2; 3,4]", {1, 2, 3, 4}},
      {"[ 7 ]", {7}},
      {"[1\n2]", {1, 2}},
      {"single(0.5)", {0.5}},
      {"int8([1 2])", {1, 2}},
      {"true", {1}},
      {"false", {0}},
      {"", {}},
      {"[]", {}},
      {"Ts", {}},
      {"inf", {}},
      {"-inf", {}},
      {"nan", {}},
      {"1 2", {}},
      {"2*pi", {}},
      {"[1 2", {}},
      {"1e999", {}},
      {"0x10", {}},
      {"sin(1)", {}},
      {"[1 - 2]", {}},
      {"-", {}},
      {"1..2", {}},
  };
  for (const auto& row : rows)
    EXPECT_EQ(row.numbers,
              HX_ReadNumbers(row.text).value_or(std::vector<double>()))
        << row.text;
}

TEST(TextsTest, DimensionsGiveElements) {
  const std::pair<const char*, int> rows[] = {
      {"3", 3},         {"[2 3]", 6}, {"[255 257]", 65535},
      {"[256 256]", 1}, {"-1", 1},    {"[3 0.5]", 1},
      {"n", 1},         {"", 1},      {"0", 1},
      {"20.0", 20},
  };
  for (const auto& [text, elements] : rows)
    EXPECT_EQ(elements, HX_ReadDimensions(text)) << text;
}

TEST(TextsTest, LabelsOfStatesHoldNames) {
  const std::pair<const char*, const char*> states[] = {
      {"Off", "Off"},
      {"Heat/ en: x;", "Heat"},
      {" Heat \nen: x;", "Heat"},
      {"a\r\nb", "a"},
      {"", ""},
      {"/x", ""},
      {"\xE4\xBD\xA0\xE5\xA5\xBD", "\xE4\xBD\xA0\xE5\xA5\xBD"},
  };
  for (const auto& [label, name] : states)
    EXPECT_EQ(name, HX_StateName(label)) << label;
  const std::pair<const char*, const char*> functions[] = {
      {"f(x)", "f"},
      {"y = f(x)", "f"},
      {"[a, b] = f (x, y)", "f"},
      {"f", "f"},
      {"f(x = 1)", "f"},
      {"y=f", "f"},
      {" f( )\n", "f"},
      {"[a,b]=\xCF\x81(x)", "\xCF\x81"},
  };
  for (const auto& [signature, name] : functions)
    EXPECT_EQ(name, HX_FunctionName(signature)) << signature;
}

}  // namespace
