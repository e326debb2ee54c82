#include "Diagnostics/HxCDebugServer.h"

#include <limits>

#include "Diagnostics/HX_FileFixture.h"
#include "SystemServices/HX_BuildNumber.h"
#include "platform/matlab/HX_MatlabSession.h"
#include "support/HX_ForeignLocale.h"
#include "support/HX_HeapCount.h"

namespace {

using testing::HasSubstr;
using testing::StartsWith;

constexpr char kLog[] = "HX_DebugLog.txt";
constexpr char kProtocol[] = "HX_DebugProtocol.txt";
const std::string kHeader =
    "Begin with debug/performance of the CodeGeneration\n\n";

class DebugServerTest : public HX_FileFixture {
 protected:
  DebugServerTest() {
    HX_SetCommandWindow([this](const char* text) { m_Window += text; });
    m_Clock.frequency = 2'000'000;
    m_Clock.ticks = 1;
    m_Server.boot();
  }
  ~DebugServerTest() override { HX_SetCommandWindow({}); }

  // The log without the header of boot().
  static std::string log() { return content(kLog).substr(kHeader.size()); }

  HX_ManualClock m_Clock;
  HxCDebugServer m_Server;
  std::string m_Window;
  char m_Entry[5] = "* %s";
};

// A START or END line: the text filled up or cut to 40 columns, then the time.
std::string line(std::string text, const std::string& time = "") {
  text.resize(40, '.');
  text += time.empty() ? std::string(14, ' ')
                       : std::string(11 - time.size(), ' ') + time + "\xB5s ";
  return text + "\n";
}

TEST_F(DebugServerTest, RunTimesAreLoggedAndPrintedAsTheyNest) {
  const std::string missing = "Missing END runtimes\n";
  const std::string invalid =
      "Invalid END runtime - no active START found with that name\n";
  const std::string name63(63, 'n');
  struct Step {
    std::string step;  // + and a name starts, - and a name ends a run time
    std::string written;
  };
  std::vector<Step> steps = {
      {"+A", line("START A")},
      {"+100%s%n", line("  START 100%s%n")},
      {"-100%s%n", line("  END   100%s%n", "7")},
      {"-X", invalid},
      {"+B", line("  START B")},
      {"+C", line("    START C")},
      {"-B", missing + line("  END   B", "14")},
      {"-C", invalid},
      {"+" + name63 + "1234567", line("  START " + name63)},
      {"-" + name63.substr(1), invalid},
      {"-" + name63 + "7654321", line("  END   " + name63, "14")},
      {"-A", line("END   A", "77")},
  };
  for (std::size_t depth = 0; depth < 20; depth += 2)
    steps.push_back({"+deep", line(std::string(depth, ' ') + "START deep")});
  steps.push_back({"+eleventh", ""});
  steps.push_back({"-eleventh", invalid});
  steps.push_back({"-deep", line(std::string(18, ' ') + "END   deep", "21")});

  const HX_RunRecorder listener;
  std::string allWritten;
  for (const auto& [step, written] : steps) {
    const auto call = step[0] == '+' ? &HxCDebugServer::runTimeStart
                                     : &HxCDebugServer::runTimeEnd;
    (m_Server.*call)(step.c_str() + 1);
    m_Clock.ticks += 14;
    allWritten += written;
  }
  EXPECT_EQ(log(), allWritten);
  EXPECT_EQ(m_Window, allWritten);
  EXPECT_EQ(listener.runs,
            "100%s%n 7+7 B 28+14 " + name63 + " 56+14 A 0+77 deep 147+21 ");
}

TEST_F(DebugServerTest, WhatCannotBeWrittenIsLostWithoutAReport) {
  std::filesystem::remove(kLog);
  for (const char* file : {kLog, kProtocol})
    std::filesystem::create_directory(file);
  m_Server.shutdown();
  EXPECT_TRUE(m_Server.boot());
  m_Server.runTimeStart(nullptr);
  m_Server.protocolEntry(m_Entry, "lost");
  for (const char* file : {kLog, kProtocol}) std::filesystem::remove(file);
  m_Clock.ticks += 19'753'086'420;
  m_Server.runTimeEnd(nullptr);
  m_Server.protocolEntry(m_Entry, "100%s");
  const std::string tooLong(1024, 'x');
  m_Server.protocolEntry(m_Entry, tooLong.c_str());
  EXPECT_EQ(content(kLog), line("END   ", "9876543210"));
  EXPECT_EQ(content(kProtocol),
            "000000002 * 100%s\n000000003 * " + tooLong.substr(3) + "\n");
  EXPECT_THAT(messages(), testing::IsEmpty());
}

TEST_F(DebugServerTest, ResultsAreWrittenByteForByte) {
  const auto interval = [&](ScEDebugClock clock, std::int64_t microseconds) {
    m_Server.clockStart(clock);
    m_Clock.ticks += 2 * microseconds;
    m_Server.clockStop(clock);
  };
  for (int i = 0; i < 12; ++i) m_Server.count(eCounterCommon2);
  m_Server.count(eCounterEvalMlExpr);
  for (const int microseconds : {700, 1300, 2})
    interval(eClockCommon3, microseconds);
  m_Server.clockStop(eClockCommon3);
  m_Server.clockStart(eClockEvalMlExpr);
  m_Clock.ticks += 10;
  interval(eClockEvalMlExpr, 5);  // starts but once
  interval(eClockCommon20, 1);
  m_Server.clockReset(eClockCommon20);
  // Values outside the enumerations are ignored.
  for (int value : {-1, kDebugCounters, kDebugClocks, 1 << 30,
                    std::numeric_limits<int>::min()}) {
    const auto counter = static_cast<ScEDebugCounter>(value);
    m_Server.count(counter);
    EXPECT_EQ(m_Server.getCounter(counter), 0);
    EXPECT_STREQ(HxCDebugElements::getCounterComment(counter), "");
    if (value == kDebugCounters) continue;
    const auto clock = static_cast<ScEDebugClock>(value);
    interval(clock, 1);
    m_Server.clockReset(clock);
    EXPECT_STREQ(HxCDebugElements::getClockComment(clock), "");
  }
  {
    const HX_ForeignLocale foreign;
    m_Server.printCurrentResults("50% done");
  }

  std::string expected =
      "\n\nDebug-Results - 50% done\n-----------------------------------\n"
      "\ncounter-----------------------------------\n";
  for (int i = 0; i < 9; ++i)
    expected += "Counter 00" + std::to_string(i) + " has 0000000" +
                (i == 1 ? "12" : "00") + " calls (free counter for common use" +
                std::to_string(i + 1) + ")\n";
  expected +=
      "Counter 009 has 000000001 calls (mexCallMatlab in "
      "HX_MlExprEvaluator::evalMlExpr)\n"
      "\n\nclocks------------------------------------------------------------"
      "--\n"
      " Nr     Calls    TotalTime    MaxTime  AverageTime Name\n"
      "--------------------------------------------------------------------\n";
  for (int i = 0; i < 20; ++i)
    expected +=
        (i < 10 ? "  " : " ") + std::to_string(i) +
        (i == 2 ? "         3       2002\xB5s     1300\xB5s    667.333"
                : "         0          0\xB5s        0\xB5s      0.000") +
        "\xB5s free clock for common use " + std::to_string(i + 1) + "\n";
  expected +=
      " 20         1         10\xB5s       10\xB5s     10.000\xB5s method "
      "HX_MlExprEvaluator::evalMlExpr\n\n\n";
  EXPECT_EQ(log(), expected);
}

TEST_F(DebugServerTest, BootStartsAnewOnlyWhenNotBooted) {
  m_Server.count(eCounterCommon1);
  m_Server.clockStart(eClockCommon1);
  m_Server.runTimeStart("kept");
  m_Server.protocolEntry(m_Entry, "");
  m_Clock.frequency = 0;  // the next clock counts milliseconds
  m_Clock.milliseconds = 3;
  for (const bool isBooted : {true, false}) {
    if (!isBooted) {
      EXPECT_TRUE(m_Server.shutdown());
    }
    EXPECT_TRUE(m_Server.boot());
    EXPECT_EQ(content(kLog), isBooted ? kHeader + line("START kept") : kHeader);
    EXPECT_EQ(m_Server.getCounter(eCounterCommon1), isBooted);
    EXPECT_EQ(HxCDebugServer::getCurrentProtocolIndex(), isBooted);
  }
  m_Server.clockStop(eClockCommon1);
  m_Server.runTimeEnd("kept");
  m_Server.printCurrentResults(nullptr);
  EXPECT_THAT(log(), StartsWith(line("END   kept", "2000")));
  EXPECT_THAT(log(), HasSubstr("\n  0         1       2000\xB5s"));
}

TEST_F(DebugServerTest, ModelInformationIsCutToItsFields) {
  const std::string date(50, 'd'), time(50, 't'), rule(52, '=');
  std::string model(260, 'm');
  HX_BuildNumber build;
  build.definedBuildNumber(1, 2, 0, 0, "", false, true, 0, "", "", date.c_str(),
                           time.c_str());
  m_Server.setModelInfo(&build, model.data());
  m_Server.logModelInfo();
  m_Server.setModelInfo(nullptr, nullptr);
  m_Server.logModelInfo();
  EXPECT_EQ(log(), "\n\n" + rule + "\nModel name: " + model.substr(1) +
                       "\nVersion:    1.2\t from " + date + " " +
                       time.substr(12) + "\nBuildTime:  " + time.substr(1) +
                       "\nBuildDate:  " + date.substr(1) + "\n" + rule +
                       "\n\n\n" + rule +
                       "\nModel name: \nVersion:    \nBuildTime:  \n"
                       "BuildDate:  \n" +
                       rule + "\n");
}

TEST_F(DebugServerTest, MissingMemoryCostsOnlyTheTableOfResults) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  HX_CountingController controller;
  controller.fail();
  {
    const HX_FailingHeap heap(0, true);
    m_Server.runTimeStart("A");
    m_Server.printCurrentResults("lost");
    m_Server.runTimeEnd("A");
    m_Server.protocolEntry(m_Entry, "");
  }
  EXPECT_EQ(log(), line("START A") + line("END   A", "0"));
  EXPECT_EQ(content(kProtocol), "000000001 * \n");
  EXPECT_EQ(controller.allocated(), 1) << "the table asks the controller";
}

TEST_F(DebugServerTest, LatestInstanceIsRegistered) {
  EXPECT_EQ(HxCDebugServer::getDebugServer(), &m_Server);
  {
    const HxCDebugServer second;
    EXPECT_EQ(HxCDebugServer::getDebugServer(), &second);
  }
  EXPECT_EQ(HxCDebugServer::getDebugServer(), nullptr);
  m_Server.protocolEntry(m_Entry, "");
  EXPECT_EQ(HxCDebugServer::getCurrentProtocolIndex(), 0);
}

}  // namespace
