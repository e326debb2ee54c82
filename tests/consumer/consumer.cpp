// Expands one name and hears of one problem, which takes the library, the
// platform layer and what the second calls back in the first.
//
// Prints: Sa1_Speed_Gain 408
#include <cstdio>

#include "Naming/HxCNames.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HX_Block.h"

int main() {
  HxCNames::boot();
  int reported = 0;
  HX_MessageHandler::instance().setSink(
      [&](const HX_Message& message) { reported = message.row; });

  HX_Block controller("Controller");
  controller.setSubsystem("a", 1);
  HX_Block gain("Speed Gain", &controller);
  HxCNames names;
  HxCCIdentifier id("$S_$B");
  id.setSourceRef(gain.getSrcRef());
  names.createNameFromForm(id, nullptr, 0, 0, false);
  id.makeCIdentifier();
  names.isStringValidCVariableName("while");

  const KyCXString name = id.getCookedName(HxCCIdentifier::eActualName);
  std::printf("%s %d\n", name.cstring(), reported);
  HxCNames::shutdown();
  return 0;
}
