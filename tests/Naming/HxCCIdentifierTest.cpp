#include "Naming/HxCCIdentifier.h"

#include <tuple>

#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "support/HX_TestFixture.h"

namespace {

using Id = HxCCIdentifier;
constexpr auto kActive = Id::eActiveName;
constexpr auto kActual = Id::eActualName;
constexpr auto kFormal = Id::eFormalName;

TEST(CIdentifierTest, SetNameSplitsFormalAndActual) {
  const std::tuple<const char*, const char*, const char*, bool> rows[] = {
      {"Var", "Var", "Var$R", true}, {"In:Out", "In", "Out", true},
      {"a:b:c", "a", "b", false},    {"", "", "$R", true},
      {":", "", "", true},           {":b", "", "b", true},
      {"::", "", "", false}};
  for (const auto& [name, formal, actual, twoPartsAtMost] : rows) {
    SCOPED_TRACE(name);
    Id id("old:one");
    id.setCookLevel(Id::eCookLevelFull);
    id.setDollarXValue("x");
    id.setSignalLabel("label");
    id.setIdentifierChangeable(true, kActual);
    id.activateActualName();
    EXPECT_EQ(id.setName(name), twoPartsAtMost);
    EXPECT_EQ(id.getRawName(kFormal), formal);
    EXPECT_EQ(id.getRawName(kActual), actual);
    EXPECT_EQ(id.getCookedName(kActive), formal);
    EXPECT_EQ(id.getCookedName(kActual), actual);
    KyCXString x;
    id.getDollarXValue(x);
    EXPECT_TRUE(x.isEmpty() && id.getSignalLabel().isEmpty());
    EXPECT_EQ(id.getCookLevel(), Id::eCookLevelRaw);
    EXPECT_FALSE(id.getIdentifierChangeable(kActual));
  }
}

TEST(CIdentifierTest, NamesMayBeGivenByThemselves) {
  Id id;
  id = "a_rather_long_name_that_needs_memory_of_its_own:b";
  id = id.getRawName(kFormal);
  EXPECT_EQ(id.getRawName(kActual),
            "a_rather_long_name_that_needs_memory_of_its_own$R");
  id.addPrefix(id.getRawName(kFormal));
  EXPECT_EQ(id.getRawName(kFormal).length(), 94);
  Id suffix("a");
  suffix += "b";
  suffix += suffix.getRawName(kActual);
  EXPECT_EQ(suffix.getCookedName(kFormal), "aba$Rb");
  EXPECT_EQ(suffix.getRawName(kActual), "a$Rba$Rb");
}

TEST(CIdentifierTest, UsedFlagsCountFromTheirLevel) {
  struct Row {
    const char* form;
    bool (Id::*get)(Id::HxENameTypeTag) const;
    void (Id::*set)(bool, Id::HxENameTypeTag);
    int threshold;
  };
  const Row rows[] = {{"x_$L", &Id::getDollarLUsed, &Id::setDollarLUsed, 2},
                      {"x_$E", &Id::getDollarEUsed, &Id::setDollarEUsed, 1},
                      {"x_$N", &Id::getDollarNUsed, &Id::setDollarNUsed, 2}};
  for (const Row& row : rows) {
    for (int level = 0; level <= 3; ++level) {
      SCOPED_TRACE(testing::Message() << row.form << " at level " << level);
      Id with(row.form);
      Id without("x");
      for (Id* id : {&with, &without})
        id->setCookLevel(static_cast<Id::HxECookLevelTag>(level));
      (without.*row.set)(true, kFormal);
      const bool stored = level >= row.threshold;
      EXPECT_EQ((with.*row.get)(kActive), !stored);
      EXPECT_EQ((without.*row.get)(kActive), stored);
      EXPECT_FALSE((without.*row.get)(kActual));
    }
  }
}

TEST(CIdentifierTest, ChangesTouchTheNamesTheySay) {
  Id id("f-1:a-1");
  id.makeCIdentifier();
  id.addPrefix("p-");
  id.addPostfix("-s");
  EXPECT_EQ(id.getRawName(kFormal), "p-f-1-s");
  EXPECT_EQ(id.getCookedName(kFormal), "p-f_1-s");
  EXPECT_EQ(id.getCookedName(kActual), "p-a_1-s");
  id.setCookedName("new", kActual);
  EXPECT_EQ(id.getCookedName(kActual), "new");
  EXPECT_EQ(id.getRawName(kActual), "p-a-1-s");
}

TEST(CIdentifierTest, EqualityIsThatOfTheRawActiveNames) {
  Id a("x:y");
  Id b("x:z");
  b.setCookedName("cooked", kFormal);
  b.setDollarLUsed(true, kFormal);
  EXPECT_TRUE(a == b);
  b.activateActualName();
  EXPECT_FALSE(a == b);
  EXPECT_FALSE(Id(b).isFormalNameActive());
}

TEST(CIdentifierTest, AdaptSizeNeedsTheFlagAndTheOption) {
  const KyCXString longName("abcdefghijklmnopqrstuvwxyz_0123456789");
  HX_OptionsExt options;
  HxCGlobal::setOptions(&options);
  for (int bits = 0; bits < 4; ++bits) {
    options.setLimitVariableNameLength((bits & 1) != 0);
    Id id(longName);
    id.setIdentifierChangeable((bits & 2) != 0, kFormal);
    id.adaptSize();
    EXPECT_EQ(id.getCookedName(kFormal),
              bits == 3 ? "abcdefghijklmno__xyz_0123456789" : longName);
    EXPECT_EQ(id.getCookedName(kActual).length(), bits == 3 ? 31 : 39);
  }
  HxCGlobal::setOptions(nullptr);
}

}  // namespace
