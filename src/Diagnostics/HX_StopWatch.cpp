#include "Diagnostics/HX_StopWatch.h"

#include <algorithm>
#include <cstring>
#include <string>

#include "Control/HX_SelfCheck.h"
#include "Diagnostics/HX_TimingListener.h"
#include "Diagnostics/implDiagnostics/HX_RawClock.h"
#include "platform/os/HX_OsFile.h"

namespace {

using hx_detail::wrapAdd;
using hx_detail::wrapSubtract;

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

// The colours of even and odd rows by column; the last two are in reserve.
constexpr const char* kPalettes[2][7] = {
    {"80F080", "80E090", "80D0A0", "80C0B0", "80B0C0", "80A0D0", "8090E0"},
    {"B0F080", "B0E090", "B0D0A0", "B0C0B0", "B0B0C0", "B0A0D0", "B090E0"}};

std::int32_t wrapAdd32(std::int32_t a, std::int64_t b) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) +
                                   static_cast<std::uint32_t>(b));
}

// Adds to the entry of \p key, which starts at 0.
template <class Dictionary>
void addTo(Dictionary& entries, int key, std::int64_t value) {
  if (auto entry = entries.lookup(key))
    entries[entry] = wrapAdd32(entries[entry], value);
  else
    entries.insert(key, wrapAdd32(0, value));
}

}  // namespace

// The rows of the report, as they are built up. All functions are inline: the
// library would export others with the class around this one.
struct HX_StopWatch::Report {
  inline void addRow(const HX_StopWatch& watch);
  inline void addSubWatches(const HX_StopWatch& watch);
  void openCell(int column) {
    text.append("<td bgcolor=#")
        .append(kPalettes[rows % 2][column])
        .append(">");
  }
  void addCell(int column, const std::string& content) {
    openCell(column);
    text.append(content).append("</td>\n");
  }

  std::string text = kReportHead;
  int rows = 0;
};

int HX_StopWatch::WatchIdCounter = 0;
std::int64_t HX_StopWatch::m_ProcessorFreq = 0;
bool HX_StopWatch::m_PerformanceCounter = false;
bool HX_StopWatch::m_bInit = false;
HX_StopWatch* HX_StopWatch::s_pRunning = nullptr;

// Created by the first watch, so that it outlives every static watch.
HX_StopWatch::Registry& HX_StopWatch::watches() {
  static Registry s_watches;
  return s_watches;
}

HX_StopWatch::HX_StopWatch(const char* name) : m_Id(WatchIdCounter++) {
  const std::size_t length =
      name == nullptr ? 0 : strnlen(name, kMaxNameLength);
  if (length != 0) std::memcpy(m_Name, name, length);
  m_Name[length] = 0;

  watches().insert(m_Id, this);
  m_RegistryKey = m_Id;
  if (m_bInit) return;
  m_PerformanceCounter = hx_detail::queryFrequency(m_ProcessorFreq);
  m_bInit = true;
}

HX_StopWatch::HX_StopWatch(const HX_StopWatch& other) { assignFields(other); }

HX_StopWatch& HX_StopWatch::operator=(const HX_StopWatch& other) {
  if (this == &other) return *this;
  assignFields(other);
  updateRunningList();
  return *this;
}

HX_StopWatch::~HX_StopWatch() {
  unregister(m_Id);
  // After an assignment the watch may still be registered under another id; no
  // dead watch may stay behind.
  if (m_RegistryKey != kNotRegistered) unregister(m_RegistryKey);
}

void HX_StopWatch::assignFields(const HX_StopWatch& other) {
  m_Id = other.m_Id;
  m_TotalTime = other.m_TotalTime;
  m_SubWatchTime = other.m_SubWatchTime;
  m_Calls = other.m_Calls;
  m_Start = other.m_Start;
  m_SubWatchCalls = other.m_SubWatchCalls;
  m_SubWatchTimes = other.m_SubWatchTimes;
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

// Called after every change of what decides about membership.
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
    HX_DebugCheck(false, "0");
    return;
  }
  m_Start = hx_detail::rawTime(m_PerformanceCounter);
  updateRunningList();
}

void HX_StopWatch::stop() {
  if (!isActive()) {
    HX_DebugCheck(false, "0");
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

// Kept out of stop(), which is measured along with what it measures.
[[gnu::noinline]] void HX_StopWatch::tellListener(std::int64_t interval) const {
  HX_TimingListener::installed()->runEnded(
      m_Name,
      hx_detail::rawTimeToMicroseconds(m_Start, m_PerformanceCounter,
                                       m_ProcessorFreq),
      interval);
}

[[gnu::noinline]] void HX_StopWatch::addIntervalToActiveWatches(
    std::int64_t time) {
  // This watch has just stopped, so the list holds only others.
  for (HX_StopWatch* watch = s_pRunning; watch != nullptr;
       watch = watch->m_pNext)
    watch->addIntervalOfSubWatch(time, m_Id);
}

void HX_StopWatch::addIntervalOfSubWatch(std::int64_t time, int subWatchId) {
  if (!isActive()) return;
  m_SubWatchTime = wrapAdd(m_SubWatchTime, time);
  addTo(m_SubWatchCalls, subWatchId, 1);
  addTo(m_SubWatchTimes, subWatchId, time);
}

void HX_StopWatch::endStopWatches() {
  if (watches().empty()) return;
  m_bInit = false;

  Report report;
  for (auto entry = watches().first_item(); entry;
       entry = watches().next_item(entry))
    report.addRow(*watches().inf(entry));
  report.text += kReportTail;
  HX_RewriteFile(kReportFile, report.text.data(), report.text.size());

  terminate();
  while (auto entry = watches().first_item()) unregister(watches().key(entry));
}

void HX_StopWatch::terminate() { WatchIdCounter = 0; }

void HX_StopWatch::Report::addRow(const HX_StopWatch& watch) {
  std::int64_t ownTime = watch.m_TotalTime;
  const PerSubWatch& times = watch.m_SubWatchTimes;
  for (auto entry = times.first_item(); entry; entry = times.next_item(entry))
    ownTime = wrapSubtract(ownTime, times.inf(entry));

  text += "<tr>\n";
  addCell(0, watch.m_Name);
  addCell(1, std::to_string(watch.m_Calls));
  addCell(2, std::to_string(watch.m_TotalTime));
  openCell(3);
  text += "\n";
  addSubWatches(watch);
  text += "</td>\n";
  addCell(4, std::to_string(ownTime));
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
    text.append(" / ").append(std::to_string(calls.inf(entry)));
    text.append(" / ").append(std::to_string(times.inf(times.lookup(id))));
  }
}
