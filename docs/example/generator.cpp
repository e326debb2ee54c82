// A generator in forty lines: forms the names of two signals, keeps them apart,
// and hears of problems through its own platform layer.
//
// Prints:
//   Sa1_Speed_Gain
//   Sa1_Speed_Gain_a
//   1 problem reported
#include <cstdio>

#include "NameSpace/HX_LimitedNameSpace.h"
#include "Naming/HxCNames.h"
#include "messages.h"
#include "platform/model/HX_Block.h"

int main() {
  HxCNames::boot();

  HX_Block controller("Controller");
  controller.setSubsystem("a", 1);
  HX_Block gain("Speed Gain", &controller);

  HxCNames names;
  HX_LimitedNameSpace taken;
  for (const char* nameTemplate : {"$S_$B", "$S_$B"}) {
    HxCCIdentifier id(nameTemplate);
    id.setSourceRef(gain.getSrcRef());
    names.createNameFromForm(id, nullptr, 0, 0, false);
    id.makeCIdentifier();
    KyCXString name = id.getCookedName(HxCCIdentifier::eActualName);
    taken.addUnique(name);
    std::printf("%s\n", name.cstring());
  }

  // A keyword is reported as message 408, which ends up in messages.cpp.
  names.isStringValidCVariableName("while");
  std::printf("%d problem reported\n", reportedProblems());
  HxCNames::shutdown();
  return 0;
}
