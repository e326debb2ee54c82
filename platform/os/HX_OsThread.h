// Threads of the operating system.
//
// Priorities are levels from -15 (idle) over -2 (lowest) to -1, 0 (normal), 1,
// 2 (highest) and 15 (time critical).

#ifndef PLATFORM_OS_HX_OSTHREAD_H
#define PLATFORM_OS_HX_OSTHREAD_H

#include "platform/HX_PlatformExport.h"

/// Names a thread. A handle is not closed.
using HX_ThreadHandle = void*;

/// Levels with a name.
inline constexpr int THREAD_PRIORITY_LOWEST = -2;
inline constexpr int THREAD_PRIORITY_NORMAL = 0;
/// The answer of GetThreadPriority() for an unknown thread.
inline constexpr int THREAD_PRIORITY_ERROR_RETURN = 0x7fffffff;

/// The calling thread; null if the system gives no handle.
HX_PLATFORM_API HX_ThreadHandle GetCurrentThread();

/// The priority level of \p thread.
HX_PLATFORM_API int GetThreadPriority(HX_ThreadHandle thread);

/// Sets the priority level of \p thread.
/// RETURNS: 1; 0 for a level that does not exist or that the process may not
/// set.
HX_PLATFORM_API int SetThreadPriority(HX_ThreadHandle thread, int priority);

#endif  // PLATFORM_OS_HX_OSTHREAD_H
