#include "Control/HxCControl.h"
#include "Diagnostics/HX_FileFixture.h"
#include "SourceRef/HxCSrcRef.h"
#include "Trace/HxCTraceFallThrough.h"
#include "Trace/HxCTransformationTracer.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

using testing::AllOf;
using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;
using Texts = std::vector<std::string>;
using Tracer = HxCTraceFallThrough;

class TraceTest : public HX_FileFixture {
 protected:
  ~TraceTest() override {
    Tracer::setVerbose(false);
    HxCControl::setProductionCodeBehaviour();
    HxCTransformationTracer::shutdown();
  }
};

// What a verbose tracer reports of the three forms of a level.
Texts reportsOf(const std::vector<const char*>& heads) {
  Texts texts;
  for (const std::string head : heads)
    for (const char* place : {"file unknown!', Line: -1 Reason: cause unknown!",
                              "x.cpp', Line: 12 Reason: cause unknown!",
                              "x.cpp', Line: 12 Reason: bad index"})
      texts.push_back(
          head + " trace fall through - early abortion. [Internal: Module: '" +
          place + "]");
  return texts;
}

TEST_F(TraceTest, LevelsReportWhenVerboseAndOnlyDeadlyOnesElse) {
  recordDebugReports();
  Texts reports, places;
  HX_MessageHandler::instance().setDebugReport(
      [&](const std::string& file, int line, const char* expression) {
        places.push_back(file + "_" + std::to_string(line));
        reports.emplace_back(expression);
        return 0;
      });
  const auto throwAll = [](const Tracer& t) {
    return t.throwNote() || t.throwNote("x.cpp", 12) ||
           t.throwNote("x.cpp", 12, "bad index") || t.throwWarning() ||
           t.throwWarning("x.cpp", 12) ||
           t.throwWarning("x.cpp", 12, "bad index") || t.throwError() ||
           t.throwError("x.cpp", 12) ||
           t.throwError("x.cpp", 12, "bad index") || t.throwDeadly() ||
           t.throwDeadly("x.cpp", 12) ||
           t.throwDeadly("x.cpp", 12, "bad index");
  };
  Tracer::setVerbose(true);
  EXPECT_FALSE(throwAll(Tracer()));
  EXPECT_EQ(messages(), reportsOf({"1272/4", "1273/5", "1274/6", "1275/7"}));
  EXPECT_EQ(reports, Texts(12, "0"));

  Tracer::setVerbose(false);
  clearMessages();
  const HxCSrcRef before;
  EXPECT_FALSE(throwAll(Tracer()));
  EXPECT_EQ(HxCSrcRef().getSrcRefId(), before.getSrcRefId() + 1);
  EXPECT_EQ(reports, Texts(15, "0"));
  // Deadly levels alone, by an assertion at the place of the debug report.
  const std::string start = "7/3 Internal error. Error code: ";
  EXPECT_THAT(places.back(), StartsWith("Trace/HxCTraceFallThrough.cpp_"));
  EXPECT_THAT(
      messages(),
      AllOf(SizeIs(3), Each(AllOf(StartsWith(start + places.back() + ". "),
                                  Not(HasSubstr("["))))));
}

TEST_F(TraceTest, ControlReportsOnlyWithBothSwitchesOn) {
  const std::pair<void (*)(), bool> settings[] = {
      {[] { HxCControl::setFallThrough(false); }, false},
      {[] { HxCControl::setFallThrough(true); }, true},
      {[] { HxCControl::setDevelopBehaviour(); }, true},
      {[] { HxCControl::setProductionCodeBehaviour(); }, false}};
  HxCControl control;
  for (const bool isVerbose : {true, false}) {
    Tracer::setVerbose(isVerbose);
    for (const auto& [set, isOn] : settings) {
      HxCControl::setFallThrough(!isOn);
      set();
      clearMessages();
      EXPECT_FALSE(control.traceFallThrough());
      EXPECT_FALSE(control.traceFallThrough("x.cpp", 12));
      EXPECT_FALSE(control.traceFallThrough("x.cpp", 12, "bad index"));
      EXPECT_EQ(messages(),
                isVerbose && isOn ? reportsOf({"1274/6"}) : Texts());
    }
  }
}

TEST_F(TraceTest, TraceFileAppendsExactRecordsUntilShutdownOrAFailedBoot) {
  using T = HxCTransformationTracer;
  T::logTransformation("before boot");
  EXPECT_TRUE(T::boot("t.txt"));
  for (const char* text : {"A", "100%s", static_cast<const char*>(nullptr)})
    T::logTransformation(text);
  // The second boot closes, and so writes, the first trace.
  EXPECT_TRUE(T::boot("t.txt"));
  EXPECT_EQ(content("t.txt"), "A \n 100%s \n ");
  T::logTransformation("");
  for (int shutdowns = 0; shutdowns < 2; ++shutdowns)
    EXPECT_TRUE(T::shutdown());
  T::logTransformation("after shutdown");
  EXPECT_EQ(messages(), Texts());

  for (const char* name : {"/no/such/folder/t.txt", "", "/"}) {
    EXPECT_TRUE(T::boot("t.txt"));
    clearMessages();
    EXPECT_FALSE(T::boot(name));
    T::logTransformation("lost");
    EXPECT_THAT(
        messages(),
        ElementsAre("90/3 Cannot create file: " + std::string(name) + "."));
  }
  EXPECT_FALSE(T::boot(nullptr));
  EXPECT_EQ(content("t.txt"), "A \n 100%s \n  \n ");
}

}  // namespace
