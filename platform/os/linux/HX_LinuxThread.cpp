// Priority levels are nice values of the thread: on Linux the nice value
// belongs to a thread and is reached through the thread id.

#include <errno.h>
#include <sys/resource.h>
#include <unistd.h>

#include <cstdint>

#include "platform/os/HX_OsThread.h"

namespace {

struct LevelRow {
  int level;
  int nice;
};

// From the least to the most urgent.
constexpr LevelRow kLevels[] = {{-15, 19}, {-2, 10}, {-1, 5},  {0, 0},
                                {1, -5},   {2, -10}, {15, -20}};

id_t threadId(HX_ThreadHandle thread) {
  return static_cast<id_t>(reinterpret_cast<std::uintptr_t>(thread));
}

}  // namespace

HX_ThreadHandle GetCurrentThread() {
  const auto id = static_cast<std::uintptr_t>(gettid());
  return reinterpret_cast<HX_ThreadHandle>(id);
}

int GetThreadPriority(HX_ThreadHandle thread) {
  errno = 0;
  const int nice = getpriority(PRIO_PROCESS, threadId(thread));
  if (nice == -1 && errno != 0) return THREAD_PRIORITY_ERROR_RETURN;
  int level = kLevels[0].level;
  for (const LevelRow& row : kLevels)
    if (nice <= row.nice) level = row.level;
  return level;
}

int SetThreadPriority(HX_ThreadHandle thread, int priority) {
  for (const LevelRow& row : kLevels) {
    if (row.level != priority) continue;
    return setpriority(PRIO_PROCESS, threadId(thread), row.nice) == 0 ? 1 : 0;
  }
  return 0;
}
