#include <tuple>

#include "Naming/HX_NamingFixture.h"
#include "platform/model/HxCSymbol.h"
#include "support/HX_PlainTemplate.h"

namespace {

class SubstitutionTest : public HX_NamingFixture {};

TEST_F(SubstitutionTest, EveryShortTemplateIsSubstitutedAsPlainly) {
  std::vector<std::string> forms = HX_TextsUpTo(6, "$nN(E)");
  std::erase_if(forms, [](const std::string& form) { return form[0] != '$'; });
  for (const std::string& group : HX_TextsUpTo(6, "()'"))
    forms.push_back("$E" + group + "$n");
  const Id value("aZ$n:aZ$n");
  for (const char* macro : {"n", "N", "nN", "(N)"}) {
    for (int kind = 0; kind <= 3; ++kind) {
      SCOPED_TRACE(testing::Message() << macro << " in kind " << kind);
      for (const std::string& form : forms) {
        const std::string plain =
            HX_PlainSubstitution(form, macro, "aZ$n", kind % 3);
        Id id((form + ":" + form).c_str());
        const bool replaced = names.substAllDollarZByValue(
            id, macro, value, static_cast<HxCNames::tagMacroKindEnum>(kind));
        ASSERT_EQ(shown(id), plain) << form;
        ASSERT_EQ(replaced, plain != form);
      }
    }
  }
}

TEST_F(SubstitutionTest, FlagsAndLevelsAreTakenOver) {
  // Template and level, macro, value and level -> names, notes, level.
  const char* const rows[][4] = {
      {"a:$b 0", "m", "v:$N 0", "a:$b : 0"},  // the value's active name counts
      {"a:b 0", "m", "$L$E$N: 0", "a:b LEN: 0"},
      {"a:b 0", "m", "v:w 1", "a:b : 1"},  // only level 1 raises, only level 0
      {"a:b 2", "m", "v:w 1", "a:b : 2"},
      {"a:b 3", "m", "v:w 1", "a:b : 3"},
      {"a:b 0", "m", "v:w 2", "a:b : 0"},
      {"a:b 3", "E", "v:w 0", "a:b : 1"},  // E sets level 1 in any case
      {"$e:b 2", "e", "v:w 0", "v:b E: 1"},
      {"$L:$Lb 2", "L", "v:w 0", "v:wb L:L 2"},
      {"$l:b 2", "l", "v:w 0", "v:b L: 2"},
      {"a:$N 2", "N", "v:w 0", "a:w :N 2"},
      {"$n:b 2", "n", "v:w 1", "v:b N: 2"}};
  const auto at = [](const std::string& text) {
    Id id(text.substr(0, text.size() - 2).c_str());
    id.setCookLevel(static_cast<Id::HxECookLevelTag>(text.back() - '0'));
    return id;
  };
  for (const auto& [form, macro, value, result] : rows) {
    Id id = at(form);
    names.substAllDollarZByValue(id, macro, at(value),
                                 HxCNames::eMacroKindExact);
    const std::string level = " " + std::to_string(id.getCookLevel());
    id.setCookLevel(Id::eCookLevelFull);
    EXPECT_EQ(shown(id) + " " + notedOf(id) + level, result) << form << macro;
  }
}

TEST_F(SubstitutionTest, ReferencesAreTakenOver) {
  const HxCDdSrcRef ddRef(1);
  Id value = identifier("v:w"), id("none");
  value.setDdSourceRef(&ddRef);
  value.setIdentifierChangeable(true, Id::eFormalName);
  for (const Id& by : {value, Id("plain")})
    names.substAllDollarZByValue(id, "m", by, HxCNames::eMacroKindExact);
  EXPECT_EQ(id.getSourceRef(), gain.getSrcRef());
  EXPECT_EQ(id.getDdSourceRef(), &ddRef);
  EXPECT_EQ(notedOf(id), "R:");
}

TEST_F(SubstitutionTest, ANameMayBePutIntoItself) {
  Id id("v:$xL$");
  id.activateActualName();
  names.substAllDollarZByValue(id, "x", id, HxCNames::eMacroKindExact);
  EXPECT_EQ(shown(id), "v:$xL$L$");
  id.setCookLevel(Id::eCookLevelFull);
  EXPECT_EQ(notedOf(id), ":L");
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
  HX_BdBlock ivBlock("iv", gain.getSrcRef());  // counts as no object
  for (const auto& [form, ofModel, hasBlock, result, isComplete] : rows) {
    Id id = identifier(form, hasBlock ? gain.getSrcRef() : nullptr);
    if (!ofModel) id.setSourceIVBlock(&ivBlock);
    EXPECT_EQ(names.handleFileNameMacro(id, ofModel), isComplete) << form;
    EXPECT_EQ(shown(id), result);
  }
}

TEST_F(SubstitutionTest, SymbolMacrosTakeTheSymbol) {
  HX_DataType int16("Int16");
  int16.setCut("i16").setBase();
  HxCSymbol variable("Speed", HxCSymbol::eVariable, &int16);
  variable.setDollarX("ext");
  HxCSymbol function("step", HxCSymbol::eFunction);
  const auto handle = [this](HxCSymbol& symbol) {
    Id id("$x_$X_$v_$V_$t_$T_$f$F:$x$v$f");
    names.handleSymbolNameMacro(id, &symbol);
    EXPECT_EQ(id.getCookLevel(), Id::eCookLevelSymbol);
    return shown(id);
  };
  EXPECT_EQ(handle(variable),
            "ext_ext_Speed_SPEED_i16_i16_$f$F:ext$RSpeed$R$f");
  EXPECT_EQ(handle(function), "__$v_$V___stepSTEP:$R$vstep$R");
}

}  // namespace
