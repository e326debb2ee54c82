#include "Naming/HX_NamingFixture.h"
#include "platform/model/HxCSymbol.h"
#include "support/HX_PlainTemplate.h"

namespace {

class SubstitutionTest : public HX_NamingFixture {
 protected:
  std::string substitute(const std::string& form, const char* macro,
                         const char* value, HxCNames::tagMacroKindEnum kind) {
    HxCCIdentifier id((form + ":" + form).c_str());
    const HxCCIdentifier by((std::string(value) + ":" + value).c_str());
    replaced = names.substAllDollarZByValue(id, macro, by, kind);
    return formal(id);
  }

  bool replaced = false;
};

TEST_F(SubstitutionTest, EveryShortTemplateIsSubstitutedAsPlainly) {
  const std::string alphabet = "$nN(E)";
  std::vector<std::string> forms{"$"};
  for (std::size_t i = 0; i < forms.size() && forms[i].size() < 6; ++i)
    for (char c : alphabet) forms.push_back(forms[i] + c);
  for (const char* macro : {"n", "N", "nN", "(N)"}) {
    for (int kind = 0; kind <= 2; ++kind) {
      for (const std::string& form : forms) {
        const auto how = static_cast<HxCNames::tagMacroKindEnum>(kind);
        ASSERT_EQ(substitute(form, macro, "aZ$n", how),
                  HX_PlainSubstitution(form, macro, "aZ$n", kind))
            << form << " by " << macro << " kind " << kind;
      }
    }
  }
}

TEST_F(SubstitutionTest, ExtendedMacrosNeedTheirParentheses) {
  EXPECT_EQ(substitute("$(Task)x", "(Task)", "t", HxCNames::eMacroKindExact),
            "tx");
  EXPECT_TRUE(replaced);
  EXPECT_EQ(substitute("$(Task)x", "Task", "t", HxCNames::eMacroKindExact),
            "$(Task)x");
  EXPECT_FALSE(replaced);
  EXPECT_EQ(substitute("$$x", "x", "t", HxCNames::eMacroKindExact), "$$x");
  EXPECT_EQ(substitute("$x$X", "x", "t", HxCNames::tagMacroKindEnum{3}), "t$X");
}

TEST_F(SubstitutionTest, DollarEGroupsAreMeasured) {
  struct Row {
    const char* text;
    int start;
    int length;
  };
  const Row rows[] = {{"(a(b)c)x", 0, 7}, {"('(')", 0, 5},   {"x", 0, 0},
                      {"(a", 0, 2},       {"()", 2, 0},      {"()", -1, 0},
                      {"(')')", 0, 5},    {"a(b)(c)", 1, 3}, {"('", 0, 2}};
  for (const Row& row : rows)
    EXPECT_EQ(HxCNamesTestAccess::dollarELength(row.text, row.start),
              row.length)
        << row.text;
}

TEST_F(SubstitutionTest, ReferencesFlagsAndLevelsAreTakenOver) {
  using Id = HxCCIdentifier;
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

  Id itself("v:$xL$");  // becomes "$xL$L$"
  itself.activateActualName();
  names.substAllDollarZByValue(itself, "x", itself, HxCNames::eMacroKindExact);
  itself.setCookLevel(Id::eCookLevelFull);
  EXPECT_TRUE(itself.getDollarLUsed(Id::eActualName));
}

TEST_F(SubstitutionTest, FileNamesExpandWhatIsKnownWithoutAnObject) {
  struct Row {
    const char* form;
    bool modelContext;
    bool hasSource;
    const char* result;
    bool complete;
  };
  const Row rows[] = {
      {"$M_$N", false, false, "plant v2_Ctrl", true},
      {"$B$S$I", false, false, "$B$S$I", false},
      {"$B$S$I", true, false, "_B_S", true},
      {"$B_$S$R", false, true, "Speed_Gain_Sa3", true},
      {"$L$H$O$C$D$T$X", false, true, "$L$H$O$C$D$T$X", false},
      {"$(Type)", false, true, "$(Type)", false},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.form);
    HxCCIdentifier id =
        identifier(row.form, row.hasSource ? gain.getSrcRef() : nullptr);
    EXPECT_EQ(names.handleFileNameMacro(id, row.modelContext), row.complete);
    EXPECT_EQ(formal(id), row.result);
  }
}

TEST_F(SubstitutionTest, SymbolMacrosTakeTheSymbol) {
  HX_DataType type("Int16");
  type.setCut("i16").setBase();
  HxCSymbol variable("Speed", HxCSymbol::eVariable, &type);
  HxCSymbol function("step", HxCSymbol::eFunction);
  variable.setDollarX("ext");
  struct Row {
    HxCSymbol* symbol;
    const char* formal;
    const char* actual;
  };
  const Row rows[] = {
      {&variable, "ext_ext_Speed_SPEED_i16_i16_$f$F", "ext$R:Speed$R"},
      {&function, "__$v_$V___stepSTEP", "$R:step$R"}};
  for (const Row& row : rows) {
    HxCCIdentifier id("$x_$X_$v_$V_$t_$T_$f$F:$x:");
    const bool isFunction = row.symbol == &function;
    id.setCookedName(isFunction ? "$x:$f" : "$x:$v",
                     HxCCIdentifier::eActualName);
    names.handleSymbolNameMacro(id, row.symbol);
    EXPECT_EQ(formal(id), row.formal);
    EXPECT_EQ(actual(id), row.actual);
    EXPECT_EQ(id.getCookLevel(), HxCCIdentifier::eCookLevelSymbol);
  }
}

}  // namespace
