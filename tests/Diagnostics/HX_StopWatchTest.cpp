#include "Diagnostics/HX_StopWatch.h"

#include <array>
#include <cstdio>
#include <map>
#include <memory>
#include <random>

#include "Diagnostics/HX_FileFixture.h"

namespace {

using testing::HasSubstr;
using testing::IsEmpty;

constexpr char kReport[] = "HX_StopWatch.html";

class StopWatchTest : public HX_FileFixture {
 protected:
  StopWatchTest() { setFrequency(m_Clock.frequency); }

  // A measuring period that has ended makes the next watch ask for it.
  void setFrequency(std::int64_t frequency) {
    m_Clock.frequency = frequency;
    HX_StopWatch ended("");
    HX_StopWatch::endStopWatches();
    std::filesystem::remove(kReport);
  }

  void run(HX_StopWatch& watch, std::int64_t ticks) {
    watch.start();
    m_Clock.ticks += ticks;
    watch.stop();
  }

  static std::string report() {
    std::filesystem::remove(kReport);
    HX_StopWatch::endStopWatches();
    return content(kReport);
  }

  HX_ManualClock m_Clock;
};

// One table row as the report writes it.
std::string row(int number, const std::string& name, int calls,
                std::int64_t total, const std::string& subWatches,
                std::int64_t own) {
  const std::string color = number % 2 == 0 ? "80" : "B0";
  return "<tr>\n<td bgcolor=#" + color + "F080>" + name + "</td>\n" +
         "<td bgcolor=#" + color + "E090>" + std::to_string(calls) +
         "</td>\n<td bgcolor=#" + color + "D0A0>" + std::to_string(total) +
         "</td>\n<td bgcolor=#" + color + "C0B0>\n" + subWatches + "</td>\n" +
         "<td bgcolor=#" + color + "B0C0>" + std::to_string(own) + "</td>\n";
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
const std::string kTail = "</table>\n</body>\n</html>\n";

TEST_F(StopWatchTest, ReportHoldsNestedWatchesByteForByte) {
  m_Clock.ticks = 5;
  HX_StopWatch p("P 100%s"), q("Q"), r("R");
  auto gone = std::make_unique<HX_StopWatch>("gone");
  p.start();
  m_Clock.ticks += 10;
  q.start();
  m_Clock.ticks += 20;
  run(r, 7);
  run(r, 8);
  q.stop();
  run(*gone, 3);
  p.stop();
  gone.reset();
  const std::string expected =
      kHead +
      row(0, "P 100%s", 1, 48, "Q / 1 / 20<BR>\nR / 2 / 15<BR>\n / 1 / 3", 10) +
      row(1, "Q", 1, 35, "R / 2 / 15", 20) + row(2, "R", 2, 15, "", 15) + kTail;
  EXPECT_EQ(report(), expected);
  EXPECT_EQ(report(), "(none)") << "nothing is registered any more";
  HX_StopWatch next("first again");
  EXPECT_EQ(report(), kHead + row(0, "first again", 0, 0, "", 0) + kTail);
}

TEST_F(StopWatchTest, NamesAreCutToTheirField) {
  for (std::size_t length : {0U, 254U, 255U, 256U, 5000U}) {
    const std::string name(length, 'x');
    HX_StopWatch watch(name.c_str());
    EXPECT_EQ(watch.getName(), name.substr(0, 255));
  }
  EXPECT_STREQ(HX_StopWatch(nullptr).getName(), "");
}

TEST_F(StopWatchTest, FrequencyIsAskedForOncePerMeasuringPeriod) {
  struct Case {
    const char* why;
    std::int64_t frequency;
    std::int64_t ticks;  // of the counter and, in ms, of the process clock
    std::int64_t total;
  };
  const Case cases[] = {
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
  for (const Case& c : cases) {
    SCOPED_TRACE(c.why);
    setFrequency(c.frequency);
    m_Clock.ticks = m_Clock.milliseconds = 1;
    HX_StopWatch watch("w");
    m_Clock.frequency = 77;  // not asked for again
    watch.start();
    m_Clock.ticks += c.ticks;
    m_Clock.milliseconds += c.ticks;
    watch.stop();
    EXPECT_EQ(watch.getTotalTime(), c.total);
  }
}

TEST_F(StopWatchTest, UnopenableReportStillEndsThePeriod) {
  obstruct(kReport);
  HX_StopWatch before("before");
  HX_StopWatch::endStopWatches();
  EXPECT_THAT(messages(), IsEmpty());
  std::filesystem::remove(kReport);
  HX_StopWatch after("after");
  EXPECT_EQ(report(), kHead + row(0, "after", 0, 0, "", 0) + kTail);
}

TEST_F(StopWatchTest, ListenerHearsEachRunAsItEnds) {
  const HX_RunRecorder listener;
  setFrequency(2'000'000);
  // Times a million as large would not fit: ten thousand years of ticks.
  m_Clock.ticks = 2'000'001 * std::int64_t{315'360'000'000};
  HX_StopWatch outer("outer"), inner("inner");
  outer.start();
  m_Clock.ticks += 10;
  run(inner, 6);
  outer.stop();
  EXPECT_EQ(listener.runs,
            "inner 315360157680000005+3 outer 315360157680000000+8 ");
}

// What a stop watch is, without the list of running watches.
struct PlainWatch {
  int id = 0;
  std::int64_t total = 0, subTime = 0;
  int calls = 0;
  std::int64_t start = 0;
  std::map<int, std::int32_t> subCalls, subTimes;
  std::string name;
};

class PlainWatches {
 public:
  explicit PlainWatches(const HX_ManualClock& clock) : m_Clock(clock) {}

  void create(PlainWatch& w, const std::string& name) {
    w = PlainWatch();
    w.id = m_NextId++;
    w.name = name;
    m_Registry[w.id] = &w;
  }
  void destroy(const PlainWatch& w) {
    m_Registry.erase(w.id);
    std::erase_if(m_Registry, [&](const auto& e) { return e.second == &w; });
  }
  void start(PlainWatch& w) {
    if (w.start == 0)
      w.start = m_Clock.ticks;
    else
      ++misuses;
  }
  void stop(PlainWatch& w) {
    if (w.start == 0) {
      ++misuses;
      return;
    }
    const std::int64_t interval =
        (m_Clock.ticks - w.start) * 1'000'000 / m_Clock.frequency;
    w.total += interval;
    ++w.calls;
    w.start = 0;
    const std::int64_t own = interval - w.subTime;
    for (auto& [key, other] : m_Registry) {
      if (other == &w || other->start == 0) continue;
      other->subTime += own;
      ++other->subCalls[w.id];
      std::int32_t& sum = other->subTimes[w.id];
      sum = static_cast<std::int32_t>(static_cast<std::uint64_t>(sum + own));
    }
    w.subTime = 0;
  }
  std::string end() {
    if (m_Registry.empty()) return "(none)";
    std::string text = kHead;
    int number = 0;
    for (const auto& [key, w] : m_Registry) {
      std::string subs;
      std::int64_t own = w->total;
      for (const auto& [id, time] : w->subTimes) {
        own -= time;
        if (!subs.empty()) subs += "<BR>\n";
        const auto found = m_Registry.find(id);
        if (found != m_Registry.end()) subs += found->second->name;
        subs += " / " + std::to_string(w->subCalls[id]) + " / " +
                std::to_string(time);
      }
      text += row(number++, w->name, w->calls, w->total, subs, own);
    }
    m_Registry.clear();
    m_NextId = 0;
    return text + kTail;
  }

  std::size_t misuses = 0;

 private:
  const HX_ManualClock& m_Clock;
  std::map<int, PlainWatch*> m_Registry;
  int m_NextId = 0;
};

TEST_F(StopWatchTest, RandomUseAccountsLikeThePlainForm) {
  constexpr std::size_t kSlots = 6;
  const unsigned seed = std::random_device()();
  SCOPED_TRACE("seed " + std::to_string(seed));
  std::mt19937 random(seed);
  const auto below = [&](unsigned bound) {
    return static_cast<unsigned>(random()) % bound;
  };
  const auto& reports = recordDebugReports();
  setFrequency(3'000'000);
  m_Clock.ticks = 1;
  PlainWatches plain(m_Clock);
  std::array<std::unique_ptr<HX_StopWatch>, kSlots> watches;
  std::array<PlainWatch, kSlots> models;
  const auto destroy = [&](std::size_t i) {
    if (watches[i]) plain.destroy(models[i]);
    watches[i].reset();
  };

  for (int step = 0; step < 20'000; ++step) {
    SCOPED_TRACE("step " + std::to_string(step));
    // Now and then more than an hour, which 32 bits of microseconds do not
    // hold.
    m_Clock.ticks += below(50) == 0 ? 12'000'000'000 : below(100);
    const std::size_t i = below(kSlots), from = below(kSlots);
    const unsigned action = below(100);
    if (action < 8) {
      destroy(i);
      const std::string name = "w" + std::to_string(step);
      watches[i] = std::make_unique<HX_StopWatch>(name.c_str());
      plain.create(models[i], name);
    } else if (action < 12) {
      destroy(i);
    } else if (action < 15 && i != from && watches[from]) {
      destroy(i);
      watches[i] = std::make_unique<HX_StopWatch>(*watches[from]);
      models[i] = models[from];
    } else if (action < 19 && watches[i] && watches[from]) {
      *watches[i] = *watches[from];
      models[i] = models[from];
    } else if (action < 20) {
      ASSERT_EQ(report(), plain.end());
    } else if (watches[i] && action < 60) {
      watches[i]->start();
      plain.start(models[i]);
    } else if (watches[i]) {
      watches[i]->stop();
      plain.stop(models[i]);
      ASSERT_EQ(watches[i]->getTotalTime(), models[i].total);
    }
  }
  EXPECT_EQ(report(), plain.end());
  EXPECT_EQ(reports, std::vector<std::string>(plain.misuses, "0"));
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(StopWatchTest, BrowserShowsTheReport) {
  HX_StopWatch outer("Outer"), inner("Inner");
  m_Clock.ticks = 1;
  outer.start();
  run(inner, 1234);
  run(inner, 1);
  outer.stop();
  HX_StopWatch::endStopWatches();
  // The page writes what its table shows into its title, one cell per field.
  std::ofstream(kReport, std::ios::app)
      << "<script>document.title=Array.from(document.querySelectorAll('tr'))"
         ".map(r=>Array.from(r.cells).map(c=>c.innerText.trim()).join('|'))"
         ".join(';')</script>";
  // Exit status 77: no Chromium is installed.
  const int status = std::system(
      "for b in chromium chromium-headless-shell google-chrome; do "
      "command -v $b >/dev/null && exec $b --headless --no-sandbox "
      "--disable-gpu --dump-dom \"file://$PWD/HX_StopWatch.html\" "
      ">dom.html 2>/dev/null; done; exit 77");
  if (WEXITSTATUS(status) == 77) GTEST_SKIP() << "no Chromium is installed";
  ASSERT_EQ(status, 0);
  EXPECT_THAT(content("dom.html"), HasSubstr(";Outer|1|1235|Inner / 2 / 1235|0;"
                                             "Inner|2|1235||1235</title>"));
}

}  // namespace
