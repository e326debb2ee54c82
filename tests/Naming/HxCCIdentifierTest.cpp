#include "Naming/HxCCIdentifier.h"

#include <tuple>

#include "Naming/HX_NamingFixture.h"

namespace {

class CIdentifierTest : public HX_NamingFixture {
 protected:
  static constexpr auto kActual = Id::eActualName;
  static constexpr auto kFormal = Id::eFormalName;

  /// Raw names, cooked names, notes and level.
  std::string all(Id id) {
    const KyCXString raw =
        id.getRawName(kFormal) + ":" + id.getRawName(kActual);
    return raw.cstring() + (" " + shown(id)) + " " + notedOf(id) + " " +
           std::to_string(id.getCookLevel());
  }
};

TEST_F(CIdentifierTest, SetNameSplitsFormalAndActual) {
  const std::tuple<const char*, const char*, bool> rows[] = {
      {"Var", "Var:Var$R Var:Var$R : 0", true},
      {"In:Out", "In:Out In:Out : 0", true},
      {"a:b:c", "a:b a:b : 0", false},  // more than two parts
      {"", ":$R :$R : 0", true},
      {":", ":  : 0", true},
      {":b", ":b :b : 0", true},
      {"::", ":  : 0", false}};
  Id id("old:one");
  HX_BdBlock ivBlock("iv");
  for (const auto& [name, result, twoPartsAtMost] : rows) {
    id.setSourceRef(gain.getSrcRef());
    id.setDdSourceRef(gain.getSrcRef());
    id.setSourceIVBlock(&ivBlock);
    id.setCookLevel(Id::eCookLevelFull);
    id.setDollarXValue("x");
    id.setSignalLabel("label");
    id.setIdentifierChangeable(true, kActual);
    id.activateActualName();
    EXPECT_EQ(id.setName(name), twoPartsAtMost) << name;
    EXPECT_EQ(all(id), result);
    KyCXString rest;
    id.getDollarXValue(rest);
    EXPECT_EQ(rest, "");
    EXPECT_EQ(id.getSignalLabel(), "");
    EXPECT_TRUE(id.isFormalNameActive());
    EXPECT_EQ(id.getSourceRef(), nullptr);
    EXPECT_EQ(id.getDdSourceRef(), nullptr);
    EXPECT_EQ(id.getSourceIVBlock(), nullptr);
  }
}

TEST_F(CIdentifierTest, CopiesHaveEveryField) {
  HX_BdBlock ivBlock("iv");
  const HxCDdSrcRef ddRef(1);
  Id id = identifier("a:b");
  id.setCookedName("c", kFormal);
  id.setCookedName("d", kActual);
  id.activateActualName();
  id.setDdSourceRef(&ddRef);
  id.setSourceIVBlock(&ivBlock);
  id.setSignalLabel("label");
  id.setDollarXValue("x");
  Id assigned("other");
  for (int bit = 0; bit < 8; ++bit) {
    const auto name = bit < 4 ? kFormal : kActual;
    id.setIdentifierChangeable(bit % 4 == 0, name);
    id.setDollarLUsed(bit % 4 == 1, name);
    id.setDollarEUsed(bit % 4 == 2, name);
    id.setDollarNUsed(bit % 4 == 3, name);
    id.setCookLevel(bit % 2 == 0 ? Id::eCookLevelSymbol : Id::eCookLevelFull);
    assigned = id;
    Id made(assigned);
    EXPECT_EQ(all(made), all(id));
    EXPECT_EQ(all(assigned), all(id));
    EXPECT_FALSE(made.isFormalNameActive());
    EXPECT_EQ(made.getSourceRef(), gain.getSrcRef());
    EXPECT_EQ(made.getDdSourceRef(), &ddRef);
    EXPECT_EQ(made.getSourceIVBlock(), &ivBlock);
    EXPECT_EQ(made.getSignalLabel(), "label");
    KyCXString x;
    made.getDollarXValue(x);
    EXPECT_EQ(x, "x");
  }
}

TEST_F(CIdentifierTest, NamesMayBeGivenByThemselves) {
  Id id;
  id = "a_rather_long_name_that_needs_memory_of_its_own:b";
  id = id.getRawName(kFormal);
  id.addPrefix(id.getRawName(kFormal));
  const std::string name = "a_rather_long_name_that_needs_memory_of_its_own";
  const std::string both = name + name + ":" + name + name + "$R";
  EXPECT_EQ(all(id), both + " " + both + " : 0");
  Id suffix("a");
  suffix += "b";
  suffix += suffix.getRawName(kActual);
  EXPECT_EQ(all(suffix), "aba$Rb:a$Rba$Rb aba$Rb:a$Rba$Rb : 0");
}

TEST_F(CIdentifierTest, UsedFlagsCountFromTheirLevel) {
  const char* const ofTexts[] = {"LEN:", "LN:", ":", ":"};
  const char* const stored[] = {":", "E:E", "LE:EN", "LE:EN"};
  for (int level = 0; level <= 3; ++level) {
    Id with("x_$L$$E$N:");
    Id without("LEN:$");
    without.setDollarLUsed(true, kFormal);
    without.setDollarEUsed(true, kFormal);
    without.setDollarEUsed(true, kActual);
    without.setDollarNUsed(true, kActual);
    for (Id* id : {&with, &without})
      id->setCookLevel(static_cast<Id::HxECookLevelTag>(level));
    EXPECT_EQ(notedOf(with), ofTexts[level]) << level;
    EXPECT_EQ(notedOf(without), stored[level]) << level;
  }
}

TEST_F(CIdentifierTest, ChangesTouchTheNamesTheySay) {
  Id id("f-1:a-1");
  id.makeCIdentifier();
  id.addPrefix("p-");
  id.addPostfix("-s");
  EXPECT_EQ(all(id), "p-f-1-s:p-a-1-s p-f_1-s:p-a_1-s : 0");
  id.setCookedName("new", kFormal);
  EXPECT_EQ(all(id), "p-f-1-s:p-a-1-s new:p-a_1-s : 0");
  // The raw active names decide about equality.
  EXPECT_TRUE(id == Id("p-f-1-s:b"));
  id.activateActualName();
  EXPECT_FALSE(id == Id("p-f-1-s:b"));
  EXPECT_TRUE(Id(id) == Id("p-a-1-s"));
}

TEST_F(CIdentifierTest, AdaptSizeNeedsTheFlagAndTheOption) {
  const std::string name = "abcdefghijklmnopqrstuvwxyz_0123456789";
  for (int bits = 0; bits < 4; ++bits) {
    options.setLimitVariableNameLength((bits & 1) != 0);
    Id id = identifier(name, nullptr);
    id.setIdentifierChangeable((bits & 2) != 0, kFormal);
    id.adaptSize();
    EXPECT_EQ(shown(id), bits == 3 ? "abcdefghijklmno__xyz_0123456789:"
                                     "abcdefghijklmno__z_0123456789$R"
                                   : name + ":" + name + "$R");
  }
}

}  // namespace
