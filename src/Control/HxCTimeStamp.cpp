#include "Control/HxCTimeStamp.h"

#include "Control/ERR_Messages.h"
#include "SystemServices/HX_SystemCall.h"
#include "platform/strings/KyCXString.h"

HxCTimeStamp::~HxCTimeStamp() = default;

double HxCTimeStamp::getTimeStamp() const {
  return HX_SystemCall().getTimeStamp();
}

bool HxCTimeStamp::emitElapsedTime(double start, KyCXString& label) {
  const double now = getTimeStamp();
  ERR_Msg2(label.cstring(), HX_SystemCall().getDeltaTimeInSec(start, now));
  return true;
}
