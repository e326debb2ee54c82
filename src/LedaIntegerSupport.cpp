#include "LedaIntegerSupport.h"

#include "Control/HX_ExportInline.h"

namespace hx_detail {

leda::integer ledaLargestInt64;
leda::integer ledaSmallestInt64;

}  // namespace hx_detail

template struct HX_ExportInline<
    static_cast<leda::integer (*)(long long)>(&toInteger),
    static_cast<leda::integer (*)(unsigned long long)>(&toInteger), &toInt64>;

void LedaIntegerSupportBoot() {
  hx_detail::ledaLargestInt64 =
      toInteger(std::numeric_limits<long long>::max());
  hx_detail::ledaSmallestInt64 =
      toInteger(std::numeric_limits<long long>::min());
}
