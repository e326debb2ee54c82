#include <tuple>
#include <utility>

#include "Naming/HX_NamingFixture.h"
#include "platform/datadictionary/kyddapi.h"
#include "platform/datatypes/HX_NumericalType.h"

namespace {

using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;

class MacrosTest : public HX_NamingFixture {};

TEST_F(MacrosTest, EverySingleLetterMacroObeysItsBits) {
  // Macro, bit, values for "Speed Gain" and for no object, notes of the first
  // value.
  const std::tuple<const char*, unsigned, const char*, const char*, const char*>
      rows[] = {{"$L", 0x1, "Speed_Gain", "", "L:R"},
                {"$B", 0x2, "Speed_Gain", "_B", ":R"},
                {"$S", 0x4, "Sa3", "_S", "R:R"},
                {"$I", 0x8, "a", "", ":R"},
                {"$M", 0x10, "plant v2", "plant v2", ":R"},
                {"$N", 0x20, "Ctrl", "Ctrl", "N:R"},
                {"$H", 0x40, "_H", "_H", ":R"},
                {"$O", 0x80, "_O", "_O", ":R"},
                {"$C", 0x100, "_C", "_C", ":R"},
                {"$T", 0x400, "_T", "_T", ":R"},
                {"$X", 0x800, "_X", "_X", ":R"},
                {"$R", 0x1000, "", "", "R:R"},
                {"$(Type)", 0x80000, "__Type_", "__Type_", ":R"},
                {"$(BaseType)", 0x80000, "__BaseType_", "__BaseType_", ":R"}};
  const HxCSrcRef* block = gain.getSrcRef();
  for (const auto& [macro, bit, value, placeholder, notes] : rows) {
    SCOPED_TRACE(macro);
    EXPECT_EQ(expand(macro, nullptr), placeholder);
    EXPECT_EQ(expand(macro, block, ~bit, ~bit), value);
    EXPECT_TRUE(complete);
    EXPECT_EQ(noted, notes);
    EXPECT_EQ(expand(macro, block, bit), macro);
    EXPECT_FALSE(complete);
    // A retained macro is used, here and in the copy, but changes no flag R.
    const std::string used(notes[0] == 'L' || notes[0] == 'N' ? 1 : 0, *notes);
    EXPECT_EQ(noted, used + ":R" + used);
    EXPECT_EQ(expand(macro, block, 0, bit), value);
    EXPECT_FALSE(complete);
  }
}

TEST_F(MacrosTest, IdentifiersOwnTextsAreLabelAndX) {
  // Label -> $L. Blanks and one enclosing pair of brackets do not count.
  const std::pair<const char*, const char*> rows[] = {
      {"  <speed> ", "speed"}, {"< a b >", "a_b"}, {"", "Speed_Gain"},
      {" <> ", "Speed_Gain"},  {"a<-b", "a__b"},   {"9", "_9"}};
  for (const auto& [label, result] : rows) {
    Id id = identifier("$L_$X");
    id.setSignalLabel(label);
    id.setDollarXValue("x-y");
    EXPECT_EQ(expandId(id), result + std::string("_x-y"));
  }
}

TEST_F(MacrosTest, DataDictionaryNamesFallBackToWhatIdentifiesTheObject) {
  const HxCDdSrcRef known(HX_DdTree::instance().add("//DD0/Pool/K p"));
  const HxCDdSrcRef lost(4711);
  const HxCSrcRef* sf = event.getStateflowSrcRef();
  const HxCSrcRef* block = gain.getSrcRef();
  struct Row {
    const HxCSrcRef *srcRef, *ddRef;
    const char *result, *notes;
    unsigned int retained = 0, provisional = 0;
  };
  const Row rows[] = {
      {sf, &known, "K p", ":R"},
      {sf, &lost, "_D", ":R"},
      {nullptr, sf, "_D", ":R"},  // no data dictionary reference
      {nullptr, nullptr, "_D", ":R"},
      {sf, nullptr, "DD_Cc7_go_", "R:R"},
      // Retained macros count only for $D itself.
      {sf, nullptr, "DD_Cc7_go_", "R:R", 0x1FD},
      {block, nullptr, "DD_Sa3_Speed_Gain", "R:R", 0x6, 0x6},
      {sf, &known, "$D", ":R", 0x200},
      {sf, &known, "_D", ":R", 0x200, 0x200},
  };
  for (const auto& [srcRef, ddRef, result, notes, retained, provisional] :
       rows) {
    Id id = identifier("$D", srcRef);
    id.setDdSourceRef(ddRef);
    EXPECT_EQ(expandId(id, retained, provisional), result);
    EXPECT_EQ(noted, notes) << result;
    EXPECT_EQ(complete, ((retained | provisional) & 0x200) == 0) << result;
  }
  for (unsigned int retained : {0U, 0x200U}) {
    KyCXString result("x");
    EXPECT_EQ(HxCNamesTestAccess::ddObjectName(names, result, retained), 2);
    EXPECT_EQ(result, retained == 0 ? "x_DGain" : "x_D$D");
  }
}

struct My : HX_DataType {
  My() : HX_DataType("My- Type") {}
};

TEST_F(MacrosTest, TypesAreAskedWhatTheyAre) {
  HX_DataType base("Int  16"), bits("Bits"), nameless("");
  base.setCut("i-16").setBase();
  HX_NumericalType isSigned(-9e18, 9e18, 64, true), plain(0, 9e18, 64, false);
  const auto namesOf = [&](HX_DataType& asked, HX_DataType* bitfieldBase) {
    types.getBaseServer()->setBitfieldBaseType(bitfieldBase);
    type = &asked;
    return expand("$T|$(Type)|$(BaseType)");
  };
  const auto of = [&](HX_DataType& asked) { return namesOf(asked, &bits); };
  // Short name, long name and name of the base.
  const std::string unknown = "|My__Type|_UnknownHXBaseType_";
  const std::pair<std::string, std::string> rows[] = {
      {of(My().setUnnamed(My::eUnnamedStruct, false).setDerivedFrom(&base)),
       "||"},
      {of(My().setUnnamed(My::eUnnamedEnum, true)), "|My__Type|"},
      {of(My().setDerivedFrom(&base)), "i-16|My__Type|Int__16"},
      {of(My().setCut("b").setBase().setDerivedFrom(&base)),
       "i-16|My__Type|Int__16"},
      {of(My().setDerivedFrom(nullptr)), unknown},
      {of(My().setCut("b").setBase().set64BitInteger()), "b|My__Type|My__Type"},
      {of(My().setElement(&base)), "i-16|Int__16|Int__16"},
      {of(My().set64BitInteger().setNumerical(&isSigned)), "I64" + unknown},
      {of(My().set64BitInteger().setNumerical(&plain)), "U64" + unknown},
      {of(My().setNumerical(&plain).setCut("n").setOrigin(&base)),
       "n|My__Type|Int__16"},
      {of(My().setNumerical(&plain).setUnderlyingType(&base)),
       "i-16" + unknown},
      {of(My().setNumerical(&plain)), unknown},
      {of(My().setOrigin(&base)), "|| 7 7 7"},
      {of(My().setDerivedFrom(&base).setBitfield()), "i-16|My__Type|Bits"},
      {namesOf(My().setDerivedFrom(&base).setBitfield(), nullptr),
       "i-16" + unknown},
      {namesOf(My().setDerivedFrom(&base).setBitfield(), &nameless),
       "i-16" + unknown}};
  for (const auto& [found, expected] : rows) EXPECT_EQ(found, expected);
  EXPECT_EQ(messages().size(), 3U);
  EXPECT_THAT(messages(), Each(HX_Fits(kAssertion)));
}

class ComponentTest : public HX_NamingFixture {
 protected:
  ~ComponentTest() override { EXPECT_EQ(DDAPIHeapBalance(), 0); }

  /// Value of $(Component) for the variable at \p path, given by the data
  /// dictionary reference or by the source reference.
  std::string component(const char* path, bool isSource = false) {
    const HxCDdSrcRef ref(HX_DdTree::instance().add(path));
    Id id("$(Component)");
    isSource ? id.setSourceRef(&ref) : id.setDdSourceRef(&ref);
    return expandId(id);
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

TEST_F(ComponentTest, ComponentIsTheFirstThatRefersToTheVariable) {
  EXPECT_EQ(component(kVariable), " 1209");
  addComponent("Brake", "P0", "Variables/Brake");
  addComponent("Engine", "P1", "Variables/Ctrl");
  addComponent("Engine", "P2", "Variables/Ctrl/speed");
  for (const bool isSource : {false, true})
    EXPECT_EQ(component(kVariable, isSource), "Engine");
  EXPECT_EQ(component("//DD0/Pool/Variables/Brake"), "Brake");
  EXPECT_EQ(component("//DD0/Pool/Types/Ctrl"), "");
  addComponent("Gear", "P3", "Variables/Ctrl");
  addComponent("Gear", "P4", "Variables/Other");
  addComponent("Gear", "P5", "Variables/Ctrl/speed");
  EXPECT_EQ(component(kVariable), "Engine 1210 1210");
  EXPECT_EQ(component("//DD0/Pool/Variables/Lost"), " 1209");
  EXPECT_EQ(expand("x$(Component)"), "x 1209");
  EXPECT_EQ(expand("x$(Component)", nullptr), "x 1209");

  const std::string missing =
      "1209/1 The $(Component) name macro could not substitute";
  const std::string speed = " [//DD0/Pool/Variables/Ctrl/speed]";
  EXPECT_THAT(
      messages(),
      ElementsAre(missing + speed,
                  "1210/2 The variable was referenced first through "
                  "the RelatedVariables property P1 of software "
                  "component Engine and second by the RelatedVariables "
                  "property P3 of software component Gear." +
                      speed,
                  HasSubstr("property P5 of software component Gear"),
                  missing + " [//DD0/Pool/Variables/Lost]", missing, missing));
}

}  // namespace
