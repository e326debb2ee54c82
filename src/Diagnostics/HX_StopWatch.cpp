// Problem: stop() reports to every running registered watch. The plain form
// walks the whole registry at each stop, though nearly all watches are idle.
//
// Idea: the running registered watches also form a doubly linked list without
// order (s_pRunning). stop() walks the list alone: no report depends on the
// order of the receivers.
//
// Example: A, B and C are registered, A and C run, the list is C - A.
// C.stop() unlinks C, then reports to A. B is not visited.
//
// Invariants:
//   1. A watch is linked exactly while registered and running
//      (updateRunningList() restores this after each change of either).
//   2. The registry holds no destroyed watch, and each watch at most once,
//      under m_RegistryKey.
//   3. m_SubWatchCalls and m_SubWatchTimes of a watch hold the same ids.
//
// StopWatchTest.RandomUseAccountsLikeThePlainForm compares with the plain form.

#include "Diagnostics/HX_StopWatch.h"

#include <cstring>
#include <new>
#include <utility>

#include "Control/HX_Memory.h"
#include "Control/HX_SelfCheck.h"
#include "Diagnostics/HX_TimingListener.h"
#include "Diagnostics/implDiagnostics/HX_RawClock.h"
#include "Diagnostics/implDiagnostics/HX_ReportText.h"
#include "platform/os/HX_OsFile.h"

namespace {

using hx_detail::wrapAdd;
using hx_detail::wrapSubtract;

constexpr char kSourceFile[] = "HX_StopWatch";  // of debug reports
constexpr char kReportFile[] = "HX_StopWatch.html";

constexpr char kReportHead[] =
    "<html>\n"
    "<head>\n"
    "<title>Stop Watch Output (Time in micros seconds)</title>\n"
    "<meta http-equiv=\"Content-Style-Type\" content=\"text/css\">\n"
    "</head>\n"
    "<body>\n"
    "<table><tr><th bgcolor=#FF8080>Watch</th>\n"
    "<th bgcolor=#F88088>called</th>\n"
    "<th bgcolor=#F08090>time with sub-watches</th>\n"
    "<th bgcolor=#E88098>subwatches (name/calls/time)</th>\n"
    "<th bgcolor=#E080A0>time witout sub-watches</th></tr>\n";

constexpr char kReportTail[] =
    "</table>\n"
    "</body>\n"
    "</html>\n";

// Colours of even and of odd rows, by column. The last two are not used yet.
constexpr const char* kPalettes[2][7] = {
    {"80F080", "80E090", "80D0A0", "80C0B0", "80B0C0", "80A0D0", "8090E0"},
    {"B0F080", "B0E090", "B0D0A0", "B0C0B0", "B0B0C0", "B0A0D0", "B090E0"}};

std::int32_t wrapAdd32(std::int32_t a, std::int64_t b) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) +
                                   static_cast<std::uint32_t>(b));
}

// Enters \p id with 0 into both dictionaries; into neither without memory.
template <class Dictionary>
bool enterZeros(Dictionary& calls, Dictionary& times, int id) {
  const bool isEntered = HX_WithinMemory([&] {
    calls.insert(id, 0);
    times.insert(id, 0);
  });
  if (!isEntered) calls.del(id);
  return isEntered;
}

}  // namespace

// The rows of the report so far. All functions are inline, because the library
// exports every other function of an exported class.
struct HX_StopWatch::Report {
  inline void addRow(const HX_StopWatch& watch);
  inline void addSubWatches(const HX_StopWatch& watch);
  void openCell(int column) {
    text.append("<td bgcolor=#")
        .append(kPalettes[rows % 2][column])
        .append(">");
  }
  void closeCell() { text += "</td>\n"; }
  void addCell(int column, std::int64_t number) {
    openCell(column);
    hx_detail::appendNumber(text, number);
    closeCell();
  }

  HX_ReportText text = kReportHead;
  int rows = 0;
};

int HX_StopWatch::WatchIdCounter = 0;
std::int64_t HX_StopWatch::m_ProcessorFreq = 0;
bool HX_StopWatch::m_PerformanceCounter = false;
bool HX_StopWatch::m_bInit = false;
HX_StopWatch* HX_StopWatch::s_pRunning = nullptr;

// Never destroyed: static objects of a host may own watches, and are destroyed
// in any order.
HX_StopWatch::Registry& HX_StopWatch::watches() {
  alignas(Registry) static unsigned char s_place[sizeof(Registry)];
  static Registry& s_watches = *new (s_place) Registry;
  return s_watches;
}

HX_StopWatch::HX_StopWatch(const char* name) : m_Id(WatchIdCounter++) {
  const std::size_t length =
      name == nullptr ? 0 : strnlen(name, kMaxNameLength);
  if (length != 0) std::memcpy(m_Name, name, length);
  m_Name[length] = 0;

  if (HX_WithinMemory([&] { watches().insert(m_Id, this); }))
    m_RegistryKey = m_Id;
  if (m_bInit) return;
  m_PerformanceCounter = hx_detail::queryFrequency(m_ProcessorFreq);
  m_bInit = true;
}

HX_StopWatch::HX_StopWatch(const HX_StopWatch& other) {
  assignPlainFields(other);
  const bool isCopied = HX_WithinMemory([&] {
    m_SubWatchCalls = other.m_SubWatchCalls;
    m_SubWatchTimes = other.m_SubWatchTimes;
  });
  if (isCopied) return;
  m_SubWatchCalls.clear();
  m_SubWatchTimes.clear();
}

HX_StopWatch& HX_StopWatch::operator=(const HX_StopWatch& other) {
  if (this == &other) return *this;
  PerSubWatch calls;
  PerSubWatch times;
  const bool isCopied = HX_WithinMemory([&] {
    calls = other.m_SubWatchCalls;
    times = other.m_SubWatchTimes;
  });
  if (!isCopied) return *this;
  assignPlainFields(other);
  m_SubWatchCalls = std::move(calls);
  m_SubWatchTimes = std::move(times);
  updateRunningList();
  return *this;
}

HX_StopWatch::~HX_StopWatch() {
  unregister(m_Id);
  // After an assignment the watch may be registered under another id.
  if (m_RegistryKey != kNotRegistered) unregister(m_RegistryKey);
}

void HX_StopWatch::assignPlainFields(const HX_StopWatch& other) {
  m_Id = other.m_Id;
  m_TotalTime = other.m_TotalTime;
  m_SubWatchTime = other.m_SubWatchTime;
  m_Calls = other.m_Calls;
  m_Start = other.m_Start;
  std::memcpy(m_Name, other.m_Name, sizeof m_Name);
}

void HX_StopWatch::unregister(int key) {
  const Registry::item entry = watches().lookup(key);
  if (!entry) return;
  HX_StopWatch* watch = watches().inf(entry);
  watches().del(key);
  watch->m_RegistryKey = kNotRegistered;
  watch->updateRunningList();
}

// Restores invariant 1.
void HX_StopWatch::updateRunningList() {
  const bool belongs = m_RegistryKey != kNotRegistered && isActive();
  if (belongs == m_IsLinked) return;
  if (!belongs) {
    unlink();
    return;
  }
  m_pPrevious = nullptr;
  m_pNext = s_pRunning;
  if (m_pNext != nullptr) m_pNext->m_pPrevious = this;
  s_pRunning = this;
  m_IsLinked = true;
}

void HX_StopWatch::unlink() {
  (m_pPrevious != nullptr ? m_pPrevious->m_pNext : s_pRunning) = m_pNext;
  if (m_pNext != nullptr) m_pNext->m_pPrevious = m_pPrevious;
  m_IsLinked = false;
}

void HX_StopWatch::start() {
  if (isActive()) {
    HX_DebugCheck(false, "0", kSourceFile);
    return;
  }
  m_Start = hx_detail::rawTime(m_PerformanceCounter);
  updateRunningList();
}

void HX_StopWatch::stop() {
  if (!isActive()) {
    HX_DebugCheck(false, "0", kSourceFile);
    return;
  }
  const std::int64_t now = hx_detail::rawTime(m_PerformanceCounter);
  const std::int64_t interval = hx_detail::rawToMicroseconds(
      wrapSubtract(now, m_Start), m_PerformanceCounter, m_ProcessorFreq);
  if (HX_TimingListener::installed() != nullptr) tellListener(interval);
  m_TotalTime = wrapAdd(m_TotalTime, interval);
  m_Calls = wrapAdd32(m_Calls, 1);
  m_Start = 0;
  updateRunningList();
  if (s_pRunning != nullptr)
    addIntervalToActiveWatches(wrapSubtract(interval, m_SubWatchTime));
  m_SubWatchTime = 0;
}

// Not inlined: the code of stop() runs inside the measured intervals of the
// surrounding watches.
[[gnu::noinline]] void HX_StopWatch::tellListener(std::int64_t interval) const {
  HX_TimingListener::installed()->runEnded(
      m_Name,
      hx_detail::rawTimeToMicroseconds(m_Start, m_PerformanceCounter,
                                       m_ProcessorFreq),
      interval);
}

[[gnu::noinline]] void HX_StopWatch::addIntervalToActiveWatches(
    std::int64_t time) {
  // By invariant 1 the list no longer holds this watch.
  for (HX_StopWatch* watch = s_pRunning; watch != nullptr;
       watch = watch->m_pNext)
    watch->addIntervalOfSubWatch(time, m_Id);
}

void HX_StopWatch::addIntervalOfSubWatch(std::int64_t time, int subWatchId) {
  if (!isActive()) return;
  m_SubWatchTime = wrapAdd(m_SubWatchTime, time);
  auto calls = m_SubWatchCalls.lookup(subWatchId);
  if (!calls) {
    if (!enterZeros(m_SubWatchCalls, m_SubWatchTimes, subWatchId)) return;
    calls = m_SubWatchCalls.lookup(subWatchId);
  }
  const auto times = m_SubWatchTimes.lookup(subWatchId);
  m_SubWatchCalls[calls] = wrapAdd32(m_SubWatchCalls[calls], 1);
  m_SubWatchTimes[times] = wrapAdd32(m_SubWatchTimes[times], time);
}

void HX_StopWatch::endStopWatches() {
  if (watches().empty() || !HX_WithinMemory(writeReport)) return;
  m_bInit = false;
  terminate();
  while (auto entry = watches().first_item()) unregister(watches().key(entry));
}

void HX_StopWatch::writeReport() {
  Report report;
  for (auto entry = watches().first_item(); entry;
       entry = watches().next_item(entry))
    report.addRow(*watches().inf(entry));
  report.text += kReportTail;
  HX_RewriteFile(kReportFile, report.text.data(), report.text.size());
}

void HX_StopWatch::terminate() { WatchIdCounter = 0; }

void HX_StopWatch::Report::addRow(const HX_StopWatch& watch) {
  std::int64_t ownTime = watch.m_TotalTime;
  const PerSubWatch& times = watch.m_SubWatchTimes;
  for (auto entry = times.first_item(); entry; entry = times.next_item(entry))
    ownTime = wrapSubtract(ownTime, times.inf(entry));

  text += "<tr>\n";
  openCell(0);
  text += watch.m_Name;
  closeCell();
  addCell(1, watch.m_Calls);
  addCell(2, watch.m_TotalTime);
  openCell(3);
  text += "\n";
  addSubWatches(watch);
  closeCell();
  addCell(4, ownTime);
  ++rows;
}

void HX_StopWatch::Report::addSubWatches(const HX_StopWatch& watch) {
  const PerSubWatch& calls = watch.m_SubWatchCalls;
  const PerSubWatch& times = watch.m_SubWatchTimes;
  const char* separator = "";
  for (auto entry = calls.first_item(); entry; entry = calls.next_item(entry)) {
    const int id = calls.key(entry);
    text += separator;
    separator = "<BR>\n";
    if (const auto found = watches().lookup(id))
      text += watches().inf(found)->m_Name;
    text += " / ";
    hx_detail::appendNumber(text, calls.inf(entry));
    text += " / ";
    hx_detail::appendNumber(text, times.inf(times.lookup(id)));
  }
}
