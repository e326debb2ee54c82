// Threads of the system under names of our own, because the header of the
// system declares the calls of HX_OsThread.h too. Private to
// platform/os/windows.

#ifndef PLATFORM_OS_WINDOWS_HX_WINDOWSTHREAD_H
#define PLATFORM_OS_WINDOWS_HX_WINDOWSTHREAD_H

/// The call of the same name without "HX_Windows".
void* HX_WindowsGetCurrentThread();
int HX_WindowsGetThreadPriority(void* thread);
int HX_WindowsSetThreadPriority(void* thread, int priority);

#endif  // PLATFORM_OS_WINDOWS_HX_WINDOWSTHREAD_H
