// Lines of run times, protocol entries and the model information have a known
// greatest length: these texts stand in buffers on the stack, and the
// operations cannot run out of memory. Only the table of results has a title
// of any length.

#include "Diagnostics/HxCDebugServer.h"

#include <algorithm>
#include <cinttypes>
#include <cstdarg>
#include <cstdio>
#include <cstring>
#include <iterator>

#include "Diagnostics/HX_TimingListener.h"
#include "Diagnostics/implDiagnostics/HX_RawClock.h"
#include "Diagnostics/implDiagnostics/HX_ReportText.h"
#include "SystemServices/HX_BuildNumber.h"
#include "implContainers/HX_Number.h"
#include "platform/matlab/HX_MexInterface.h"
#include "platform/os/HX_OsFile.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kLogFile[] = "HX_DebugLog.txt";
constexpr char kProtocolFile[] = "HX_DebugProtocol.txt";

constexpr std::size_t kMaxEntryLength = 1023;
constexpr int kLineWidth = 40;                // of a run time, before its time
constexpr char kNoTime[] = "              ";  // as wide as the time of an END
constexpr char kMissingEnd[] = "Missing END runtimes\n";
constexpr char kInvalidEnd[] =
    "Invalid END runtime - no active START found with that name\n";

constexpr char kClockHead[] =
    "\nclocks--------------------------------------------------------------\n"
    " Nr     Calls    TotalTime    MaxTime  AverageTime Name\n"
    "--------------------------------------------------------------------\n";

#define HX_MICROSECONDS "\xB5s"  // ISO-8859-1

const char* orEmpty(const char* text) { return text == nullptr ? "" : text; }

const char* orEmpty(const KyCXString* text) {
  return text == nullptr ? "" : text->cstring();
}

// Copies as much of \p text as fits into \p field.
template <std::size_t size>
void copyCut(char (&field)[size], const char* text) {
  const std::size_t length = strnlen(text, size - 1);
  std::memcpy(field, text, length);
  field[length] = 0;
}

template <class... Args>
void appendFormatted(HX_ReportText& text, const char* format, Args... args) {
  char buffer[160];  // more than the longest line of numbers
  std::snprintf(buffer, sizeof buffer, format, args...);
  text += buffer;
}

void log(const char* text, std::size_t length) {
  HX_AppendToFile(kLogFile, text, length);
}

void logAndPrint(const char* text) {
  log(text, std::strlen(text));
  // The command window of a host may run out of memory.
  HX_WithinMemory([&] { mexPrintf("%s", text); });
}

// Logs and prints the line of a run time: indented, filled up with '.' or cut,
// then \p time.
void logRunTime(int level, const char* keyword, const char* name,
                const char* time) {
  char head[128];  // more than indentation, keyword and name
  const int length =
      std::snprintf(head, sizeof head, "%*s%s%s", level * 2, "", keyword, name);
  char line[kLineWidth + 48];  // room for the longest time and the line feed
  std::memset(line, '.', kLineWidth);
  std::memcpy(line, head,
              static_cast<std::size_t>(std::min(length, kLineWidth)));
  std::snprintf(line + kLineWidth, sizeof line - kLineWidth, "%s\n", time);
  logAndPrint(line);
}

void addCounters(HX_ReportText& text, const std::int64_t* counters) {
  text += "\ncounter-----------------------------------\n";
  for (int i = 0; i < kDebugCounters; ++i)
    appendFormatted(
        text, "Counter %03d has %09" PRId64 " calls (%s)\n", i, counters[i],
        HxCDebugElements::getCounterComment(static_cast<ScEDebugCounter>(i)));
  text += "\n";
}

void addClock(HX_ReportText& text, int index, std::int64_t calls,
              std::int64_t total, std::int64_t maximum) {
  const double average =
      calls == 0 ? 0.0
                 : static_cast<double>(total) / static_cast<double>(calls);
  char digits[32];
  HX_WriteFixed(digits, sizeof digits, average, 3);
  appendFormatted(
      text,
      "%3d %9" PRId64 " %10" PRId64 HX_MICROSECONDS " %8" PRId64 HX_MICROSECONDS
      " %10s" HX_MICROSECONDS " %s\n",
      index, calls, total, maximum, digits,
      HxCDebugElements::getClockComment(static_cast<ScEDebugClock>(index)));
}

}  // namespace

HxCDebugServer* HxCDebugServer::s_pDebugServer = nullptr;

HxCDebugServer::HxCDebugServer() { s_pDebugServer = this; }

HxCDebugServer::~HxCDebugServer() {
  if (m_Booted) shutdown();
  s_pDebugServer = nullptr;
}

bool HxCDebugServer::boot() {
  static constexpr char kHeader[] =
      "Begin with debug/performance of the CodeGeneration\n\n";
  if (m_Booted) return true;
  m_ProtocolIndex = 0;
  m_HasPerformanceCounter = hx_detail::queryFrequency(m_Frequency);
  m_Booted = true;
  HX_RewriteFile(kLogFile, kHeader, sizeof kHeader - 1);
  std::fill(std::begin(m_Counters), std::end(m_Counters), 0);
  return true;
}

bool HxCDebugServer::shutdown() {
  m_Booted = false;
  return true;
}

void HxCDebugServer::count(ScEDebugCounter counter) {
  if (counter < 0 || counter >= kDebugCounters) return;
  m_Counters[counter] = hx_detail::wrapAdd(m_Counters[counter], 1);
}

std::int64_t HxCDebugServer::getCounter(ScEDebugCounter counter) const {
  if (counter < 0 || counter >= kDebugCounters) return 0;
  return m_Counters[counter];
}

void HxCDebugServer::clockStart(ScEDebugClock clock) {
  if (clock < 0 || clock >= kDebugClocks) return;
  HxCDebugClock& c = m_Clocks[clock];
  if (c.runningStart != 0) return;
  c.calls = hx_detail::wrapAdd(c.calls, 1);
  getCurrentTime(c.runningStart, false);
}

void HxCDebugServer::clockStop(ScEDebugClock clock) {
  if (clock < 0 || clock >= kDebugClocks) return;
  HxCDebugClock& c = m_Clocks[clock];
  if (c.runningStart == 0) return;
  std::int64_t now = 0;
  getCurrentTime(now, false);
  const std::int64_t interval = hx_detail::wrapSubtract(now, c.runningStart);
  c.total = hx_detail::wrapAdd(c.total, interval);
  c.maximum = std::max(c.maximum, interval);
  c.runningStart = 0;
}

void HxCDebugServer::clockReset(ScEDebugClock clock) {
  if (clock < 0 || clock >= kDebugClocks) return;
  m_Clocks[clock] = HxCDebugClock();
}

void HxCDebugServer::runTimeStart(const char* name) {
  if (m_ActiveRunTimes >= kMaxRunTimes) return;
  HxCDebugRuntime& runTime = m_RunTimes[m_ActiveRunTimes];
  copyCut(runTime.name, orEmpty(name));
  getCurrentTime(runTime.start, false);
  logRunTime(m_ActiveRunTimes, "START ", runTime.name, kNoTime);
  ++m_ActiveRunTimes;
}

void HxCDebugServer::runTimeEnd(const char* name) {
  const int level = findRunTime(orEmpty(name));
  if (level < 0) {
    logAndPrint(kInvalidEnd);
    return;
  }
  if (level != m_ActiveRunTimes - 1) logAndPrint(kMissingEnd);
  m_ActiveRunTimes = level;

  const HxCDebugRuntime& runTime = m_RunTimes[level];
  std::int64_t duration = 0;
  getCurrentTime(duration, false);
  duration = hx_detail::wrapSubtract(duration, runTime.start);
  transformTimeIntoMicroSeconds(duration);
  char time[32];
  std::snprintf(time, sizeof time, " %10" PRId64 HX_MICROSECONDS " ", duration);
  logRunTime(level, "END   ", runTime.name, time);
  if (HX_TimingListener* listener = HX_TimingListener::installed())
    listener->runEnded(runTime.name,
                       hx_detail::rawTimeToMicroseconds(
                           runTime.start, m_HasPerformanceCounter, m_Frequency),
                       duration);
}

// Returns the level of the innermost run time \p name; -1 if none is active.
int HxCDebugServer::findRunTime(const char* name) const {
  HxCDebugRuntime wanted;
  copyCut(wanted.name, name);
  int level = m_ActiveRunTimes - 1;
  while (level >= 0 && std::strcmp(m_RunTimes[level].name, wanted.name) != 0)
    --level;
  return level;
}

void HxCDebugServer::protocolEntry(char* format, ...) {
  char text[kMaxEntryLength + 1] = "";
  std::va_list args;
  va_start(args, format);
  const int length = std::vsnprintf(text, sizeof text, orEmpty(format), args);
  va_end(args);
  if (length < 0) text[0] = 0;  // an argument without a printable form

  char line[sizeof text + 32];
  const int written = std::snprintf(line, sizeof line, "%09" PRId64 " %s\n",
                                    getProtocolIndex(), text);
  HX_AppendToFile(kProtocolFile, line, static_cast<std::size_t>(written));
}

std::int64_t HxCDebugServer::getCurrentProtocolIndex() {
  return s_pDebugServer == nullptr ? 0 : s_pDebugServer->m_ProtocolIndex;
}

void HxCDebugServer::printCurrentResults(const char* title) {
  HX_WithinMemory([&] {
    HX_ReportText text = "\n\nDebug-Results - ";
    text += orEmpty(title);
    text += "\n-----------------------------------\n";
    addCounters(text, m_Counters);
    text += kClockHead;
    for (int i = 0; i < kDebugClocks; ++i) {
      std::int64_t total = m_Clocks[i].total;
      std::int64_t maximum = m_Clocks[i].maximum;
      transformTimeIntoMicroSeconds(total);
      transformTimeIntoMicroSeconds(maximum);
      addClock(text, i, m_Clocks[i].calls, total, maximum);
    }
    text += "\n\n";
    log(text.data(), text.size());
  });
}

void HxCDebugServer::setModelInfo(HX_BuildNumber* build, char* modelName) {
  const HX_BuildNumber undefined;
  const HX_BuildNumber& source = build == nullptr ? undefined : *build;
  copyCut(m_BuildTime, orEmpty(source.getBuildTime()));
  copyCut(m_BuildDate, orEmpty(source.getBuildDate()));
  copyCut(m_Version, orEmpty(source.getLongVersionString()));
  copyCut(m_ModelName, orEmpty(modelName));
}

void HxCDebugServer::printModelInfo() {
  static constexpr char kRule[] =
      "====================================================\n";
  char text[sizeof m_ModelName + sizeof m_Version + sizeof m_BuildTime +
            sizeof m_BuildDate + 2 * sizeof kRule + 64];
  const int length = std::snprintf(
      text, sizeof text,
      "\n\n%sModel name: %s\nVersion:    %s\nBuildTime:  %s\n"
      "BuildDate:  %s\n%s",
      kRule, m_ModelName, m_Version, m_BuildTime, m_BuildDate, kRule);
  log(text, static_cast<std::size_t>(length));
}

void HxCDebugServer::getCurrentTime(std::int64_t& time,
                                    bool useProcessClock) const {
  time = hx_detail::rawTime(m_HasPerformanceCounter && !useProcessClock);
}

std::int64_t HxCDebugServer::getProtocolIndex() {
  m_ProtocolIndex = hx_detail::wrapAdd(m_ProtocolIndex, 1);
  return m_ProtocolIndex;
}

void HxCDebugServer::transformTimeIntoMicroSeconds(std::int64_t& time) const {
  time =
      hx_detail::rawToMicroseconds(time, m_HasPerformanceCounter, m_Frequency);
}
