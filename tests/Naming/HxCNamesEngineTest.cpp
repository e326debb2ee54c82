#include <tuple>
#include <utility>

#include "Naming/HX_NamingFixture.h"
#include "support/HX_HeapCount.h"
#include "support/HX_PlainTemplate.h"

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::IsEmpty;
using testing::StartsWith;

class NameEngineTest : public HX_NamingFixture {};

// The scan written plainly for templates over "$", "B", "Q", "(", ")" and
// letters without a meaning; counts the messages.
std::string plainExpansion(const std::string& form, std::size_t& messages) {
  std::string result;
  for (std::size_t at = 0, end; at < form.size(); at = end) {
    end = HX_PlainTokenEnd(form, at);
    const std::string token = form.substr(at, end - at);
    const bool isExtended = token.starts_with("$(");
    if (token[0] != '$' || (isExtended && !token.ends_with(')'))) {
      result += token;
    } else if (token == "$B" || token == "$$") {
      result += token == "$B" ? "Speed_Gain" : "$";
    } else {
      result +=
          isExtended ? "__" + token.substr(2, token.size() - 3) + "_" : token;
      ++messages;
    }
  }
  return result;
}

TEST_F(NameEngineTest, EveryShortTemplateExpandsAsThePlainScanDoes) {
  std::vector<std::string> forms{"x", "$B", "$"};
  for (std::size_t i = 0; i < forms.size() && forms[i].size() < 5; ++i)
    for (char c : {'$', 'B', '(', ')', 'Q', 'x'}) forms.push_back(forms[i] + c);
  for (const std::string& form : forms) {
    SCOPED_TRACE(form);
    clearMessages();
    std::size_t expected = 0;
    const std::string plain = plainExpansion(form, expected);
    ASSERT_EQ(expand(form.c_str(), gain.getSrcRef()), plain);
    ASSERT_EQ(messages().size(), expected);
  }
}

TEST_F(NameEngineTest, MacrosThatMeanNothingHereStayAndAreReported) {
  struct Row {
    std::string form, result, shown;
    bool isKnown;
  };
  std::vector<Row> rows = {{"A$QB", "A$QB", "'$Q'", false},
                           {"a$", "a$", "'$'", false},
                           {"$e", "$e", "'$e'", false},
                           {"$P", "$P", "'$P'", true},
                           {"$V", "$V", "'$V' and '$v'", true},
                           {"$v", "$v", "'$V' and '$v'", true},
                           {"$F", "$F", "'$F' and '$f'", true},
                           {"$f", "$f", "'$F' and '$f'", true},
                           {"$E(a(b)-c)x", "$E_a_b__c_x", "'$E'", true}};
  const auto add = [&rows](const std::string& name, bool isKnown) {
    rows.push_back(
        {"a$(" + name + ")b", "a__" + name + "_b", "$" + name, isKnown});
  };
  for (const auto& name :
       words("Task ISR Msg Ctr Event MsgVar PObj Section Module FunctionName "
             "DataVariantName PageNumber VariantItemName Time Period Offset"))
    add(name, true);
  for (const char* kind : {"Time", "Period", "Offset"})
    for (const auto& unit : words("1us 10us 100us 1ms 10ms 100ms 1s 1m 1h 1d"))
      add(kind + unit, true);
  for (const char* name : {"task", "Foo", "Time2ms", "", "Type ", "$"})
    add(name, false);
  for (const Row& row : rows) {
    clearMessages();
    EXPECT_EQ(expand(row.form.c_str(), gain.getSrcRef()), row.result);
    Id id = identifier(row.form.c_str(), gain.getSrcRef());
    EXPECT_TRUE(names.createNameFromForm(id, nullptr, 0, 0, true));
    EXPECT_THAT(
        messages(),
        ElementsAre((row.isKnown ? "1202/1 The " : "1203/1 The ") + row.shown +
                    " name macro in the " + row.form + " name template is " +
                    (row.isKnown ? "not supported here" : "unknown") +
                    ". It is ignored. [car/Ctrl/Speed Gain]"));
  }
}

TEST_F(NameEngineTest, MacroLettersCountWithAllTheirBits) {
  constexpr unsigned short kLowByteIsB = 0x142;
  const unsigned short units[] = {'$', kLowByteIsB, '$', 0, '$', 'B'};
  Id id(KyCXString(units, 6));
  id.setSourceRef(gain.getSrcRef());
  EXPECT_FALSE(names.substAllDollarZByValue(
      id, KyCXString(units + 4, 1), Id("v:v"), HxCNames::eMacroKindAnyCase));
  expand(id);
  EXPECT_EQ(id.getCookedName(Id::eFormalName),
            KyCXString(units, 4) + "Speed_Gain");
  ASSERT_EQ(messages().size(), 2U);
  EXPECT_THAT(messages()[0], StartsWith("1203/1 The '$?' name macro"));
}

TEST_F(NameEngineTest, ContextFollowsTheReferences) {
  HX_BcPartitionContext partitionContext("p");
  HX_BdPartition partition(&partitionContext);
  HxCIvData ivData(&partition);
  options.setHxSystemID("o");
  const auto expandFor = [this](HX_BdBlock& ivBlock) {
    Id id("$B_$S_$Q");
    id.setSourceIVBlock(&ivBlock);
    return expand(id);
  };
  HX_BdBlock ivBlock("iv block", gain.getSrcRef()), stray("iv-block");

  EXPECT_EQ(expand("$I$S_$B_$C_$O", gain.getSrcRef()), "aSa3_Speed_Gain__C__O");
  EXPECT_EQ(expand("$I", nullptr), "o");
  HxCGlobal::setIvData(&ivData);
  EXPECT_EQ(expand("$I$S", nullptr), "pSp0");
  EXPECT_EQ(expand("$C_$B_$I_$O", mode.getSrcRef()), "Cc4_Mode_c_Mode_chart");
  EXPECT_EQ(expand("$C_$B_$H_$O", event.getStateflowSrcRef()),
            "Cc7_Mode_Top_Run_go_");
  SC_ModelAccess::setChartState(&event, nullptr);
  EXPECT_EQ(expand("$I", event.getStateflowSrcRef()), "a");
  EXPECT_EQ(expandFor(ivBlock), "Speed_Gain_Sa3_$Q");
  EXPECT_THAT(messages().back(), EndsWith("[car/Ctrl/Speed Gain]"));
  EXPECT_EQ(expandFor(stray), "iv_block_Sp0_$Q");
  gain.setNamedThroughParent(true);
  EXPECT_EQ(expand("$B_$S", gain.getSrcRef()), "Ctrl_Sa3");
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
  Id quiet = identifier("", gain.getSrcRef());
  names.createNameFromForm(quiet, nullptr, 0, 0, true);
  EXPECT_EQ(messages().size(), 4U);
}

TEST_F(NameEngineTest, ActualNameFollowsTheFormalOne) {
  const std::tuple<const char*, const char*, bool, bool> rows[] = {
      {"x_$B", "x_Speed_Gain", true, false}, {"a:a$R", "a", true, false},
      {"a:$Ra", "a", true, false},           {"a:a", "a", false, false},
      {"$S:$S", "Sa3", true, true},          {"a:b$R", "b", true, false},
      {"a$R:b", "b", false, true},           {"a:a$R$R", "a", true, false},
  };
  for (const auto& [form, result, actualChanges, formalChanges] : rows) {
    for (bool formalActive : {true, false}) {
      SCOPED_TRACE(form);
      Id id = identifier(form, gain.getSrcRef());
      if (!formalActive) id.activateActualName();
      EXPECT_TRUE(names.createNameFromForm(id, nullptr, 0, 0, false));
      EXPECT_EQ(actual(id), result);
      EXPECT_EQ(id.getIdentifierChangeable(Id::eActualName), actualChanges);
      EXPECT_EQ(id.getIdentifierChangeable(Id::eFormalName), formalChanges);
      EXPECT_EQ(id.isFormalNameActive(), formalActive);
      EXPECT_EQ(id.getCookLevel(), Id::eCookLevelFull);
    }
  }
}

TEST_F(NameEngineTest, UsedFlagsOfTheActualNameComeFromItsOwnScanOrTheText) {
  const std::pair<const char*, bool> rows[] = {{"$L$N", false},
                                               {"$L$N:$L$N$R", false},
                                               {"$L$N:$R$L$N", false},
                                               {"$L$N:$N$L", true}};
  for (const auto& [form, own] : rows) {
    Id id = identifier(form, gain.getSrcRef());
    expand(id);
    EXPECT_TRUE(id.getDollarLUsed(Id::eFormalName));
    EXPECT_TRUE(id.getDollarNUsed(Id::eFormalName));
    EXPECT_EQ(id.getDollarLUsed(Id::eActualName), own) << form;
    EXPECT_EQ(id.getDollarNUsed(Id::eActualName), own) << form;
  }
  Id kept = identifier("$L", gain.getSrcRef());
  expand(kept, nullptr, HxCNames::eMacroLabel);
  EXPECT_TRUE(kept.getDollarLUsed(Id::eActualName));
}

TEST_F(NameEngineTest, OnlyLevelTwoIsLeftAlone) {
  for (int level = 0; level <= 3; ++level) {
    Id id = identifier("$B", gain.getSrcRef());
    id.setCookLevel(static_cast<Id::HxECookLevelTag>(level));
    EXPECT_EQ(expand(id), level == 2 ? "$B" : "Speed_Gain");
    EXPECT_TRUE(complete);
    expand("$M", nullptr, nullptr, 0, HxCNames::eMacroModelName);
    EXPECT_FALSE(complete);  // until the next one
  }
}

TEST_F(NameEngineTest, ANameAsksForMemoryOnceAtMost) {
  gain.getSrcRef();  // made on demand
  HX_CountingController controller;
  for (const char* longPart : {"", "_and_a_text_longer_than_a_name_may_be"}) {
    const std::string form = std::string("$S_$B_$M_$N_$O") + longPart;
    Id id = identifier(form.c_str(), gain.getSrcRef());
    const int before = HX_HeapBlocks();
    names.createNameFromForm(id, nullptr, 0, 0, false);
    const int blocks = HX_HeapBlocks() - before;
    EXPECT_LE(blocks, *longPart == 0 ? 0 : 2) << "for both names";
    EXPECT_EQ(controller.allocated(), 0);
  }
}

}  // namespace
