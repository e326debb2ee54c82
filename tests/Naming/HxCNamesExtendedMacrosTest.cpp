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
    Id id("$(Component)");
    id.setDdSourceRef(&ref);
    return expand(id);
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
  const auto conflict = [](const char* second) {
    return std::string(
               "1210/2 The variable was referenced first through the "
               "RelatedVariables property P1 of software component Engine and "
               "second "
               "by the RelatedVariables property ") +
           second +
           " of software component Gear. [//DD0/Pool/Variables/Ctrl/speed]";
  };
  EXPECT_THAT(messages(), ElementsAre(conflict("P3"), conflict("P5")));
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
