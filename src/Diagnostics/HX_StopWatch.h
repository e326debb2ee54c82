// Named stop watches with a report of calls, times and sub-watches.
//
//   HX_StopWatch all("All"), sort("Sort");
//   all.start();
//   sort.start();
//   ...
//   sort.stop();                     // a sub-watch of "All"
//   all.stop();
//   HX_StopWatch::endStopWatches();  // writes HX_StopWatch.html

#ifndef DIAGNOSTICS_HX_STOPWATCH_H
#define DIAGNOSTICS_HX_STOPWATCH_H

#include <cstdint>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/containers/dictionary.h"

/// Sums the time between start() and stop(), in microseconds.
///
/// A new watch is registered under a fresh id. When a watch stops, every
/// running registered watch records the stopped watch as a sub-watch: one call,
/// and the run's own time (the run without the times already reported to the
/// stopped watch). The order of the starts does not matter. Example:
///
///     P  |---------------------|   50 us   records Q: 20 us, R: 10 us
///     Q      |-------------|       30 us   records R: 10 us
///     R          |-----|           10 us
///
/// A copy takes over all values, the id included, but is not registered: the
/// report has no row for a copy, and a copy records no sub-watches. Assignment
/// takes over the same values; a registered target stays registered under its
/// old id. Destroying a watch unregisters the watch with the same id (for a
/// copy: the original) and the destroyed watch.
///
/// Sums wrap around: at 64 bits in a watch, at 32 bits (35 minutes) in the
/// record of one sub-watch. One thread; nothing is locked. Watches may be
/// static objects of a host: the register lives from load to process end.
///
/// MEMORY: nothing throws. Without memory a new watch measures but is not
/// registered, a copy has no records of sub-watches, an assignment changes
/// nothing, a running watch does not record a new sub-watch, and
/// endStopWatches() does nothing.
class HX_UTILS_API HX_StopWatch : public HX_Allocated {
 public:
  /// \param name  cut to 255 characters; null counts as empty. The report
  ///     shows the name unchanged, HTML included.
  explicit HX_StopWatch(const char* name);
  HX_StopWatch(const HX_StopWatch& other);
  HX_StopWatch& operator=(const HX_StopWatch& other);
  ~HX_StopWatch();

  /// Starts a run. A running watch raises a debug report and keeps the start
  /// time. The watch does not start while the clock shows 0.
  void start();

  /// Ends the run. A watch without a run raises a debug report and does not
  /// change.
  /// COST: one clock reading and a visit to the running watches, however many
  /// others are registered.
  void stop();

  /// OWNERSHIP: the watch owns the text.
  const char* getName() const { return m_Name; }

  /// Microseconds of all completed runs.
  std::int64_t getTotalTime() const { return m_TotalTime; }

  /// Writes HX_StopWatch.html into the working directory: one table row per
  /// registered watch in the order of creation, with calls, time with
  /// sub-watches, the sub-watches, time without sub-watches. Then unregisters
  /// all watches and lets ids start at 0 again. Watches keep their values; runs
  /// under way go on, but no later report shows the watch.
  ///
  /// A sub-watch without registration is shown with an empty name. Without a
  /// registered watch nothing happens. A file that cannot be opened is not
  /// reported.
  static void endStopWatches();

 private:
  using Registry = leda::dictionary<int, HX_StopWatch*, leda::ab_tree>;
  using PerSubWatch = leda::dictionary<int, std::int32_t, leda::ab_tree>;
  struct Report;

  static constexpr int kMaxNameLength = 255;
  static constexpr int kNotRegistered = -1;

  bool isActive() const { return m_Start != 0; }
  void addIntervalOfSubWatch(std::int64_t time, int subWatchId);
  void addIntervalToActiveWatches(std::int64_t time);
  static void writeReport();
  static void terminate();

  void tellListener(std::int64_t interval) const;
  void assignPlainFields(const HX_StopWatch& other);
  static Registry& watches();
  static void unregister(int key);
  void updateRunningList();
  void unlink();

  static int WatchIdCounter;            // the id of the next watch
  static std::int64_t m_ProcessorFreq;  // ticks per second
  static bool m_PerformanceCounter;
  static bool m_bInit;              // whether the two above are set
  static HX_StopWatch* s_pRunning;  // head of the running watches

  int m_Id;
  std::int64_t m_TotalTime = 0;     // microseconds
  std::int64_t m_SubWatchTime = 0;  // microseconds, of the current run
  int m_Calls = 0;                  // completed runs
  std::int64_t m_Start = 0;         // raw time; 0: not running
  // Both dictionaries hold the same ids.
  PerSubWatch m_SubWatchCalls;  // id -> runs
  PerSubWatch m_SubWatchTimes;  // id -> microseconds
  char m_Name[kMaxNameLength + 1];

  // Key of this object in the registry; kNotRegistered if there is no entry.
  // After an assignment the key differs from the id.
  int m_RegistryKey = kNotRegistered;
  // List of the running registered watches, unordered, for stop(). A watch is
  // linked exactly while running and registered.
  bool m_IsLinked = false;
  HX_StopWatch* m_pPrevious = nullptr;
  HX_StopWatch* m_pNext = nullptr;
};

#endif  // DIAGNOSTICS_HX_STOPWATCH_H
