#include "Control/HX_SelfCheck.h"

#include "Control/ERR_Messages.h"
#include "platform/messages/ERR_MessageHandler.h"

namespace hx_detail {

void failDebugCheck(const char* expression, const char* file, int line) {
  if (!ShowInternalInfo()) return;
  if (HX_DebugReport(file, line, expression) == 1) HX_DebugBreak();
}

void failAssertion(const char* fileCode, const char* file, int line) {
  failDebugCheck("0", file, line);
  ERR_Msg7(fileCode, line);
}

}  // namespace hx_detail
