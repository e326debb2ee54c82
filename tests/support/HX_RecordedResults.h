// Results of operations, recorded as text: arguments and result of each call.
//
//   # floor with snapping            a remark
//   FPS_RoundDown(x)                 the operation of the rows below
//   2.9999999999 = 3                 arguments = result

#ifndef SUPPORT_HX_RECORDEDRESULTS_H
#define SUPPORT_HX_RECORDEDRESULTS_H

#include <gtest/gtest.h>

#include <bit>
#include <charconv>
#include <cmath>
#include <concepts>
#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <limits>
#include <map>
#include <sstream>
#include <string>
#include <vector>

/// The arguments of a row; 0 behind the last argument.
struct HX_Arguments : std::vector<std::string> {
  const char* text(std::size_t i) const {
    return i < size() ? (*this)[i].c_str() : "0";
  }
  /// "snan" is a signalling NaN.
  double real(std::size_t i) const {
    return text(i) == std::string("snan")
               ? std::numeric_limits<double>::signaling_NaN()
               : std::strtod(text(i), nullptr);
  }
  long long integer(std::size_t i) const {
    return std::strtoll(text(i), nullptr, 10);
  }
};

/// The shortest text that reads back as the same value; "nan" for a quiet NaN,
/// whatever the sign.
inline std::string HX_TextOf(double value) {
  if (std::isnan(value))
    return std::bit_cast<std::uint64_t>(value) >> 51 & 1 ? "nan" : "snan";
  char text[64];
  return {text, std::to_chars(text, text + sizeof text, value).ptr};
}
inline std::string HX_TextOf(const std::string& text) { return text; }
template <std::integral T>
std::string HX_TextOf(T value) {
  return std::to_string(value);
}

/// By the text of the operation in the file.
using HX_Operations =
    std::map<std::string, std::function<std::string(const HX_Arguments&)>>;

/// An expression of the arguments row; x, b and v are the first two as numbers
/// and the first as an integer.
#define HX_OF(expression)                                   \
  {                                                         \
#expression, [](const HX_Arguments& row) {                \
      [[maybe_unused]] const double x = row.real(0);        \
      [[maybe_unused]] const double b = row.real(1);        \
      [[maybe_unused]] const long long v = row.integer(0);  \
      return HX_TextOf(expression);                         \
    } \
  }

/// Repeats the calls of \p file of the test folder and expects the recorded
/// results, at least one for every operation.
inline void HX_ExpectRecorded(const std::string& file,
                              const HX_Operations& operations) {
  std::ifstream stream(HX_RECORDED_FOLDER "/" + file);
  std::map<std::string, int> calls;
  std::string operation;
  for (std::string line; std::getline(stream, line);) {
    const std::size_t end = line.find(" = ");
    if (line.empty() || line[0] == '#') continue;
    if (end == line.npos) {
      operation = line;
      continue;
    }
    HX_Arguments arguments;
    std::istringstream texts(line.substr(0, end));
    for (std::string text; texts >> text;) arguments.push_back(text);
    EXPECT_EQ(operations.at(operation)(arguments), line.substr(end + 3))
        << operation << " of " << line;
    ++calls[operation];
  }
  EXPECT_EQ(calls.size(), operations.size());
}

#endif  // SUPPORT_HX_RECORDEDRESULTS_H
