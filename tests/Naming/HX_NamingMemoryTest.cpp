// Names while memory runs out: all or nothing.
#include "Naming/HX_NamingFixture.h"
#include "platform/model/HxCSymbol.h"
#include "support/HX_HeapCount.h"

namespace {

using Id = HxCCIdentifier;

const char* const kLong = "a_rather_long_text_that_needs_memory_of_its_own";

// One operation, the identifier before, and the identifier after success.
struct Step {
  const char* why;
  void (*change)(Id& id);
  Id before;
  Id after;
};

Step* s_step = nullptr;
const KyCXString* s_text = nullptr;
const Id* s_other = nullptr;
bool s_isHalf = false;

// Asks for no memory.
bool isSame(Id& a, Id& b) {
  for (const auto type : {Id::eFormalName, Id::eActualName}) {
    if (!(a.getRawName(type) == b.getRawName(type)) ||
        !(a.getCookedName(type) == b.getCookedName(type)) ||
        a.getIdentifierChangeable(type) != b.getIdentifierChangeable(type) ||
        a.getDollarLUsed(type) != b.getDollarLUsed(type) ||
        a.getDollarEUsed(type) != b.getDollarEUsed(type) ||
        a.getDollarNUsed(type) != b.getDollarNUsed(type))
      return false;
  }
  return a.getCookLevel() == b.getCookLevel() &&
         a.isFormalNameActive() == b.isFormalNameActive() &&
         a.getSignalLabel() == b.getSignalLabel() &&
         a.getSourceRef() == b.getSourceRef();
}

bool isWhole() {
  Id id(s_step->before);
  Id none;
  if (!isSame(id, s_step->before)) {
    s_isHalf |= !isSame(id, none);
    return false;
  }
  s_step->change(id);
  if (isSame(id, s_step->after)) return true;
  s_isHalf |= !isSame(id, s_step->before);
  return false;
}

class NamingMemoryTest : public HX_NamingFixture {};

TEST_F(NamingMemoryTest, AnIdentifierChangesAsAWholeOrNotAtAll) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  const unsigned short units[] = {0x4F60, 0x597D};
  const KyCXString wide(units, 2);
  const KyCXString text(kLong);
  s_text = &text;
  const Id other(kLong);
  s_other = &other;
  options.setLimitVariableNameLength(true);
  const std::pair<const char*, void (*)(Id&)> operations[] = {
      {"setName", [](Id& id) { id.setName(*s_text); }},
      {"assign a name", [](Id& id) { id = *s_text; }},
      {"assign a text", [](Id& id) { id = kLong; }},
      {"assign", [](Id& id) { id = *s_other; }},
      {"setCookedName",
       [](Id& id) { id.setCookedName(*s_text, Id::eActiveName); }},
      {"addPrefix", [](Id& id) { id.addPrefix(*s_text); }},
      {"addPostfix", [](Id& id) { id.addPostfix(*s_text); }},
      {"append", [](Id& id) { id += kLong; }},
      {"makeCIdentifier", [](Id& id) { id.makeCIdentifier(); }},
      {"adaptSize", [](Id& id) { id.adaptSize(); }},
      {"setSignalLabel", [](Id& id) { id.setSignalLabel(*s_text); }},
      {"expand",
       [](Id& id) { HxCNames().createNameFromForm(id, nullptr, 0, 0, true); }},
      {"file name", [](Id& id) { HxCNames().handleFileNameMacro(id, true); }},
      {"substitute", [](Id& id) {
         Id value(s_step->before);
         if (!isSame(value, s_step->before)) return;
         value.setCookLevel(Id::eCookLevelDollarE);
         value.setDollarNUsed(true, Id::eActiveName);
         value.setSourceRef(nullptr);
         HxCNames().substAllDollarZByValue(id, "N", value,
                                           HxCNames::eMacroKindExact);
       }}};
  const std::string longForm = std::string("$L$N$R_$B_") + kLong;
  for (const std::string& form : {longForm + ":$N$S_" + kLong, longForm}) {
    Id before = identifier(form);
    before.activateActualName();
    before.setSignalLabel(wide);
    before.setIdentifierChangeable(true, Id::eActualName);
    for (const auto& [why, change] : operations) {
      Step step{why, change, before, before};
      s_step = &step;
      change(step.after);
      s_isHalf = false;
      HX_WithoutEachHeapBlock(why, isWhole);
      EXPECT_FALSE(s_isHalf) << why << " of " << form;
    }
  }
}

TEST_F(NamingMemoryTest, WithoutAControllerBlockNothingIsMadeOrExpanded) {
  Id id = identifier("$O", mode.getSrcRef());
  HX_CountingController controller;
  controller.fail();
  EXPECT_EQ(new HxCNames, nullptr);
  EXPECT_EQ(new Id("x"), nullptr);
  // The chart cannot make a reference to itself.
  EXPECT_FALSE(names.createNameFromForm(id, nullptr, 0, 0, false));
  EXPECT_EQ(shown(id), "$O:$O$R");
  EXPECT_EQ(id.getCookLevel(), Id::eCookLevelRaw);
  EXPECT_TRUE(id.isFormalNameActive());
}

TEST_F(NamingMemoryTest, SeveralMacrosAreReplacedOneByOne) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  static HxCSymbol symbol(kLong, HxCSymbol::eFunction);
  symbol.setDollarX(kLong);
  HX_WithoutEachHeapBlock("several macros", [] {
    Id id("$x$f$(Task)$(Msg)$(MsgVar)$(Time)$(Period1ms)");
    HxCNames engine;
    engine.replaceMultirateTimeName(id, 0.01, 0, true);
    engine.replaceMultirateTaskISRName(id, Id(kLong), Id("isr"), false);
    engine.replaceMultirateMsgName(id, Id("msg"));
    engine.replaceMultirateMsgVarName(id, "#a#b;");
    engine.handleSymbolNameMacro(id, &symbol);
    KyCXString name;
    engine.appendSuffix(name, 0);
    return !id.getCookedName(Id::eFormalName).contains("$") && name == "_a" &&
           !id.getCookedName(Id::eFormalName).isEmpty() &&
           id.getCookLevel() == Id::eCookLevelSymbol;
  });
}

TEST_F(NamingMemoryTest, ADictionaryIsReplacedAsAWhole) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  static bool isLost = false;
  HX_WithoutEachHeapBlock("dictionary", [] {
    const KyCXString word("word");
    HxCNames::boot();
    const bool isBooted =
        HxCNames::checkCVariableName("int") == HxCNames::eVariableNameCKeyword;
    if (isBooted)
      HxCNames().addToKeywordDict(word, HxCNames::eDictUserTypeName);
    const bool isEntered =
        HxCNames::checkCVariableName(word) == HxCNames::eVariableNameUserType;
    HxCNames::boot();
    const bool isFresh =
        HxCNames::checkCVariableName(word) == HxCNames::eVariableNameValid;
    isLost |= isBooted && HxCNames::checkCVariableName("int") !=
                              HxCNames::eVariableNameCKeyword;
    HxCNames::shutdown();
    return isBooted && isEntered && isFresh;
  });
  EXPECT_FALSE(isLost);
}

}  // namespace
