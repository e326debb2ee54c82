#include "Control/HxCControl.h"
#include "Diagnostics/HX_FileFixture.h"
#include "SourceRef/HxCSrcRef.h"
#include "Trace/HxCTraceFallThrough.h"
#include "Trace/HxCTransformationTracer.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

using TraceTest = HX_FileFixture;
using Texts = std::vector<std::string>;
using Tracer = HxCTraceFallThrough;
using File = HxCTransformationTracer;

// Calls the three forms of an operation. False if no form returned true.
bool callForms(auto operation) {
  return operation() || operation("x.h", 12) || operation("x.h", 12, "why");
}

// Messages of the levels, by the three forms.
Texts reportsOf(const Texts& levels) {
  Texts texts;
  for (const char* place :
       {"file unknown!', Line: -1 Reason: cause unknown!",
        "x.h', Line: 12 Reason: cause unknown!", "x.h', Line: 12 Reason: why"})
    for (const std::string& level : levels)
      texts.push_back(level + " trace fall through - early abortion. " +
                      "[Internal: Module: '" + place + "]");
  return texts;
}

TEST_F(TraceTest, LevelsReportWhenVerboseAndOnlyDeadlyLevelsElse) {
  recordDebugReports();
  Texts places;
  HX_MessageHandler::instance().setDebugReport(
      [&](const std::string& file, int line, const std::string& expression) {
        places.push_back(file + expression + std::to_string(line));
        return 0;
      });
  const auto callAll = [](auto... place) {
    const Tracer t;
    return t.throwNote(place...) || t.throwWarning(place...) ||
           t.throwError(place...) || t.throwDeadly(place...);
  };
  Tracer::setVerbose(true);
  EXPECT_FALSE(callForms(callAll));
  EXPECT_EQ(messages(), reportsOf({"1272/4", "1273/5", "1274/6", "1275/7"}));
  EXPECT_EQ(places.size(), 12U);
  Tracer::setVerbose(false);
  clearMessages();
  const int number = HxCSrcRef().getSrcRefId();
  EXPECT_FALSE(callForms(callAll));
  EXPECT_EQ(HxCSrcRef().getSrcRefId(), number + 1);
  // Three assertions, each at the place of the debug report and without a
  // source reference behind the text.
  ASSERT_EQ(messages().size(), 3U);
  std::string line = places.back().substr(places.back().find('0') + 1);
  EXPECT_EQ(messages(),
            Texts(3,
                  "7/3 Internal error. Error code: "
                  "Trace/HxCTraceFallThrough.cpp_" +
                      line +
                      ". Please report it to the support, with the model "
                      "if you can."));
  places.erase(places.begin(), places.begin() + 12);
  EXPECT_EQ(places, Texts(3, "Trace/HxCTraceFallThrough.cpp0" + line));
}

TEST_F(TraceTest, ControlReportsOnlyWithBothSwitchesOn) {
  void (*const settings[])() = {[] { HxCControl::setFallThrough(1.0); },
                                [] { HxCControl::setFallThrough(0.0); },
                                HxCControl::setDevelopBehaviour,
                                HxCControl::setProductionCodeBehaviour};
  const Texts reports = reportsOf({"1274/6"});
  const auto call = [](auto... p) {
    return HxCControl().traceFallThrough(p...);
  };
  for (const bool isVerbose : {true, false}) {
    Tracer::setVerbose(isVerbose);
    for (int i = 0; i < 4; ++i) {
      clearMessages();
      settings[i]();
      EXPECT_FALSE(callForms(call));
      EXPECT_EQ(messages(), isVerbose && i % 2 == 0 ? reports : Texts()) << i;
    }
  }
}

TEST_F(TraceTest, TraceFileAppendsExactRecordsUntilShutdownOrAFailedBoot) {
  File::logTransformation("before boot");
  EXPECT_TRUE(File::boot("t.txt"));
  for (const char* text : {"A", "100%s", static_cast<const char*>(nullptr)})
    File::logTransformation(text);
  // The second boot closes, and so writes, the first trace.
  EXPECT_TRUE(File::boot("t.txt"));
  EXPECT_EQ(content("t.txt"), "A \n 100%s \n ");
  File::logTransformation("");
  EXPECT_EQ(File::shutdown() + File::shutdown(), 2);
  File::logTransformation("after shutdown");
  for (const char* name : {"/no/such/folder/t.txt", "/", ""}) {
    EXPECT_TRUE(File::boot("t.txt"));
    EXPECT_FALSE(File::boot(*name != 0 ? name : nullptr));
    File::logTransformation("lost");
    const std::string text = "90/3 Cannot create file: ";
    EXPECT_EQ(messages(), Texts{text + name + "."});
    clearMessages();
  }
  EXPECT_EQ(content("t.txt"), "A \n 100%s \n  \n ");
}

}  // namespace
