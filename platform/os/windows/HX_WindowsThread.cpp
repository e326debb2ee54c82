#include "platform/os/windows/HX_WindowsThread.h"

#include <windows.h>

void* HX_WindowsGetCurrentThread() { return GetCurrentThread(); }

int HX_WindowsGetThreadPriority(void* thread) {
  return GetThreadPriority(thread);
}

int HX_WindowsSetThreadPriority(void* thread, int priority) {
  return SetThreadPriority(thread, priority) != 0 ? 1 : 0;
}
