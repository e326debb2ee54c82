#include "Diagnostics/HxCDebugServer.h"

#include <clocale>
#include <limits>

#include "Diagnostics/HX_FileFixture.h"
#include "SystemServices/HX_BuildNumber.h"
#include "platform/matlab/HX_MexInterface.h"

namespace {

using testing::EndsWith;
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
    m_Clock.ticks = 1;
    m_Server.boot();
  }
  ~DebugServerTest() override { HX_SetCommandWindow({}); }

  // A log without the header of boot(), which is checked where it matters.
  static std::string log() { return content(kLog).substr(kHeader.size()); }

  HX_ManualClock m_Clock;
  HxCDebugServer m_Server;
  std::string m_Window;
};

// A START or END line: the text filled up to 40 columns, then the time.
std::string line(std::string text, const std::string& time) {
  text.resize(40, '.');
  return text + time + "\n";
}
std::string startLine(const std::string& text) {
  return line(text, "              ");
}

TEST_F(DebugServerTest, NestedRunTimesAreLoggedAndPrinted) {
  m_Server.runTimeStart("A");
  m_Clock.ticks += 1000;
  m_Server.runTimeStart("100%s%n");
  m_Clock.ticks += 234;
  m_Server.runTimeEnd("100%s%n");
  EXPECT_EQ(log(), startLine("START A") + startLine("  START 100%s%n") +
                       line("  END   100%s%n", "        234\xB5s "));
  std::filesystem::rename(kLog, "moved.txt");
  m_Clock.ticks += 98'765'432'109;
  m_Server.runTimeEnd("A");
  EXPECT_EQ(content(kLog), line("END   A", " 98765433343\xB5s "))
      << "a moved log starts anew";
  EXPECT_EQ(m_Window,
            content("moved.txt").substr(kHeader.size()) + content(kLog));
}

TEST_F(DebugServerTest, EndsThatDoNotMatchAreReportedAndNotHeard) {
  const HX_RunRecorder listener;
  m_Clock.ticks = 10;
  for (const char* name : {"A", "B", "C"}) m_Server.runTimeStart(name);
  m_Clock.ticks += 7;
  const std::string invalid =
      "Invalid END runtime - no active START found with that name\n";
  const std::string rows[][2] = {
      {"X", invalid},
      {"B", "Missing END runtimes\n" + line("  END   B", "          7\xB5s ")},
      {"C", invalid},
      {"A", line("END   A", "          7\xB5s ")}};
  for (const auto& [name, written] : rows) {
    m_Window.clear();
    m_Server.runTimeEnd(name.c_str());
    EXPECT_EQ(m_Window, written) << name;
    EXPECT_THAT(log(), EndsWith(written));
  }
  EXPECT_EQ(listener.runs, "B 10+7 A 10+7 ");
}

TEST_F(DebugServerTest, LongNamesAndDeepNestingAreCut) {
  const std::string name63(63, 'n'), other(62, 'n');
  m_Server.runTimeStart((name63 + "1234567").c_str());
  m_Server.runTimeStart(nullptr);
  m_Server.runTimeEnd("");
  m_Window.clear();
  m_Server.runTimeEnd(other.c_str());
  EXPECT_THAT(m_Window, StartsWith("Invalid END"));
  m_Server.runTimeEnd((name63 + "7654321").c_str());
  EXPECT_THAT(m_Window, EndsWith("END   " + std::string(34, 'n') +
                                 "          0\xB5s \n"));

  for (int i = 0; i < 10; ++i) m_Server.runTimeStart("deep");
  m_Window.clear();
  m_Server.runTimeStart("eleventh");
  EXPECT_EQ(m_Window, "");
  m_Server.runTimeEnd("eleventh");
  EXPECT_THAT(m_Window, StartsWith("Invalid END"));
  m_Server.runTimeEnd("deep");
  EXPECT_THAT(m_Window, HasSubstr("\n" + std::string(18, ' ') + "END   deep."));
}

TEST_F(DebugServerTest, ResultsAreWrittenByteForByte) {
  // A locale with a decimal comma must not show; skipped where none is there.
  std::setlocale(LC_NUMERIC, "de_DE.UTF-8");
  for (int i = 0; i < 12; ++i) m_Server.count(eCounterCommon2);
  m_Server.count(eCounterEvalMlExpr);
  const auto interval = [&](ScEDebugClock clock, std::int64_t ticks) {
    m_Server.clockStart(clock);
    m_Clock.ticks += ticks;
    m_Server.clockStop(clock);
  };
  for (const int ticks : {700, 1300, 2}) interval(eClockCommon3, ticks);
  m_Server.clockStop(eClockCommon3);
  m_Server.clockStart(eClockEvalMlExpr);
  m_Clock.ticks += 5;
  interval(eClockEvalMlExpr, 5);
  interval(eClockCommon20, 1);
  m_Server.clockReset(eClockCommon20);
  m_Server.printCurrentResults("50% done");
  std::setlocale(LC_NUMERIC, "C");

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

TEST_F(DebugServerTest, BootClearsCountersAndLogOnlyWhenNotBooted) {
  char entry[] = "value %d %s";
  m_Server.count(eCounterCommon1);
  m_Server.clockStart(eClockCommon1);
  m_Server.runTimeStart("kept");
  m_Server.protocolEntry(entry, 1, "a%d");
  EXPECT_TRUE(m_Server.boot());
  EXPECT_EQ(m_Server.getCounter(eCounterCommon1), 1);
  EXPECT_NE(log(), "");
  m_Server.protocolEntry(entry, 2, "b");
  EXPECT_EQ(HxCDebugServer::getCurrentProtocolIndex(), 2);

  EXPECT_TRUE(m_Server.shutdown());
  m_Clock.frequency = 0;  // from now on milliseconds
  m_Clock.milliseconds = 3;
  EXPECT_TRUE(m_Server.boot());
  EXPECT_EQ(content(kLog), kHeader);
  EXPECT_EQ(m_Server.getCounter(eCounterCommon1), 0);
  EXPECT_EQ(HxCDebugServer::getCurrentProtocolIndex(), 0);
  m_Server.clockStop(eClockCommon1);
  m_Server.runTimeEnd("kept");
  m_Server.printCurrentResults(nullptr);
  EXPECT_THAT(content(kLog), HasSubstr("END   kept......"));
  EXPECT_THAT(content(kLog), HasSubstr("\n  0         1       2000\xB5s"));

  const std::string longText(1024, 'x');
  char format[] = "%s";
  m_Server.protocolEntry(format, longText.c_str());
  EXPECT_EQ(content(kProtocol),
            "000000001 value 1 a%d\n000000002 value 2 b\n"
            "000000001 " +
                longText.substr(1) + "\n");
}

TEST_F(DebugServerTest, ValuesOutsideTheEnumerationsAreIgnored) {
  for (int value : {-1, kDebugCounters, kDebugClocks, 1 << 30,
                    std::numeric_limits<int>::min()}) {
    const auto counter = static_cast<ScEDebugCounter>(value);
    const auto clock = static_cast<ScEDebugClock>(value);
    m_Server.count(counter);
    EXPECT_EQ(m_Server.getCounter(counter), 0);
    EXPECT_STREQ(HxCDebugElements::getCounterComment(counter), "");
    if (value == kDebugCounters) continue;
    m_Server.clockStart(clock);
    m_Server.clockStop(clock);
    m_Server.clockReset(clock);
    EXPECT_STREQ(HxCDebugElements::getClockComment(clock), "");
  }
  m_Server.printCurrentResults("");
  EXPECT_THAT(log(), testing::Not(HasSubstr("000000001")));
}

TEST_F(DebugServerTest, ModelInformationIsCutToItsFields) {
  const std::string text(300, 't'), rule(52, '=');
  std::string model(300, 'm');
  HX_BuildNumber undefined, build;
  const auto expectLogged = [&](HX_BuildNumber& given, char* name,
                                const std::string& shownName,
                                std::size_t version, std::size_t time) {
    m_Server.setModelInfo(&given, name);
    m_Server.logModelInfo();
    EXPECT_THAT(
        log(),
        EndsWith("\n\n" + rule + "\nModel name: " + shownName +
                 "\nVersion:    " + (version > 0 ? "1.2\t from " : "") +
                 text.substr(0, version) +
                 "\nBuildTime:  " + text.substr(0, time) +
                 "\nBuildDate:  " + text.substr(0, time) + "\n" + rule + "\n"));
  };
  build.definedBuildNumber(1, 2, 0, 0, "", false, true, 0, "", "", text.c_str(),
                           (text + "u").c_str());
  expectLogged(build, model.data(), model.substr(41), 89, 49);
  expectLogged(undefined, nullptr, "", 0, 0);
}

TEST_F(DebugServerTest, UnopenableFilesAreNotReported) {
  std::filesystem::remove(kLog);
  obstruct(kLog);
  obstruct(kProtocol);
  m_Server.shutdown();
  EXPECT_TRUE(m_Server.boot());
  m_Server.runTimeStart("A");
  m_Server.runTimeEnd("A");
  m_Server.printCurrentResults("x");
  m_Server.logModelInfo();
  char entry[] = "%d";
  m_Server.protocolEntry(entry, 1);
  EXPECT_EQ(HxCDebugServer::getCurrentProtocolIndex(), 1);
  EXPECT_THAT(m_Window, HasSubstr("END   A"));
  EXPECT_THAT(messages(), testing::IsEmpty());
}

TEST_F(DebugServerTest, LatestInstanceIsRegistered) {
  EXPECT_EQ(HxCDebugServer::getDebugServer(), &m_Server);
  {
    HxCDebugServer second;
    EXPECT_EQ(HxCDebugServer::getDebugServer(), &second);
  }
  EXPECT_EQ(HxCDebugServer::getDebugServer(), nullptr);
  char entry[] = "%d";
  m_Server.protocolEntry(entry, 1);
  EXPECT_EQ(HxCDebugServer::getCurrentProtocolIndex(), 0);
}

}  // namespace
