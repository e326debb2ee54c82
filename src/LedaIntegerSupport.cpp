#include "LedaIntegerSupport.h"

namespace hx_detail {

constinit leda::integer ledaLargestInt64;
constinit leda::integer ledaSmallestInt64;

}  // namespace hx_detail

void LedaIntegerSupportBoot() {
  hx_detail::ledaLargestInt64 =
      toInteger(std::numeric_limits<long long>::max());
  hx_detail::ledaSmallestInt64 =
      toInteger(std::numeric_limits<long long>::min());
}
