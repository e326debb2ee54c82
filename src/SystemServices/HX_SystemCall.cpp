#include "SystemServices/HX_SystemCall.h"

#include <cstdlib>
#include <ctime>
#include <utility>

#include "Control/HX_Memory.h"
#include "platform/os/HX_OsClock.h"
#include "platform/os/HX_OsThread.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr double kMillisecondsPerSecond = 1000.0;

KyCXString* localTimeText(const char* format) {
  tzset();
  const std::time_t now = std::time(nullptr);
  char buffer[20] = "";
  std::strftime(buffer, sizeof buffer, format, std::localtime(&now));
  KyCXString* none = nullptr;
  return HX_WithinMemory(none, [&] { return new KyCXString(buffer); });
}

}  // namespace

double HX_SystemCall::getTimeStamp() const {
  return static_cast<double>(HX_ProcessClock());
}

double HX_SystemCall::getDeltaTimeInSec(double earlier, double later) {
  return (later - earlier) / kMillisecondsPerSecond;
}

KyCXString* HX_SystemCall::getStandardDateString() {
  return localTimeText("%Y-%m-%d");
}

KyCXString* HX_SystemCall::getStandardTimeString() {
  return localTimeText("%H:%M:%S");
}

bool HX_SystemCall::setCurrentThreadPriority(int priority) {
  return SetThreadPriority(GetCurrentThread(), priority) != 0;
}

bool HX_SystemCall::setLowestThreadPriorityToCurrentThread(int& previous) {
  previous = 0;
  HX_ThreadHandle thread = GetCurrentThread();
  if (thread == nullptr) return false;
  previous = GetThreadPriority(thread);
  SetThreadPriority(thread, THREAD_PRIORITY_LOWEST);
  return true;
}

bool HX_SystemCall::substituteEnvVariable(KyCXString& text) {
  const int open = text.find('%', 0);
  if (open < 0) return true;
  const int close = text.find('%', open + 1);
  if (close < 0) return true;
  return HX_WithinMemory([&] {
    const KyCXString name = text.sub(open + 1, close - 1);
    const char* value = std::getenv(name.cstring());
    if (value == nullptr) return;
    text = KyCXString(value) + text.sub(close + 1, text.length() - 1);
  });
}
