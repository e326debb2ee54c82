// Calls what texts, containers and model take part in.
//
// Prints:
//   Sa1_Speed_Gain
//   Sa1_Speed_Gain_a
//   a_very_long_name_that_has_to_fit_into_31
//   a_very_long_name_that_has_to__a
//   x=2 y=1 rest
//   -9223372036854775808
#include <cstdio>

#include "LedaIntegerSupport.h"
#include "NameSpace/HX_LimitedNameSpace.h"
#include "Naming/HxCNames.h"
#include "Strings/HX_StringParser.h"
#include "model.h"

#ifdef PLATFORM_STRINGS_KYCXSTRING_H
#error The texts of the library are in the way
#endif

int main() {
  HxCNames::boot();
  LedaIntegerSupportBoot();
  HX_Block gain("Speed Gain", "a");
  HxCNames names;
  HX_LimitedNameSpace taken;
  for (int i = 0; i < 2; ++i) {
    HxCCIdentifier id("$S_$B");
    id.setSourceRef(gain.getSrcRef());
    names.createNameFromForm(id, nullptr, 0, 0, false);
    id.makeCIdentifier();
    KyCXString name = id.getCookedName(HxCCIdentifier::eActualName);
    taken.addUnique(name);
    std::printf("%s\n", name.cstring());
  }
  for (int i = 0; i < 2; ++i) {
    KyCXString name("a_very_long_name_that_has_to_fit_into_31");
    taken.addUnique(name);
    std::printf("%s\n", name.cstring());
  }

  leda::array<KyCXString> keys(2), values(2);
  keys[0] = "x";
  keys[1] = "y";
  const KyCXString rest = HX_StringParser().parseKeyValuePairs(
      "y=1; x = 2;rest", "=", ";", keys, values);
  std::printf("x=%s y=%s %s\n", values[0].cstring(), values[1].cstring(),
              rest.cstring());
  std::printf("%lld\n",
              toInt64(toInteger(-9223372036854775807LL - 1) + toInteger(-1LL)));
  HxCNames::shutdown();
  return 0;
}
