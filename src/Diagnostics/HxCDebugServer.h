// Measures a code generation run: event counters, clocks, nested run times and
// a protocol of free-form entries.
//
//   HxCDebugServer server;
//   server.boot();
//   server.runTimeStart("Optimise");
//   server.clockStart(eClockEvalMlExpr);
//   ...
//   server.clockStop(eClockEvalMlExpr);
//   server.runTimeEnd("Optimise");
//   server.printCurrentResults("after optimisation");
//
// HX_DebugLog.txt then holds, in the working directory:
//
//   Begin with debug/performance of the CodeGeneration
//
//   START Optimise..........................
//   END   Optimise..........................       1234us
//
// and the results, where "us" is written as ISO-8859-1 with a micro sign (the
// byte 0xB5). HX_DebugProtocol.txt holds the protocol.

#ifndef DIAGNOSTICS_HXCDEBUGSERVER_H
#define DIAGNOSTICS_HXCDEBUGSERVER_H

#include <cstddef>
#include <cstdint>

#include "Control/HX_Allocated.h"
#include "Diagnostics/HxCDebugElements.h"
#include "HX_Export.h"

class HX_BuildNumber;

/// The last constructed instance is the registered one. Not copied, because
/// the destruction of a copy would unregister the original.
///
/// Each operation opens its file, writes and closes the file: between two
/// operations the files are complete. If a file cannot be opened, the text is
/// lost without a report. Values outside the enumerations are ignored, null
/// texts count as empty, texts above their limit are cut. Only boot() asks
/// whether the server is booted. Sums wrap around at 64 bits. One thread;
/// nothing is locked.
///
/// MEMORY: nothing throws. Only printCurrentResults() needs memory, and writes
/// nothing without.
class HX_UTILS_API HxCDebugServer : public HX_Allocated {
 public:
  /// Sums of one clock, in raw times: ticks of the high-resolution counter; on
  /// a machine without counter, milliseconds of the process clock.
  struct HxCDebugClock {
    std::int64_t total = 0;         ///< of all intervals that ended
    std::int64_t maximum = 0;       ///< the longest single interval
    std::int64_t runningStart = 0;  ///< 0: not running
    std::int64_t calls = 0;         ///< counted starts
  };

  /// A run time under way.
  struct HxCDebugRuntime {
    static constexpr int kMaxNameLength = 63;  ///< in bytes; the rest is cut
    std::int64_t start = 0;                    ///< raw time
    char name[kMaxNameLength + 1] = "";        ///< zero-terminated
  };

  HxCDebugServer();
  HxCDebugServer(const HxCDebugServer&) = delete;
  HxCDebugServer& operator=(const HxCDebugServer&) = delete;
  /// Leaves no instance registered, not even another instance.
  ~HxCDebugServer();

  /// RETURNS: the registered instance, or null.
  static HxCDebugServer* getDebugServer() { return s_pDebugServer; }

  /// Chooses the clock, starts a new log, clears the counters and numbers the
  /// protocol from 1 again. Clocks and run times stay. Before the first boot()
  /// the clock is the process clock; an interval across a change of the clock
  /// has a meaningless time. Does nothing while the server is booted.
  /// RETURNS: true
  bool boot();

  /// Allows the next boot(). Writes nothing. RETURNS: true
  bool shutdown();

  /// Adds 1.
  void count(ScEDebugCounter counter);
  /// RETURNS: the count; 0 for a value outside the enumeration.
  std::int64_t getCounter(ScEDebugCounter counter) const;

  /// Starts and counts an interval; ignored while the clock is running. At the
  /// raw time 0 the start is counted, but the clock does not run.
  void clockStart(ScEDebugClock clock);
  /// Ends the interval; ignored while the clock is not running.
  void clockStop(ScEDebugClock clock);
  /// Clears the sums; a running clock stops uncounted.
  void clockReset(ScEDebugClock clock);

  /// Begins a run time inside the active run times; logs and prints the START
  /// line. The 11th nested run time is ignored and writes no line.
  /// \param name  cut to 63 characters, in the line to 40 columns
  void runTimeStart(const char* name);

  /// Ends the innermost run time \p name; logs and prints the END line with
  /// the duration in microseconds.
  ///
  /// Inner run times without END are dropped after the line "Missing END
  /// runtimes". Without an active run time \p name only the line "Invalid END
  /// runtime - no active START found with that name" is written.
  void runTimeEnd(const char* name);

  /// Appends a numbered line to the protocol, which the server never empties.
  /// \param format  as for printf(); the result is cut to 1023 characters
  void protocolEntry(char* format, ...)
#if defined(__GNUC__)
      __attribute__((format(printf, 2, 3)))
#endif
      ;

  /// RETURNS: the number of the last protocol entry of the registered instance;
  /// 0 before the first entry and without an instance.
  static std::int64_t getCurrentProtocolIndex();

  /// Appends a table of all counters and clocks to the log, under \p title.
  /// Running intervals are not counted; counters and clocks stay.
  void printCurrentResults(const char* title);

  /// Takes over build time and date (each cut to 49 characters), long version
  /// text (99) and model name (259). Texts missing in \p build are empty.
  void setModelInfo(HX_BuildNumber* build, char* modelName);

  /// Appends the texts of setModelInfo() to the log. Only the host calls this
  /// operation.
  void logModelInfo() { printModelInfo(); }

 private:
  static constexpr int kMaxRunTimes = 10;

  void printModelInfo();
  void getCurrentTime(std::int64_t& time, bool useProcessClock) const;
  std::int64_t getProtocolIndex();
  void transformTimeIntoMicroSeconds(std::int64_t& time) const;

  int findRunTime(const char* name) const;

  static HxCDebugServer* s_pDebugServer;

  bool m_Booted = false;
  std::int64_t m_Frequency = 0;  // ticks per second
  bool m_HasPerformanceCounter = false;
  std::int64_t m_Counters[kDebugCounters] = {};
  HxCDebugClock m_Clocks[kDebugClocks];
  HxCDebugRuntime m_RunTimes[kMaxRunTimes];  // a stack
  int m_ActiveRunTimes = 0;                  // its height
  char m_BuildTime[50] = "";
  char m_BuildDate[50] = "";
  char m_Version[100] = "";
  char m_ModelName[260] = "";
  std::int64_t m_ProtocolIndex = 0;  // of the last entry
};

#endif  // DIAGNOSTICS_HXCDEBUGSERVER_H
