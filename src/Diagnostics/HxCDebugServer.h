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
#include <string>

#include "Control/HX_Allocated.h"
#include "Diagnostics/HxCDebugElements.h"
#include "HX_Export.h"

class HX_BuildNumber;

/// The instance that was constructed last is the registered one. Not copied: a
/// copy's destruction would unregister the original.
///
/// Files are complete after each operation: it opens the file, writes and
/// closes it. A file that cannot be opened is not reported and the text is
/// lost. Values outside the enumerations are ignored, null texts count as
/// empty, texts that exceed their limit are cut. No operation but boot() asks
/// whether the server is booted. Sums wrap around at 64 bits. One thread;
/// nothing is locked.
class HX_UTILS_API HxCDebugServer : public HX_Allocated {
 public:
  /// Sums of one clock, in raw times: ticks of the high-resolution counter or,
  /// where there is none, milliseconds of the process clock.
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
  /// Leaves no instance registered, whichever it was.
  ~HxCDebugServer();

  /// The registered instance, null if there is none.
  static HxCDebugServer* getDebugServer() { return s_pDebugServer; }

  /// Chooses the clock, starts a new log, clears the counters and numbers the
  /// protocol from 1 again. Clocks and run times stay. Before the first boot()
  /// the clock is the process clock; what runs across a change of the clock
  /// gets a meaningless time. Nothing happens while the server is booted.
  /// \return true
  bool boot();

  /// Allows the next boot(). Writes nothing. \return true
  bool shutdown();

  /// Adds 1.
  void count(ScEDebugCounter counter);
  /// 0 for a value outside the enumeration.
  std::int64_t getCounter(ScEDebugCounter counter) const;

  /// Starts and counts an interval; ignored while the clock is running. Where
  /// the raw time is 0, the start is counted but the clock does not run.
  void clockStart(ScEDebugClock clock);
  /// Ends the interval; ignored while the clock is not running.
  void clockStop(ScEDebugClock clock);
  /// Clears the sums; a running clock stops uncounted.
  void clockReset(ScEDebugClock clock);

  /// Begins a run time inside those that are active and logs and prints its
  /// START line. The 11th nested one is ignored, its line included.
  /// \param name  known by its first 63 characters, shown by what fits into 40
  ///     columns
  void runTimeStart(const char* name);

  /// Ends the innermost run time \p name and logs and prints its END line with
  /// the microseconds it took.
  ///
  /// Run times inside it that did not end are dropped after the line "Missing
  /// END runtimes". Without an active run time of that name the line "Invalid
  /// END runtime - no active START found with that name" is all that happens.
  void runTimeEnd(const char* name);

  /// Appends a numbered line to the protocol, which the server never empties.
  /// \param format  as for printf(); the result is cut to 1023 characters
  void protocolEntry(char* format, ...)
#if defined(__GNUC__)
      __attribute__((format(printf, 2, 3)))
#endif
      ;

  /// The number of the registered instance's last protocol entry; 0 before its
  /// first one and without an instance.
  static std::int64_t getCurrentProtocolIndex();

  /// Appends a table of all counters and clocks to the log, under \p title.
  /// Running intervals are not in it; nothing is changed.
  void printCurrentResults(const char* title);

  /// Takes over build time and date (each cut to 49 characters), long version
  /// text (99) and model name (259). Texts that \p build does not define are
  /// empty.
  void setModelInfo(HX_BuildNumber* build, char* modelName);

  /// Appends what setModelInfo() took over to the log. The server never does so
  /// by itself.
  void logModelInfo() { printModelInfo(); }

 private:
  static constexpr int kMaxRunTimes = 10;

  void printModelInfo();
  void getCurrentTime(std::int64_t& time, bool useProcessClock) const;
  std::int64_t getProtocolIndex();
  void transformTimeIntoMicroSeconds(std::int64_t& time) const;

  int findRunTime(const char* name) const;
  void addCounters(std::string& text) const;
  void addClocks(std::string& text) const;

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
