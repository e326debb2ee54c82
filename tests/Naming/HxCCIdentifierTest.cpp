#include "Naming/HxCCIdentifier.h"

#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "support/HX_TestFixture.h"

namespace {

constexpr auto kActive = HxCCIdentifier::eActiveName;
constexpr auto kActual = HxCCIdentifier::eActualName;
constexpr auto kFormal = HxCCIdentifier::eFormalName;

struct SetNameCase {
  const char* why;
  const char* name;
  const char* formal;
  const char* actual;
  bool twoPartsAtMost;
};

const SetNameCase kSetNameCases[] = {
    {"one part may be changed", "Var", "Var", "Var$R", true},
    {"two parts", "In:Out", "In", "Out", true},
    {"a third part is refused and ignored", "a:b:c", "a", "b", false},
    {"empty name", "", "", "$R", true},
    {"empty parts", ":", "", "", true},
    {"empty formal part", ":b", "", "b", true},
};

TEST(CIdentifierTest, SetNameSplitsFormalAndActual) {
  for (const SetNameCase& row : kSetNameCases) {
    SCOPED_TRACE(row.why);
    HxCCIdentifier id("old:one");
    id.setCookLevel(HxCCIdentifier::eCookLevelFull);
    id.setDollarXValue("x");
    id.setSignalLabel("label");
    id.setIdentifierChangeable(true, kActual);
    id.activateActualName();
    EXPECT_EQ(id.setName(row.name), row.twoPartsAtMost);
    EXPECT_STREQ(id.getRawName(kFormal).cstring(), row.formal);
    EXPECT_STREQ(id.getRawName(kActual).cstring(), row.actual);
    EXPECT_EQ(id.getCookedName(kActive), id.getRawName(kFormal));
    EXPECT_EQ(id.getCookedName(kActual), id.getRawName(kActual));
    KyCXString x;
    id.getDollarXValue(x);
    EXPECT_TRUE(x.isEmpty() && id.getSignalLabel().isEmpty());
    EXPECT_EQ(id.getCookLevel(), HxCCIdentifier::eCookLevelRaw);
    EXPECT_FALSE(id.getIdentifierChangeable(kActual));
  }
}

TEST(CIdentifierTest, NamesMayBeGivenByThemselves) {
  HxCCIdentifier id("a_rather_long_name_that_needs_memory_of_its_own:b");
  id = id.getRawName(kFormal);
  EXPECT_STREQ(id.getRawName(kActual).cstring(),
               "a_rather_long_name_that_needs_memory_of_its_own$R");
  id.addPrefix(id.getRawName(kFormal));
  EXPECT_EQ(id.getRawName(kFormal).length(), 94);
  HxCCIdentifier suffix("ab");
  suffix += suffix.getRawName(kActual);
  EXPECT_STREQ(suffix.getCookedName(kFormal).cstring(), "abab$R");
  EXPECT_STREQ(suffix.getRawName(kActual).cstring(), "ab$Rab$R");
}

TEST(CIdentifierTest, UsedFlagsCountFromTheirLevel) {
  struct Row {
    const char* form;
    bool (HxCCIdentifier::*get)(HxCCIdentifier::HxENameTypeTag) const;
    void (HxCCIdentifier::*set)(bool, HxCCIdentifier::HxENameTypeTag);
    int threshold;
  };
  using Id = HxCCIdentifier;
  const Row rows[] = {{"x_$L", &Id::getDollarLUsed, &Id::setDollarLUsed, 2},
                      {"x_$E", &Id::getDollarEUsed, &Id::setDollarEUsed, 1},
                      {"x_$N", &Id::getDollarNUsed, &Id::setDollarNUsed, 2}};
  for (const Row& row : rows) {
    for (int level = 0; level <= 3; ++level) {
      SCOPED_TRACE(std::string(row.form) + " at level " +
                   std::to_string(level));
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
  HxCCIdentifier id("f-1:a-1");
  id.makeCIdentifier();
  id.addPrefix("p-");
  id.addPostfix("-s");
  EXPECT_STREQ(id.getRawName(kFormal).cstring(), "p-f-1-s");
  EXPECT_STREQ(id.getCookedName(kFormal).cstring(), "p-f_1-s");
  EXPECT_STREQ(id.getRawName(kActual).cstring(), "p-a-1-s");
  id.setCookedName("new", kActual);
  EXPECT_STREQ(id.getCookedName(kActual).cstring(), "new");
  EXPECT_STREQ(id.getRawName(kActual).cstring(), "p-a-1-s");
}

TEST(CIdentifierTest, EqualityIsThatOfTheRawActiveNames) {
  HxCCIdentifier a("x:y");
  HxCCIdentifier b("x:z");
  b.setCookedName("cooked", kFormal);
  b.setDollarLUsed(true, kFormal);
  EXPECT_TRUE(a == b);
  b.activateActualName();
  EXPECT_FALSE(a == b);
  const HxCCIdentifier copy(b);
  EXPECT_FALSE(copy.isFormalNameActive());
}

TEST(CIdentifierTest, AdaptSizeNeedsTheFlagAndTheOption) {
  const KyCXString longName("abcdefghijklmnopqrstuvwxyz_0123456789");
  HX_OptionsExt options;
  HxCGlobal::setOptions(&options);
  for (bool changeable : {false, true}) {
    for (bool limited : {false, true}) {
      options.setLimitVariableNameLength(limited);
      HxCCIdentifier id(longName);
      id.setIdentifierChangeable(changeable, kFormal);
      id.adaptSize();
      const bool cut = changeable && limited;
      EXPECT_STREQ(
          id.getCookedName(kFormal).cstring(),
          cut ? "abcdefghijklmno__xyz_0123456789" : longName.cstring());
      EXPECT_EQ(id.getCookedName(kActual).length(), cut ? 31 : 39);
    }
  }
  HxCGlobal::setOptions(nullptr);
}

}  // namespace
