#include <tuple>

#include "Naming/HX_NamingFixture.h"
#include "platform/model/HxCSymbol.h"
#include "support/HX_PlainTemplate.h"

namespace {

class SubstitutionTest : public HX_NamingFixture {
 protected:
  std::string substitute(const std::string& form, const char* macro,
                         const char* value, HxCNames::tagMacroKindEnum kind) {
    Id id((form + ":" + form).c_str());
    const Id by((std::string(value) + ":" + value).c_str());
    replaced = names.substAllDollarZByValue(id, macro, by, kind);
    return formal(id);
  }

  bool replaced = false;
};

TEST_F(SubstitutionTest, EveryShortTemplateIsSubstitutedAsPlainly) {
  std::vector<std::string> forms{"$"};
  for (std::size_t i = 0; i < forms.size() && forms[i].size() < 6; ++i)
    for (char c : {'$', 'n', 'N', '(', 'E', ')'}) forms.push_back(forms[i] + c);
  for (const char* macro : {"n", "N", "nN", "(N)"}) {
    for (int kind = 0; kind <= 3; ++kind) {
      for (const std::string& form : forms) {
        const std::string plain =
            HX_PlainSubstitution(form, macro, "aZ$n", kind % 3);
        const auto how = static_cast<HxCNames::tagMacroKindEnum>(kind);
        ASSERT_EQ(substitute(form, macro, "aZ$n", how), plain)
            << form << " by " << macro << " kind " << kind;
        ASSERT_EQ(replaced, plain != form);
      }
    }
  }
}

TEST_F(SubstitutionTest, DollarEGroupsAreMeasured) {
  const std::tuple<const char*, int, int> rows[] = {
      {"(a(b)c)x", 0, 7}, {"('(')", 0, 5},   {"x", 0, 0},
      {"(a", 0, 2},       {"()", 2, 0},      {"()", -1, 0},
      {"(')')", 0, 5},    {"a(b)(c)", 1, 3}, {"('", 0, 2}};
  for (const auto& [text, start, length] : rows)
    EXPECT_EQ(HxCNamesTestAccess::dollarELength(text, start), length) << text;
}

TEST_F(SubstitutionTest, ReferencesFlagsAndLevelsAreTakenOver) {
  const HxCDdSrcRef ddRef(1);
  Id value("v:w");
  value.setSourceRef(gain.getSrcRef());
  value.setDdSourceRef(&ddRef);
  value.setIdentifierChangeable(true, Id::eFormalName);
  value.setCookLevel(Id::eCookLevelDollarE);
  value.setDollarEUsed(true, Id::eFormalName);

  Id id("none");
  EXPECT_FALSE(
      names.substAllDollarZByValue(id, "m", value, HxCNames::eMacroKindExact));
  EXPECT_EQ(id.getSourceRef(), gain.getSrcRef());
  EXPECT_EQ(id.getDdSourceRef(), &ddRef);
  EXPECT_TRUE(id.getIdentifierChangeable(Id::eFormalName));
  EXPECT_FALSE(id.getIdentifierChangeable(Id::eActualName));
  EXPECT_TRUE(id.getDollarEUsed(Id::eFormalName));
  EXPECT_EQ(id.getCookLevel(), Id::eCookLevelDollarE);
  names.substAllDollarZByValue(id, "m", Id("plain"), HxCNames::eMacroKindExact);
  EXPECT_EQ(id.getSourceRef(), gain.getSrcRef());

  Id full("$N:b");
  full.setCookLevel(Id::eCookLevelFull);
  names.substAllDollarZByValue(full, "n", value, HxCNames::eMacroKindAnyCase);
  EXPECT_TRUE(full.getDollarNUsed(Id::eFormalName));
  EXPECT_FALSE(full.getDollarNUsed(Id::eActualName));
  EXPECT_EQ(full.getCookLevel(), Id::eCookLevelFull);
  names.substAllDollarZByValue(full, "e", value, HxCNames::eMacroKindExact);
  EXPECT_EQ(full.getCookLevel(), Id::eCookLevelDollarE);

  Id used("$e$L:b");
  for (const char* macro : {"e", "L"})
    names.substAllDollarZByValue(used, macro, Id("x"),
                                 HxCNames::eMacroKindExact);
  EXPECT_TRUE(used.getDollarEUsed(Id::eFormalName));
  used.setCookLevel(Id::eCookLevelFull);
  EXPECT_TRUE(used.getDollarLUsed(Id::eFormalName));

  Id itself("v:$xL$");  // becomes "$xL$L$"
  itself.activateActualName();
  names.substAllDollarZByValue(itself, "x", itself, HxCNames::eMacroKindExact);
  itself.setCookLevel(Id::eCookLevelFull);
  EXPECT_TRUE(itself.getDollarLUsed(Id::eActualName));
}

TEST_F(SubstitutionTest, FileNamesExpandWhatIsKnownWithoutAnObject) {
  // Template, in the context of the model, with a block -> name, complete.
  const std::tuple<const char*, bool, bool, const char*, bool> rows[] = {
      {"$M_$N", false, false, "plant v2_Ctrl", true},
      {"$B$S$I", false, false, "$B$S$I", false},
      {"$B$S$I", true, false, "_B_S", true},
      {"$B_$S$R", false, true, "Speed_Gain_Sa3", true},
      {"$L$H$O$C$D$T$X", false, true, "$L$H$O$C$D$T$X", false},
      {"$(Type)", false, true, "$(Type)", false}};
  for (const auto& [form, ofModel, hasBlock, result, isComplete] : rows) {
    Id id = identifier(form, hasBlock ? gain.getSrcRef() : nullptr);
    EXPECT_EQ(names.handleFileNameMacro(id, ofModel), isComplete) << form;
    EXPECT_EQ(formal(id), result);
  }
}

TEST_F(SubstitutionTest, SymbolMacrosTakeTheSymbol) {
  HX_DataType type("Int16");
  type.setCut("i16").setBase();
  HxCSymbol variable("Speed", HxCSymbol::eVariable, &type);
  variable.setDollarX("ext");
  HxCSymbol function("step", HxCSymbol::eFunction);
  const auto handle = [this](HxCSymbol& symbol, const char* actualForm) {
    Id id("$x_$X_$v_$V_$t_$T_$f$F:$x:");
    id.setCookedName(actualForm, Id::eActualName);
    names.handleSymbolNameMacro(id, &symbol);
    EXPECT_EQ(id.getCookLevel(), Id::eCookLevelSymbol);
    return formal(id) + " " + actual(id);
  };
  EXPECT_EQ(handle(variable, "$x:$v"),
            "ext_ext_Speed_SPEED_i16_i16_$f$F ext$R:Speed$R");
  EXPECT_EQ(handle(function, "$x:$f"), "__$v_$V___stepSTEP $R:step$R");
}

}  // namespace
