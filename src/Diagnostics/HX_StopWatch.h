// Named stop watches that know which of them ran inside which.
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

/// Accumulates the time between its starts and stops, in microseconds.
///
/// A constructed watch is registered under a fresh id. When a watch stops,
/// every registered watch that is running at that moment, whichever was started
/// first, records it as a sub-watch, with the part of its run that its own
/// sub-watches have not already recorded. With P, Q and R nested, P thus
/// records R's time for R and the rest of Q's for Q.
///
/// Copies and assignment take over everything, the id included, but not the
/// registration: a copy is not in the report and is not told of sub-watches,
/// while a registered watch stays registered where it was and runs on as its
/// new content says. Destroying a watch unregisters the watch that is
/// registered under its id (for a copy: the original) and the watch itself.
///
/// Sums wrap around: at 64 bits in a watch, at 32 bits (35 minutes) in what it
/// records of one sub-watch. One thread; nothing is locked.
class HX_UTILS_API HX_StopWatch : public HX_Allocated {
 public:
  /// \param name  cut to 255 characters; null gives an empty name. The report
  ///     shows it as it is, HTML included.
  explicit HX_StopWatch(const char* name);
  HX_StopWatch(const HX_StopWatch& other);
  HX_StopWatch& operator=(const HX_StopWatch& other);
  ~HX_StopWatch();

  /// Starts a run. A watch that is running raises a debug report and keeps its
  /// start time. Where the clock shows 0, the watch does not start.
  void start();

  /// Ends the run: one clock reading and a visit to the running watches,
  /// however many others are registered. A watch that is not running raises a
  /// debug report and stays as it is.
  void stop();

  /// Owned by the watch.
  const char* getName() const { return m_Name; }

  /// Microseconds of all completed runs.
  std::int64_t getTotalTime() const { return m_TotalTime; }

  /// Writes HX_StopWatch.html into the working directory, one table row per
  /// registered watch in the order of their creation: calls, time with
  /// sub-watches, the sub-watches, time without them. Then unregisters all
  /// watches, which keep their values, and lets ids start at 0 again; runs
  /// under way go on but are in no later report.
  ///
  /// A sub-watch that is no longer registered is shown without its name.
  /// Without a registered watch nothing happens. A file that cannot be opened
  /// is not reported.
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
  static void terminate();

  void tellListener(std::int64_t interval) const;
  void assignFields(const HX_StopWatch& other);
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
  PerSubWatch m_SubWatchCalls;      // id -> runs
  PerSubWatch m_SubWatchTimes;      // id -> microseconds
  char m_Name[kMaxNameLength + 1];

  // The key of this object in the registry, which differs from its id after an
  // assignment; -1 when it is not registered.
  int m_RegistryKey = kNotRegistered;
  // The running watches that are registered, in no particular order, each in
  // the list exactly while it is both: stop() visits these alone.
  bool m_IsLinked = false;
  HX_StopWatch* m_pPrevious = nullptr;
  HX_StopWatch* m_pNext = nullptr;
};

#endif  // DIAGNOSTICS_HX_STOPWATCH_H
