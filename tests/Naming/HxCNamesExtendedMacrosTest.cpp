#include "Naming/HX_NamingFixture.h"
#include "platform/datadictionary/kyddapi.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ExtendedMacrosTest : public HX_NamingFixture {
 protected:
  ~ExtendedMacrosTest() override { EXPECT_EQ(DDAPIHeapBalance(), 0); }

  /// What $(Component) gives for the variable at \p path.
  std::string component(const char* path) {
    const HxCDdSrcRef ref(HX_DdTree::instance().add(path));
    HxCCIdentifier id("$(Component)");
    id.setDdSourceRef(&ref);
    names.createNameFromForm(id, nullptr, 0, 0, false);
    return formal(id);
  }
  static void addComponent(const char* name, const char* property,
                           const char* variable) {
    HX_DdTree& tree = HX_DdTree::instance();
    const std::string path =
        std::string("/Pool/Autosar/SoftwareComponents/") + name;
    tree.add(path, HX_DdTree::kSoftwareComponent);
    tree.addReference(tree.add(path + "/RelatedVariables"), property, variable);
  }

  static constexpr const char* kVariable = "//DD0/Pool/Variables/Ctrl/speed";
};

TEST_F(ExtendedMacrosTest, EveryUnexpandedNameLeavesAPlaceholder) {
  std::vector<std::string> known = {"Task",
                                    "ISR",
                                    "Msg",
                                    "Ctr",
                                    "Event",
                                    "MsgVar",
                                    "PObj",
                                    "Section",
                                    "Module",
                                    "FunctionName",
                                    "DataVariantName",
                                    "PageNumber",
                                    "VariantItemName"};
  for (const char* kind : {"Time", "Period", "Offset"})
    for (const char* unit : {"1us", "10us", "100us", "1ms", "10ms", "100ms",
                             "1s", "1m", "1h", "1d", ""})
      known.push_back(std::string(kind) + unit);
  std::vector<std::string> unknown = {"task", "Foo",   "Time2ms",
                                      "",     "Type ", "$"};
  for (const auto* list : {&known, &unknown}) {
    for (const std::string& name : *list) {
      const std::string form = "a$(" + name + ")b";
      clearMessages();
      EXPECT_EQ(expand(form.c_str(), gain.getSrcRef()), "a__" + name + "_b");
      const bool isKnown = list == &known;
      EXPECT_THAT(
          messages(),
          ElementsAre((isKnown ? "1202/1 The $" : "1203/1 The $") + name +
                      " name macro in the " + form + " name template is " +
                      (isKnown ? "not supported here" : "unknown") +
                      ". It is ignored. [car/Ctrl/Speed Gain]"));
      HxCCIdentifier quiet = identifier(form.c_str(), gain.getSrcRef());
      names.createNameFromForm(quiet, nullptr, 0, 0, true);
      EXPECT_EQ(messages().size(), 1U);
    }
  }
}

TEST_F(ExtendedMacrosTest, AnUnclosedMacroEndsTheScan) {
  EXPECT_EQ(expand("$B$(Type$B", gain.getSrcRef()), "Speed_Gain$(Type$B");
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(ExtendedMacrosTest, ComponentIsTheFirstThatRefersToTheVariable) {
  EXPECT_EQ(component(kVariable), "");
  EXPECT_THAT(messages(),
              ElementsAre("1209/1 The $(Component) name macro could not "
                          "substitute [//DD0/Pool/Variables/Ctrl/speed]"));
  clearMessages();
  addComponent("Brake", "P0", "Variables/Brake");
  addComponent("Engine", "P1", "Variables/Ctrl");
  addComponent("Engine", "P2", "Variables/Ctrl/speed");
  EXPECT_EQ(component(kVariable), "Engine");
  EXPECT_EQ(component("//DD0/Pool/Variables/Brake"), "Brake");
  EXPECT_EQ(component("//DD0/Pool/Types/Ctrl"), "");
  EXPECT_THAT(messages(), IsEmpty());
  addComponent("Gear", "P3", "Variables/Ctrl");
  addComponent("Gear", "P4", "Variables/Other");
  addComponent("Gear", "P5", "Variables/Ctrl/speed");
  EXPECT_EQ(component(kVariable), "Engine");
  const std::string conflict =
      "1210/2 The variable was referenced first through the RelatedVariables "
      "property P1 of software component Engine and second by the "
      "RelatedVariables property P%d of software component Gear. "
      "[//DD0/Pool/Variables/Ctrl/speed]";
  std::string third = conflict;
  std::string fifth = conflict;
  EXPECT_THAT(messages(), ElementsAre(third.replace(third.find("%d"), 2, "3"),
                                      fifth.replace(fifth.find("%d"), 2, "5")));
  clearMessages();
  EXPECT_EQ(component("//DD0/Pool/Variables/Lost"), "");
  EXPECT_EQ(messages().size(), 1U);
}

TEST_F(ExtendedMacrosTest, ComponentTakesTheSourceReferenceInstead) {
  addComponent("Engine", "P1", "Variables/Ctrl");
  const HxCDdSrcRef ref(HX_DdTree::instance().add(kVariable));
  EXPECT_EQ(expand("$(Component)", &ref), "Engine");
  EXPECT_EQ(expand("x$(Component)", gain.getSrcRef()), "x");
  EXPECT_EQ(expand("x$(Component)", nullptr), "x");
  const std::string message =
      "1209/1 The $(Component) name macro could not substitute";
  EXPECT_THAT(messages(), ElementsAre(message, message));
}

}  // namespace
