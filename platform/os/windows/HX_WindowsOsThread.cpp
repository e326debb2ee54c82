#include "platform/os/HX_OsThread.h"
#include "platform/os/windows/HX_WindowsThread.h"

HX_ThreadHandle GetCurrentThread() { return HX_WindowsGetCurrentThread(); }

int GetThreadPriority(HX_ThreadHandle thread) {
  return HX_WindowsGetThreadPriority(thread);
}

int SetThreadPriority(HX_ThreadHandle thread, int priority) {
  return HX_WindowsSetThreadPriority(thread, priority);
}
