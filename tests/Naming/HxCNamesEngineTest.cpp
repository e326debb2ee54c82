// Examples; tests/plain compares with the plain form on random names.
#include <tuple>

#include "Naming/HX_NamingFixture.h"
#include "platform/model/HxCSymbol.h"
#include "support/HX_HeapCount.h"

namespace {

using testing::ElementsAre;

class NameEngineTest : public HX_NamingFixture {};

TEST_F(NameEngineTest, TemplatesBecomeNames) {
  // Template, object -> names and messages, notes.
  const HxCSrcRef* const block = gain.getSrcRef();
  const HxCSrcRef* const chartBlock = mode.getSrcRef();
  const HxCSrcRef* const object = event.getStateflowSrcRef();
  const std::tuple<const char*, const HxCSrcRef*, const char*, const char*>
      rows[] = {
          {"x_$B", block, "x_Speed_Gain", ":R"},
          {"$S_$I", block, "Sa3_a", "R:R"},
          {"$L$N", block, "Speed_GainCtrl", "LN:R"},
          {"$L$N:$N$L", block, "Speed_GainCtrl:CtrlSpeed_Gain", "LN:LN"},
          {"$$x", block, "$x", ":R"},
          {"A$QB", block, "A$QB 1203", ":R"},
          {"a$", block, "a$ 1203", ":R"},
          {"$E(a(b)-c)x", block, "$E_a_b__c_x 1202", ":RE"},
          {"$(Task)$(Foo)$(Type", block, "__Task___Foo_$(Type 1202 1203", ":R"},
          {":$B", block, "Sa3_Speed_Gain:Speed_Gain 503", "R:"},
          {"", chartBlock, "Cc4_Mode_chart 503", "R:R"},
          {"$C_$B_$I_$O", chartBlock, "Cc4_Mode_c_Mode_chart", "R:R"},
          {"$C_$H", object, "Cc7_Top_Run", "R:R"},
          {"$D", object, "DD_Cc7_go_", "R:R"},
          {"$D", nullptr, "_D", ":R"},
          {"$S$C", nullptr, "_S_C", "R:R"},
          {"a:$Ra", block, "a", ":R"},
          {"a:a", block, "a", ":"},
          {"a$R:b", block, "a:b", "R:"},
          {"a:a$R$R", block, "a", ":R"}};
  for (const auto& [form, srcRef, result, notes] : rows) {
    EXPECT_EQ(expand(form, srcRef), result);
    EXPECT_EQ(noted, notes) << form;
  }
}

TEST_F(NameEngineTest, AMessageNamesMacroTemplateAndReference) {
  gain.setNamedThroughParent(true);
  expand("$B$Q");
  EXPECT_THAT(messages(),
              ElementsAre("1203/1 The '$Q' name macro in the $B$Q name "
                          "template is unknown. It is ignored. "
                          "[car/Ctrl/Speed Gain]"));
}

TEST_F(NameEngineTest, AFurtherComponentIsReportedOnTheVariable) {
  HX_DdTree& tree = HX_DdTree::instance();
  for (const std::string name : {"Engine", "Gear"}) {
    const std::string path = "/Pool/Autosar/SoftwareComponents/" + name;
    tree.add(path, HX_DdTree::kSoftwareComponent);
    tree.addReference(tree.add(path + "/RelatedVariables"), "P of " + name,
                      "Variables/Ctrl");
  }
  const HxCDdSrcRef variable(tree.add("//DD0/Pool/Variables/Ctrl/speed"));
  Id id = identifier("$(Component)");
  id.setDdSourceRef(&variable);
  EXPECT_EQ(expandId(id), "Engine 1210");
  EXPECT_THAT(
      messages(),
      ElementsAre("1210/2 The variable was referenced first through the "
                  "RelatedVariables property P of Engine of software component "
                  "Engine and second by the RelatedVariables property P of "
                  "Gear of software component Gear. "
                  "[//DD0/Pool/Variables/Ctrl/speed]"));
}

TEST_F(NameEngineTest, SymbolMacrosTakeTheSymbol) {
  HX_DataType int16("Int16");
  int16.setCut("i16").setBase();
  HxCSymbol variable("Speed", HxCSymbol::eVariable, &int16);
  variable.setDollarX("ext");
  Id id("$x_$X_$v_$V_$t_$T_$f$F:$x$v$f");
  names.handleSymbolNameMacro(id, &variable);
  EXPECT_EQ(shown(id), "ext_ext_Speed_SPEED_i16_i16_$f$F:ext$RSpeed$R$f");
}

TEST_F(NameEngineTest, AProvisionalDictionaryNameStandsBehindItsPlaceholder) {
  for (const unsigned int retained : {0U, 0x200U}) {
    KyCXString result("x");
    EXPECT_EQ(HxCNamesTestAccess::ddObjectName(names, result, retained), 2);
    EXPECT_EQ(result, retained == 0 ? "x_DGain" : "x_D$D");
  }
}

TEST_F(NameEngineTest, ANameAsksForMemoryOnceAtMost) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  gain.getSrcRef();  // made on demand
  HX_CountingController controller;
  for (const char* longPart : {"", "_and_a_text_longer_than_a_name_may_be"}) {
    Id id = identifier(std::string("$S_$B_$M_$N_$O") + longPart);
    const int before = HX_HeapBlocks();
    names.createNameFromForm(id, nullptr, 0, 0, false);
    const int blocks = HX_HeapBlocks() - before;
    EXPECT_LE(blocks, *longPart == 0 ? 0 : 2) << "for both names";
    EXPECT_EQ(controller.allocated(), 0);
  }
}

}  // namespace
