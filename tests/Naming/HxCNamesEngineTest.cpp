

#include "Naming/HX_NamingFixture.h"
#include "support/HX_HeapCount.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::StartsWith;

class NameEngineTest : public HX_NamingFixture {};

// The scan written plainly for templates over "$", "B", "Q", "(", ")" and
// letters without a meaning; counts the messages.
std::string plainExpansion(const std::string& form, std::size_t& messages) {
  std::string result;
  for (std::size_t i = 0; i < form.size();) {
    if (form[i] != '$') {
      result += form[i++];
      continue;
    }
    const char letter = i + 1 < form.size() ? form[i + 1] : '\0';
    const std::size_t close = form.find(')', i);
    if (letter == '(' && close == std::string::npos)
      return result + form.substr(i);
    if (letter == '(') {
      result += "__" + form.substr(i + 2, close - i - 2) + "_";
      i = close;
    } else if (letter == 'B') {
      result += "Speed_Gain";
    } else {
      result += letter == '$' ? "$" : form.substr(i, 2);
    }
    messages += letter != 'B' && letter != '$';
    i += letter == '(' ? 1 : 2;
  }
  return result;
}

TEST_F(NameEngineTest, EveryShortTemplateExpandsAsThePlainScanDoes) {
  const std::string alphabet = "$B()Qx";
  std::vector<std::string> forms{"x", "$B", "$"};
  for (std::size_t i = 0; i < forms.size() && forms[i].size() < 5; ++i)
    for (char c : alphabet) forms.push_back(forms[i] + c);
  for (const std::string& form : forms) {
    SCOPED_TRACE(form);
    clearMessages();
    std::size_t expected = 0;
    const std::string plain = plainExpansion(form, expected);
    ASSERT_EQ(expand(form.c_str(), gain.getSrcRef()), plain);
    ASSERT_EQ(messages().size(), expected);
  }
}

TEST_F(NameEngineTest, ForeignMacrosStayAndAreReported) {
  struct Row {
    const char* form;
    const char* result;
    const char* message;
  };
  const Row rows[] = {
      {"A$QB", "A$QB", "1203/1 The ''$Q'' name macro in the A$QB"},
      {"a$", "a$", "1203/1 The ''$'' name macro in the a$ "},
      {"$P", "$P", "1202/1 The ''$P'' name"},
      {"$V", "$V", "1202/1 The ''$V' and '$v'' name"},
      {"$v", "$v", "1202/1 The ''$V' and '$v'' name"},
      {"$F", "$F", "1202/1 The ''$F' and '$f'' name"},
      {"$f", "$f", "1202/1 The ''$F' and '$f'' name"},
      {"$E_", "$E_", "1202/1 The ''$E'' name"},
      {"$E(a(b)-c)x", "$E_a_b__c_x", "1202/1 The ''$E'' name"},
      {"$e", "$e", "1203/1 The ''$e'' name"},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.form);
    clearMessages();
    EXPECT_EQ(expand(row.form, gain.getSrcRef()), row.result);
    std::string message = row.message;
    // The macro's text carries its own quotes.
    for (std::size_t at; (at = message.find("''")) != std::string::npos;)
      message.erase(at, 1);
    ASSERT_EQ(messages().size(), 1U);
    EXPECT_THAT(messages()[0], StartsWith(message));
    EXPECT_THAT(messages()[0], testing::EndsWith("[car/Ctrl/Speed Gain]"));
    HxCCIdentifier id = identifier(row.form, gain.getSrcRef());
    EXPECT_TRUE(names.createNameFromForm(id, nullptr, 0, 0, true));
    EXPECT_EQ(messages().size(), 1U);
  }
}

TEST_F(NameEngineTest, MacroLettersCountWithAllTheirBits) {
  constexpr unsigned short kLowByteIsB = 0x142;
  const unsigned short units[] = {'$', kLowByteIsB, '$', 0, '$', 'B'};
  HxCCIdentifier id(KyCXString(units, 6));
  id.setSourceRef(gain.getSrcRef());
  const HxCCIdentifier value("v:v");
  EXPECT_FALSE(names.substAllDollarZByValue(id, KyCXString(units + 4, 1), value,
                                            HxCNames::eMacroKindAnyCase));
  names.createNameFromForm(id, nullptr, 0, 0, false);
  EXPECT_EQ(id.getCookedName(HxCCIdentifier::eFormalName),
            KyCXString(units, 4) + "Speed_Gain");
  ASSERT_EQ(messages().size(), 2U);
  EXPECT_THAT(messages()[0], StartsWith("1203/1 The '$?' name macro"));
}

TEST_F(NameEngineTest, ContextFollowsTheReferences) {
  HX_BdBlock ivBlock("iv block", gain.getSrcRef());
  HX_BcPartitionContext partitionContext("p");
  HX_BdPartition partition(&partitionContext);
  HxCIvData ivData(&partition);
  options.setHxSystemID("o");
  gain.setNamedThroughParent(false);

  EXPECT_EQ(expand("$I$S_$B_$C_$O", gain.getSrcRef()), "aSa3_Speed_Gain__C__O");
  EXPECT_EQ(expand("$I", nullptr), "o");
  HxCGlobal::setIvData(&ivData);
  EXPECT_EQ(expand("$I$S", nullptr), "pSp0");
  EXPECT_EQ(expand("$C_$B_$I_$O", mode.getSrcRef()), "Cc4_Mode_c_Mode_chart");
  EXPECT_EQ(expand("$C_$B_$H_$O", event.getStateflowSrcRef()),
            "Cc7_Mode_Top_Run_go_");
  gain.setNamedThroughParent(true);
  EXPECT_EQ(expand("$B_$S", gain.getSrcRef()), "Ctrl_Sa3");
  gain.setNamedThroughParent(false);
  SC_ModelAccess::setChartState(&event, nullptr);
  EXPECT_EQ(expand("$I", event.getStateflowSrcRef()), "a");

  HxCCIdentifier id("$B_$Q");
  id.setSourceIVBlock(&ivBlock);
  names.createNameFromForm(id, nullptr, 0, 0, false);
  EXPECT_EQ(formal(id), "Speed_Gain_$Q");
  EXPECT_THAT(messages().back(), testing::EndsWith("[car/Ctrl/Speed Gain]"));
  HX_BdBlock strayBlock("iv-block");
  HxCCIdentifier stray("$B_$S");
  stray.setSourceIVBlock(&strayBlock);
  names.createNameFromForm(stray, nullptr, 0, 0, false);
  EXPECT_EQ(formal(stray), "iv_block_Sp0");
}

TEST_F(NameEngineTest, EmptyTemplateTakesTheDefaultOfItsObject) {
  EXPECT_EQ(expand(":$B", gain.getSrcRef()), "Sa3_Speed_Gain");
  EXPECT_THAT(messages(), ElementsAre("503/1 A template name is empty. "
                                      "[car/Ctrl/Speed Gain]"));
  EXPECT_EQ(expand("", event.getStateflowSrcRef()), "Cc7_go_");
  EXPECT_EQ(expand("", mode.getSrcRef()), "Cc4_Mode_chart");
  EXPECT_EQ(messages().size(), 3U);
  EXPECT_EQ(expand("", nullptr), "_S__B");
  EXPECT_THAT(messages().back(), StartsWith("7/3 "));
  HxCCIdentifier quiet("");
  quiet.setSourceRef(gain.getSrcRef());
  names.createNameFromForm(quiet, nullptr, 0, 0, true);
  EXPECT_EQ(messages().size(), 4U);
}

TEST_F(NameEngineTest, ActualNameFollowsTheFormalOne) {
  struct Row {
    const char* form;
    const char* actual;
    bool actualChangeable;
    bool formalChangeable;
  };
  const Row rows[] = {
      {"x_$B", "x_Speed_Gain", true, false}, {"a:a$R", "a", true, false},
      {"a:$Ra", "a", true, false},           {"a:a", "a", false, false},
      {"$S:$S", "Sa3", true, true},          {"a:b$R", "b", true, false},
      {"a$R:b", "b", false, true},           {"a:a$R$R", "a", true, false},
  };
  for (const Row& row : rows) {
    for (bool formalActive : {true, false}) {
      SCOPED_TRACE(row.form);
      HxCCIdentifier id = identifier(row.form, gain.getSrcRef());
      if (!formalActive) id.activateActualName();
      EXPECT_TRUE(names.createNameFromForm(id, nullptr, 0, 0, false));
      EXPECT_EQ(actual(id), row.actual);
      EXPECT_EQ(id.getIdentifierChangeable(HxCCIdentifier::eActualName),
                row.actualChangeable);
      EXPECT_EQ(id.getIdentifierChangeable(HxCCIdentifier::eFormalName),
                row.formalChangeable);
      EXPECT_EQ(id.isFormalNameActive(), formalActive);
      EXPECT_EQ(id.getCookLevel(), HxCCIdentifier::eCookLevelFull);
    }
  }
}

TEST_F(NameEngineTest, UsedFlagsOfTheActualNameComeFromItsOwnScanOrTheText) {
  for (const char* form : {"$L$N", "$L$N:$N$L"}) {
    HxCCIdentifier id = identifier(form, gain.getSrcRef());
    names.createNameFromForm(id, nullptr, 0, 0, false);
    const bool own = std::string(form).find(':') != std::string::npos;
    EXPECT_TRUE(id.getDollarLUsed(HxCCIdentifier::eFormalName));
    EXPECT_TRUE(id.getDollarNUsed(HxCCIdentifier::eFormalName));
    EXPECT_EQ(id.getDollarLUsed(HxCCIdentifier::eActualName), own) << form;
    EXPECT_EQ(id.getDollarNUsed(HxCCIdentifier::eActualName), own) << form;
  }
  HxCCIdentifier kept = identifier("$L", gain.getSrcRef());
  names.createNameFromForm(kept, nullptr, HxCNames::eMacroLabel, 0, false);
  EXPECT_TRUE(kept.getDollarLUsed(HxCCIdentifier::eActualName));
}

TEST_F(NameEngineTest, OnlyLevelTwoIsLeftAlone) {
  for (int level = 0; level <= 3; ++level) {
    HxCCIdentifier id = identifier("$B", gain.getSrcRef());
    id.setCookLevel(static_cast<HxCCIdentifier::HxECookLevelTag>(level));
    EXPECT_TRUE(names.createNameFromForm(id, nullptr, 0, 0, false));
    EXPECT_EQ(formal(id), level == 2 ? "$B" : "Speed_Gain");
  }
  HxCCIdentifier id = identifier("$M", nullptr);
  EXPECT_FALSE(names.createNameFromForm(id, nullptr, 0,
                                        HxCNames::eMacroModelName, false));
  const HxCNames copy(names);
  id.setCookLevel(HxCCIdentifier::eCookLevelFull);
  EXPECT_TRUE(names.createNameFromForm(id, nullptr, 0, 0, false));
}

TEST_F(NameEngineTest, ANameAsksForMemoryOnceAtMost) {
  gain.getSrcRef();  // made on demand
  HX_CountingController controller;
  for (const char* longPart : {"", "_and_a_text_longer_than_a_name_may_be"}) {
    const std::string form = std::string("$S_$B_$M_$N_$O") + longPart;
    HxCCIdentifier id = identifier(form.c_str(), gain.getSrcRef());
    const int before = HX_HeapBlocks();
    names.createNameFromForm(id, nullptr, 0, 0, false);
    const int blocks = HX_HeapBlocks() - before;
    EXPECT_LE(blocks, *longPart == 0 ? 0 : 2) << "for both names";
    EXPECT_EQ(controller.allocated(), 0);
  }
}

}  // namespace
