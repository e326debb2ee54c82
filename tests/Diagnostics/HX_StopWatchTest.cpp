#include "Diagnostics/HX_StopWatch.h"

#include <array>
#include <cstdio>
#include <map>
#include <memory>
#include <random>
#include <string_view>
#include <utility>

#include "Diagnostics/HX_FileFixture.h"
#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_RealTime.h"

namespace {

constexpr char kReport[] = "HX_StopWatch.html";

class StopWatchTest : public HX_FileFixture {
 protected:
  // Ends a measuring period without a report file: the next watch asks for the
  // frequency.
  void setFrequency(std::int64_t frequency) {
    m_Clock.frequency = frequency;
    const HX_StopWatch ended(nullptr);
    std::filesystem::create_directory(kReport);
    HX_StopWatch::endStopWatches();
    std::filesystem::remove(kReport);
  }

  HX_ManualClock m_Clock;
};

TEST_F(StopWatchTest, FrequencyIsAskedForOncePerMeasuringPeriod) {
  const struct {
    const char* why;
    std::int64_t frequency;
    std::int64_t ticks;  // of the counter and, in ms, of the process clock
    std::int64_t total;
  } rows[] = {
      {"cut towards zero", 3'000'000, 8, 2},
      {"the system's frequency", 15'625'000, 46, 2},
      {"one above it", 15'625'001, 47, 3},
      {"no counter: milliseconds", 0, 8, 8000},
      {"a counter that cannot be used", -1, 8, 8000},
      {"the product just fits", 1, 9'223'372'036'854,
       9'223'372'036'854'000'000},
      {"the product wraps around", 1, 9'223'372'036'855,
       -9'223'372'036'854'551'616},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.why);
    setFrequency(row.frequency);
    m_Clock.ticks = m_Clock.milliseconds = 1;
    const HX_StopWatch asking("");
    m_Clock.frequency = 77;  // not asked for again
    HX_StopWatch watch("");
    watch.start();
    m_Clock.ticks += row.ticks;
    m_Clock.milliseconds += row.ticks;
    watch.stop();
    EXPECT_EQ(watch.getTotalTime(), row.total);
  }
}

const std::string kHead =
    "<html>\n<head>\n"
    "<title>Stop Watch Output (Time in micros seconds)</title>\n"
    "<meta http-equiv=\"Content-Style-Type\" content=\"text/css\">\n"
    "</head>\n<body>\n"
    "<table><tr><th bgcolor=#FF8080>Watch</th>\n"
    "<th bgcolor=#F88088>called</th>\n"
    "<th bgcolor=#F08090>time with sub-watches</th>\n"
    "<th bgcolor=#E88098>subwatches (name/calls/time)</th>\n"
    "<th bgcolor=#E080A0>time witout sub-watches</th></tr>\n";

// Plain form of a stop watch, without the list of running watches.
struct PlainWatch {
  std::string name;
  int id = 0, calls = 0;
  std::int64_t start = 0, total = 0, subTime = 0;
  std::map<int, std::pair<int, std::int32_t>> subs{};  // id -> calls, time
};
using PlainRegistry = std::map<int, PlainWatch*>;

// Returns the text of the listener. Three ticks are a microsecond.
std::string stopPlain(PlainWatch& watch, std::int64_t ticks,
                      const PlainRegistry& registry) {
  if (watch.start == 0) return "";
  const std::int64_t start = watch.start / 3;
  const std::int64_t interval = (ticks - watch.start) / 3;
  const std::int64_t own = interval - watch.subTime;
  watch.total += interval;
  ++watch.calls;
  watch.start = watch.subTime = 0;
  for (const auto& [key, other] : registry) {
    if (other->start == 0) continue;
    other->subTime += own;
    auto& [calls, time] = other->subs[watch.id];
    ++calls;
    time = static_cast<std::int32_t>(time + own);
  }
  return watch.name + " " + std::to_string(start) + "+" +
         std::to_string(interval) + " ";
}

std::string plainReport(const PlainRegistry& registry) {
  if (registry.empty()) return "(none)";
  std::string text = kHead;
  bool isEven = true;
  for (const auto& [key, watch] : registry) {
    std::string subs = "\n";
    std::int64_t own = watch->total;
    for (const auto& [id, sub] : watch->subs) {
      own -= sub.second;
      if (subs != "\n") subs += "<BR>\n";
      if (registry.contains(id)) subs += registry.at(id)->name;
      subs += " / " + std::to_string(sub.first) + " / " +
              std::to_string(sub.second);
    }
    const std::pair<const char*, std::string> cells[] = {
        {"F080", watch->name},
        {"E090", std::to_string(watch->calls)},
        {"D0A0", std::to_string(watch->total)},
        {"C0B0", subs},
        {"B0C0", std::to_string(own)}};
    text += "<tr>\n";
    for (const auto& [color, content] : cells)
      text += std::string("<td bgcolor=#") + (isEven ? "80" : "B0") + color +
              ">" + content + "</td>\n";
    isEven = !isEven;
  }
  return text + "</table>\n</body>\n</html>\n";
}

TEST_F(StopWatchTest, RandomUseAccountsLikeThePlainForm) {
  constexpr std::size_t kSlots = 6;
  const unsigned seed = HX_Seed();
  SCOPED_TRACE("seed " + std::to_string(seed));
  std::mt19937 random(seed);
  const auto below = [&](unsigned bound) {
    return static_cast<unsigned>(random()) % bound;
  };
  setFrequency(3'000'000);
  // Ten thousand years of ticks: a million times as much does not fit 64 bits.
  m_Clock.ticks = 3'000'001 * std::int64_t{315'360'000'000};
  std::array<std::unique_ptr<HX_StopWatch>, kSlots> watches;
  std::array<PlainWatch, kSlots> plains;
  PlainRegistry registry;
  std::size_t misuses = 0;
  HX_RunRecorder listener;
  const auto& reports = recordDebugReports();

  for (int step = 0, nextId = 0; step < 20'000; ++step) {
    SCOPED_TRACE("step " + std::to_string(step));
    // One step in 50 lasts an hour: more microseconds than 32 bits hold.
    m_Clock.ticks += below(50) == 0 ? 12'000'000'000 : below(100);
    const std::size_t i = below(kSlots), from = below(kSlots);
    PlainWatch& plain = plains[i];
    const unsigned action = below(100);
    if (action < 15) {
      if (watches[i]) registry.erase(plain.id);
      std::erase_if(registry, [&](auto& e) { return e.second == &plain; });
      watches[i].reset();
      if (action < 8) {
        std::string name = std::to_string(step) + "%s";
        // 1 character, or 254 to 256: the longest name has 255.
        name.resize(below(2) == 0 ? 1 : 254 + below(3), 'x');
        watches[i] = std::make_unique<HX_StopWatch>(name.c_str());
        plain = {.name = name.substr(0, 255), .id = nextId};
        registry[nextId++] = &plain;
      } else if (action < 11 && watches[from]) {
        watches[i] = std::make_unique<HX_StopWatch>(*watches[from]);
        plain = plains[from];
      }
    } else if (!watches[i] || (action < 19 && !watches[from])) {
      continue;
    } else if (action < 19) {
      *watches[i] = *watches[from];
      plain = plains[from];
    } else if (action < 20) {
      HX_StopWatch::endStopWatches();
      ASSERT_EQ(content(kReport), plainReport(registry));
      std::filesystem::remove(kReport);
      if (!registry.empty()) nextId = 0;
      registry.clear();
    } else if (action < 60) {
      watches[i]->start();
      misuses += plain.start != 0;
      if (plain.start == 0) plain.start = m_Clock.ticks;
    } else {
      watches[i]->stop();
      const std::string run = stopPlain(plain, m_Clock.ticks, registry);
      misuses += run.empty();
      ASSERT_EQ(std::exchange(listener.runs, ""), run);
      ASSERT_EQ(watches[i]->getTotalTime(), plain.total);
    }
  }
  EXPECT_EQ(reports, std::vector<std::string>(misuses, "0"));
  EXPECT_THAT(messages(), testing::IsEmpty());
}

TEST_F(StopWatchTest, MisuseIsReportedWithTheSourceAndChangesNothing) {
  std::vector<std::string> reports;
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  handler.setShowInternalInfo(true);
  handler.setDebugReport([&](const char* file, int line, const char* text) {
    reports.push_back(std::string(file) + (line > 0 ? "_n " : "_0 ") + text);
    return 0;
  });
  HX_StopWatch watch("");
  watch.stop();
  m_Clock.ticks = 1;
  watch.start();
  watch.start();
  EXPECT_THAT(reports,
              testing::ElementsAre("HX_StopWatch_n 0", "HX_StopWatch_n 0"));
}

TEST_F(StopWatchTest, AMicrosecondIsAMicrosecondOfTheRealClock) {
  setFrequency(1);
  HX_ClockSource::install(nullptr);
  HX_StopWatch watch("");
  HX_ExpectRealTime([&] {
    watch.stop();  // the first one without effect
    watch.start();
    return static_cast<double>(watch.getTotalTime()) / 1e6;
  });
}

// Uses everything that asks for memory.
int s_wrongTimes = 0;  // counted, because assertions ask for memory
bool reportsTwoWatches() {
  static const std::string s_Expected =
      kHead +
      "<tr>\n<td bgcolor=#80F080>outer</td>\n<td bgcolor=#80E090>1</td>\n"
      "<td bgcolor=#80D0A0>30</td>\n<td bgcolor=#80C0B0>\n / 1 / 10</td>\n"
      "<td bgcolor=#80B0C0>20</td>\n<tr>\n<td bgcolor=#B0F080>outer</td>\n"
      "<td bgcolor=#B0E090>1</td>\n<td bgcolor=#B0D0A0>30</td>\n"
      "<td bgcolor=#B0C0B0>\n / 1 / 10</td>\n<td bgcolor=#B0B0C0>20</td>\n"
      "</table>\n</body>\n</html>\n";
  auto& ticks =
      static_cast<HX_ManualClock*>(HX_ClockSource::installed())->ticks;
  HX_StopWatch outer("outer"), copied("copied");
  {
    HX_StopWatch inner("inner");
    ticks = 1;
    outer.start();
    inner.start();
    ticks = 11;
    inner.stop();
    ticks = 31;
    outer.stop();
  }
  const HX_StopWatch copy(outer);
  copied = copy;
  const bool isKept = copied.getName() == std::string_view("copied");
  s_wrongTimes += outer.getTotalTime() + copy.getTotalTime() != 60;
  s_wrongTimes += copied.getTotalTime() != (isKept ? 0 : 30);

  HX_StopWatch::endStopWatches();
  char text[2000];
  std::FILE* file = std::fopen(kReport, "r");
  if (file == nullptr) return false;
  const std::size_t length = std::fread(text, 1, sizeof text, file);
  std::fclose(file);
  std::remove(kReport);
  return std::string_view(text, length) == s_Expected;
}

TEST_F(StopWatchTest, MissingMemoryLosesRecordsButNoTimes) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  setFrequency(1'000'000);
  ASSERT_TRUE(reportsTwoWatches());
  HX_WithoutEachHeapBlock("watches", reportsTwoWatches);
  HX_WithoutEachBlock("report", reportsTwoWatches);
  EXPECT_EQ(s_wrongTimes, 0);
}

}  // namespace
