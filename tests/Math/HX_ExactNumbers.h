// Exact integers and extreme values for the tests of the arithmetic.

#ifndef MATH_HX_EXACTNUMBERS_H
#define MATH_HX_EXACTNUMBERS_H

#include <boost/multiprecision/cpp_int.hpp>
#include <cmath>
#include <limits>
#include <vector>

using Integer =
    boost::multiprecision::number<boost::multiprecision::cpp_int_backend<>,
                                  boost::multiprecision::et_off>;

constexpr long long kMin64 = std::numeric_limits<long long>::min();
constexpr long long kMax64 = std::numeric_limits<long long>::max();
constexpr double kInf = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

inline double above(double x) { return std::nextafter(x, kInf); }
inline double below(double x) { return std::nextafter(x, -kInf); }

/// The neighbourhood of 0 and of all powers of two, both signs.
inline std::vector<long long> boundaryValues() {
  std::vector<long long> values = {0, kMin64, kMin64 + 1, kMax64, kMax64 - 1};
  for (int bit = 0; bit < 63; ++bit) {
    for (long long offset : {-1, 0, 1}) {
      const long long value = (1LL << bit) + offset;
      values.insert(values.end(), {value, -value});
    }
  }
  return values;
}

#endif  // MATH_HX_EXACTNUMBERS_H
