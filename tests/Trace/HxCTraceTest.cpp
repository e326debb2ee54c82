#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>

#include "Control/HxCControl.h"
#include "SourceRef/HxCSrcRef.h"
#include "Trace/HxCTraceFallThrough.h"
#include "Trace/HxCTransformationTracer.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::IsEmpty;
using testing::StartsWith;

class TraceTest : public HX_TestFixture {
 protected:
  ~TraceTest() override {
    HxCTraceFallThrough::setVerbose(false);
    HxCControl::setProductionCodeBehaviour();
    HxCTransformationTracer::shutdown();
    std::remove(m_FileName.c_str());
  }

  std::string fileContent() const {
    std::ifstream file(m_FileName, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
  }

  const std::string m_FileName =
      (std::filesystem::temp_directory_path() /
       ("hx_trace_test_" + std::to_string(std::random_device()()) + ".txt"))
          .string();
};

using Tracer = HxCTraceFallThrough;
// Calls the three overloads of a level; true if one did not return false.
#define THROW_ALL(name)                       \
  [](const Tracer& t) {                       \
    return t.name() || t.name("x.cpp", 12) || \
           t.name("x.cpp", 12, "bad index");  \
  }

TEST_F(TraceTest, LevelsReportWhenVerboseAndOnlyDeadlyOnesElse) {
  const struct {
    const char* head;  // row/severity of the message
    bool (*throwAll)(const Tracer&);
  } levels[] = {{"1272/4", THROW_ALL(throwNote)},
                {"1273/5", THROW_ALL(throwWarning)},
                {"1274/6", THROW_ALL(throwError)},
                {"1275/7", THROW_ALL(throwDeadly)}};
  auto& reports = recordDebugReports();
  for (const auto& level : levels) {
    SCOPED_TRACE(level.head);
    Tracer::setVerbose(true);
    clearMessages();
    EXPECT_FALSE(level.throwAll(Tracer()));
    const std::string head =
        std::string(level.head) +
        " trace fall through - early abortion. [Internal: Module: '";
    EXPECT_THAT(messages(),
                ElementsAre(head + "file unknown!', Line: -1 Reason: cause "
                                   "unknown!]",
                            head + "x.cpp', Line: 12 Reason: cause unknown!]",
                            head + "x.cpp', Line: 12 Reason: bad index]"));
    EXPECT_EQ(reports, std::vector<std::string>(3, "0"));

    Tracer::setVerbose(false);
    clearMessages();
    reports.clear();
    const HxCSrcRef before;
    EXPECT_FALSE(level.throwAll(Tracer()));
    EXPECT_EQ(HxCSrcRef().getSrcRefId(), before.getSrcRefId() + 1);
    const std::size_t expected = level.head == levels[3].head ? 3 : 0;
    EXPECT_EQ(reports.size(), expected);
    EXPECT_EQ(messages().size(), expected);
    // Without a source, so nothing follows the place.
    EXPECT_THAT(messages(), testing::Each(testing::MatchesRegex(
                                "7/3 Internal error. Error code: "
                                "[^[]*HxCTraceFallThrough.cpp_[^[]*")));
    reports.clear();
  }
}

TEST_F(TraceTest, ControlReportsOnlyWithBothSwitchesOn) {
  HxCControl control;
  void (*const settings[])() = {
      [] { HxCControl::setFallThrough(false); },
      [] { HxCControl::setProductionCodeBehaviour(); },
      [] { HxCControl::setFallThrough(true); },
      [] { HxCControl::setDevelopBehaviour(); }};
  for (int i = 0; i < 8; ++i) {
    SCOPED_TRACE(i);
    HxCControl::setFallThrough(i % 4 < 2);  // the opposite
    settings[i % 4]();
    Tracer::setVerbose(i >= 4);
    clearMessages();
    EXPECT_FALSE(control.traceFallThrough());
    EXPECT_FALSE(control.traceFallThrough("y.cpp", 7));
    EXPECT_FALSE(control.traceFallThrough("y.cpp", 7, "late"));
    if (i < 6)
      EXPECT_THAT(messages(), IsEmpty());
    else
      EXPECT_THAT(
          messages(),
          ElementsAre(StartsWith("1274/6 "),
                      EndsWith("'y.cpp', Line: 7 Reason: cause unknown!]"),
                      EndsWith("'y.cpp', Line: 7 Reason: late]")));
  }
}

TEST_F(TraceTest, TraceFileAppendsExactRecordsUntilShutdownOrAFailedBoot) {
  using T = HxCTransformationTracer;
  T::logTransformation("before boot");
  EXPECT_TRUE(T::boot(m_FileName.c_str()));
  for (const char* text : {"A", "100%s", static_cast<const char*>(nullptr)})
    T::logTransformation(text);
  // The second boot closes, and so writes, the first trace.
  EXPECT_TRUE(T::boot(m_FileName.c_str()));
  EXPECT_EQ(fileContent(), "A \n 100%s \n ");
  T::logTransformation("");
  for (int shutdowns = 0; shutdowns < 2; ++shutdowns)
    EXPECT_TRUE(T::shutdown());
  T::logTransformation("after shutdown");
  EXPECT_EQ(fileContent(), "A \n 100%s \n  \n ");
  EXPECT_THAT(messages(), IsEmpty());

  for (const char* name : {"/no/such/folder/t.txt", "", "/"}) {
    EXPECT_TRUE(T::boot(m_FileName.c_str()));
    clearMessages();
    EXPECT_FALSE(T::boot(name));
    T::logTransformation("lost");
    EXPECT_THAT(
        messages(),
        ElementsAre("90/3 Cannot create file: " + std::string(name) + "."));
  }
  EXPECT_FALSE(T::boot(nullptr));
  EXPECT_EQ(fileContent(), "A \n 100%s \n  \n ");
}

}  // namespace
