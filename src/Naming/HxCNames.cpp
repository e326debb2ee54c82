// Engine of name templates: naming context and scan loop.
//
// Problem: expand the formal and the actual template of an identifier, with
// values that hang on the model object of the identifier.
//
// Plain form: derive the context, then copy literal text and put in the value
// of each macro, twice per identifier. The scan is linear in the template.
//
// Idea: most actual templates repeat the formal template ("$S_$B" stands for
// "$S_$B:$S_$B$R"). A repeated template is copied, not expanded again. The
// scan loop finds the evaluator of a macro by the letter, in a table made from
// the macro table at compile time.
//
// Example: "$S_$B:$B", block "Speed Gain" in subsystem a3.
//   formal  "$S" -> "Sa3"   "_" -> "_"   "$B" -> "Speed_Gain"
//   actual  "$B" -> "Speed_Gain"
//
// Invariants:
// 1. The position of the scan stands on literal text or on the '$' of a macro.
// 2. Both results exist before the identifier takes a result: missing memory
//    leaves names, flags, active name and cook level as before.
// 3. Messages name the reference before the context moved to a parent or chart.
//
// The tests in tests/plain compare with the plain form.

#include "Naming/HxCNames.h"

#include <array>
#include <functional>
#include <new>
#include <utility>

#include "Control/ERR_Messages.h"
#include "Control/HX_Memory.h"
#include "Control/HX_SelfCheck.h"
#include "Control/HX_TextCalls.h"
#include "FLAG.h"
#include "Naming/HX_MacroRows.h"
#include "Naming/HxCNamesScan.h"
#include "SourceRef/HxCBlockSrcRef.h"
#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCStateflowSrcRef.h"
#include "platform/datadictionary/HX_DataDictionary.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HX_IvData.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HX_StateflowBlock.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/SC_Chart.h"
#include "platform/model/SC_State.h"

namespace {

constexpr int kLongForm = 40;
constexpr unsigned int kNone = 0;  // no macro retained or provisional

enum class Follows { eNo, eAsIs, eChangeable };

// Whether \p actual is \p formal, with or without "$R" at either end.
Follows followsFormal(const KyCXString& actual, const KyCXString& formal) {
  if (actual == formal) return Follows::eAsIs;
  const int length = formal.length();
  if (actual.length() != length + 2) return Follows::eNo;
  if (actual.startsWith(formal) && actual[length] == '$' &&
      actual[length + 1] == 'R')
    return Follows::eChangeable;
  if (actual.startsWith("$R") && actual.sub(2, length + 1) == formal)
    return Follows::eChangeable;
  return Follows::eNo;
}

// Objects of the model create their references on demand: null means that
// memory ran out.
template <class Ref>
const Ref* created(const Ref* srcRef) {
  if (srcRef == nullptr) throw std::bad_alloc();
  return srcRef;
}

// Adapter from an evaluator to a row: calls \p Evaluate with result, bit sets
// and the items of the scan that the evaluator needs.
template <auto Evaluate, auto... Items, class Scan>
int expandBy(HxCNames& names, Scan& scan) {
  return (names.*Evaluate)(scan.result, scan.retained, scan.provisional,
                           std::invoke(Items, scan)...);
}

}  // namespace

HxCNames::HxCNames() = default;
HxCNames::HxCNames(const HxCNames&) = default;
HxCNames& HxCNames::operator=(const HxCNames&) = default;
HxCNames::~HxCNames() = default;

// Flags and active name of an identifier, put back unless kept.
class HxCNames::Restore {
 public:
  explicit Restore(HxCCIdentifier& id)
      : m_Id(id),
        m_Formal(id.m_Formal.flags),
        m_Actual(id.m_Actual.flags),
        m_FormalWasActive(id.m_FormalNameActive) {}
  Restore(const Restore&) = delete;
  Restore& operator=(const Restore&) = delete;
  ~Restore() {
    m_Id.m_FormalNameActive = m_FormalWasActive;
    if (m_KeepFlags) return;
    m_Id.m_Formal.flags = m_Formal;
    m_Id.m_Actual.flags = m_Actual;
  }

  void keepFlags() { m_KeepFlags = true; }

 private:
  HxCCIdentifier& m_Id;
  HxCCIdentifier::Flags m_Formal;
  HxCCIdentifier::Flags m_Actual;
  bool m_FormalWasActive;
  bool m_KeepFlags = false;
};

bool HxCNames::createNameFromForm(HxCCIdentifier& id, HX_DataType* type,
                                  unsigned int retainedMacros,
                                  unsigned int provisionalMacros,
                                  bool suppressMessages) {
  m_NameComplete = true;
  if (id.m_CookLevel == HxCCIdentifier::eCookLevelFull) return m_NameComplete;
  const bool isDone = HX_WithinMemory([&] {
    createBothNamesFromForm(id, type, retainedMacros, provisionalMacros,
                            suppressMessages);
  });
  if (!isDone) m_NameComplete = false;
  return m_NameComplete;
}

void HxCNames::createBothNamesFromForm(HxCCIdentifier& id, HX_DataType* type,
                                       unsigned int retainedMacros,
                                       unsigned int provisionalMacros,
                                       bool suppressMessages) {
  Restore restore(id);
  HxCCIdentifier::Name& actual = id.m_Actual;
  HxCCIdentifier::Name& formal = id.m_Formal;
  const Follows follows = followsFormal(actual.cooked, formal.cooked);
  id.activateFormalName();
  KyCXString text = expandActiveName(id, type, retainedMacros,
                                     provisionalMacros, suppressMessages);
  if (follows == Follows::eNo) {
    id.activateActualName();
    createSingleNameFromForm(id, type, retainedMacros, provisionalMacros,
                             suppressMessages);
    formal.cooked = std::move(text);
  } else {
    actual.cooked = text;  // without memory the text stays as before
    formal.cooked = std::move(text);
    actual.flags.changeable =
        formal.flags.changeable || follows == Follows::eChangeable;
    // At the level before the expansion: below the threshold of a getter the
    // expanded text answers.
    actual.flags.dollarLUsed = id.getDollarLUsed(kActive);
    actual.flags.dollarEUsed = id.getDollarEUsed(kActive);
    actual.flags.dollarNUsed = id.getDollarNUsed(kActive);
  }
  restore.keepFlags();
  id.setCookLevel(HxCCIdentifier::eCookLevelFull);
}

void HxCNames::createSingleNameFromForm(HxCCIdentifier& id, HX_DataType* type,
                                        unsigned int retainedMacros,
                                        unsigned int provisionalMacros,
                                        bool suppressMessages) {
  KyCXString text = expandActiveName(id, type, retainedMacros,
                                     provisionalMacros, suppressMessages);
  id.name(kActive).cooked = std::move(text);
}

// Expands the template of the active name, which stays; flags are set.
KyCXString HxCNames::expandActiveName(HxCCIdentifier& id, HX_DataType* type,
                                      unsigned int retainedMacros,
                                      unsigned int provisionalMacros,
                                      bool suppressMessages) {
  Scan scan{.pId = &id,
            .type = type,
            .retained = retainedMacros,
            .provisional = provisionalMacros,
            .suppressMessages = suppressMessages};
  deriveContext(scan);
  scan.pForm = &id.name(kActive).cooked;
  if (scan.pForm->isEmpty()) {
    scan.standIn = standInForm(scan);
    scan.pForm = &scan.standIn;
  }
  scanTemplate(scan);
  if (scan.changeable) id.setIdentifierChangeable(true, kActive);
  return std::move(scan.result);
}

void HxCNames::deriveContext(Scan& scan) {
  scan.ivBlock = scan.pId->m_pSourceIVBlock;
  scan.srcRef = scan.pId->m_pSourceRef;
  if (scan.srcRef == nullptr && scan.ivBlock != nullptr)
    scan.srcRef = scan.ivBlock->getSrcRef();
  scan.reportRef = scan.srcRef;
  if (scan.srcRef != nullptr) {
    enterBlock(scan);
    enterStateflowObject(scan);
  }
  if (!scan.hasSystemId) getRootDollarI(scan.systemId);
  const HxCSrcRef* ddRef = scan.pId->m_pDdSourceRef;
  if (ddRef != nullptr && ddRef->isDd() != nullptr)
    HX_DataDictionary::getObjectName(ddRef->isDd()->getDdHandle(), scan.ddName);
}

// From a block reference to the block that names the object, then to the chart
// of the block.
void HxCNames::enterBlock(Scan& scan) {
  const HxCBlockSrcRef* blockRef = scan.srcRef->isBlock();
  if (blockRef == nullptr || blockRef->getBlock() == nullptr) return;
  if (blockRef->getBlock()->isNamedThroughParent() != nullptr) {
    scan.srcRef = created(blockRef->getBlock()->getParent()->getSrcRef());
    blockRef = scan.srcRef->isBlock();
  }
  scan.block = blockRef->getBlock();
  scan.setSystemId(*scan.block->getSubsystemId());
  HX_StateflowBlock* chartBlock = scan.block->isStateflowBlock();
  if (chartBlock != nullptr && chartBlock->getChartState() != nullptr)
    scan.srcRef = created(chartBlock->getChartState()->getStateflowSrcRef());
}

void HxCNames::enterStateflowObject(Scan& scan) {
  const HxCStateflowSrcRef* sfRef = scan.srcRef->isStateflow();
  if (sfRef == nullptr || sfRef->getSfObject() == nullptr) return;
  scan.sfObject = sfRef->getSfObject();
  scan.block = scan.sfObject->getContainingBlock();
  const SC_State* chartState = SC_ModelAccess::getChartState(scan.sfObject);
  if (chartState != nullptr)
    scan.setSystemId(chartState->getChart()->getSubsystemId());
  else if (scan.block != nullptr)
    scan.setSystemId(*scan.block->getSubsystemId());
}

void HxCNames::getRootDollarI(KyCXString& systemId) {
  if (const HxCIvData* ivData = HxCGlobal::getIvData()) {
    if (const HX_BdPartition* root = ivData->getIvHxRootPartition()) {
      if (const auto* context = root->getPartitionContext())
        systemId = context->getSubsystemIdentifier();
    }
  }
  if (systemId.isEmpty() && HxCGlobal::getOptions() != nullptr)
    systemId = HxCGlobal::getOptions()->getHxSystemID();
}

// Replacement of an empty template.
KyCXString HxCNames::standInForm(const Scan& scan) {
  if (HX_Assert(scan.reportRef != nullptr, kNamesErrorCode) &&
      !scan.suppressMessages)
    ERR_Msg503(scan.reportRef);
  const bool forStateflow =
      scan.srcRef != nullptr && scan.srcRef->isStateflow() != nullptr;
  return forStateflow ? "$C_$O" : "$S_$B";
}

void HxCNames::scanTemplate(Scan& scan) {
  const KyCXString& form = scan.form();
  // A template too long for a text object makes a name too long for it.
  if (form.length() >= kLongForm) HX_Reserve(scan.result, 2 * form.length());
  while (scan.pos < form.length()) {
    const unsigned short unit = form[scan.pos];
    if (unit != '$') {
      // Text between macros is short: unit by unit is the fastest way.
      HX_AppendUnit(scan.result, form, scan.pos);
      ++scan.pos;
      continue;
    }
    const unsigned short letter = form[scan.pos + 1];
    const MacroRow* row = findMacro(letter);
    if (row == nullptr) {
      keepForeignMacro(scan, letter);
      continue;
    }
    scan.pos += row->expand(*this, scan);
    if (row->noteUse != nullptr) (scan.id().*row->noteUse)(true, kActive);
  }
}

// The letters are different: their order has no meaning.
const HxCNames::MacroRow* HxCNames::findMacro(unsigned short letter) {
  using Self = HxCNames;
  static constexpr MacroRow kRows[] = {
      {HX_MacroOf("$L").text,
       &expandBy<&Self::evaluateLabelMacro, &Scan::label, &Scan::block>,
       &HxCCIdentifier::setDollarLUsed},
      {HX_MacroOf("$B").text,
       &expandBy<&Self::evaluateBlockNameMacro, &Scan::block, &Scan::ivBlock>},
      {HX_MacroOf("$S").text,
       &expandBy<&Self::evaluateSystemNumberMacro, &Scan::block,
                 &Scan::systemId, &Scan::changeable>},
      {HX_MacroOf("$I").text,
       &expandBy<&Self::evaluateSystemIDMacro, &Scan::systemId>},
      {HX_MacroOf("$M").text, &expandBy<&Self::evaluateModelNameMacro>},
      {HX_MacroOf("$N").text, &expandBy<&Self::evaluateSubsystemNameMacro>,
       &HxCCIdentifier::setDollarNUsed},
      {HX_MacroOf("$H").text,
       &expandBy<&Self::evaluateStateHierarchyMacro, &Scan::sfObject>},
      {HX_MacroOf("$O").text,
       &expandBy<&Self::evaluateSFObjectNameMacro, &Scan::sfObject>},
      {HX_MacroOf("$C").text,
       &expandBy<&Self::evaluateSFObjectIDMacro, &Scan::sfObject,
                 &Scan::systemId, &Scan::changeable>},
      {HX_MacroOf("$D").text, &Self::expandDollarD},
      {HX_MacroOf("$X").text,
       &expandBy<&Self::evaluateXNameMacro, &Scan::xValue>},
      {HX_MacroOf("$T").text,
       &expandBy<&Self::evaluateTypeNameMacro, &Scan::type>},
      {HX_MacroOf("$$").text, &Self::expandDollar},
      {HX_MacroOf("$R").text,
       &expandBy<&Self::evaluateSFObjectRMacro, &Scan::changeable>},
      {"$(",  // all extended macros
       &expandBy<&Self::evaluateExtendedNameMacro, &Scan::form, &Scan::pos,
                 &Scan::id, &Scan::type, &Scan::srcRef, &Scan::reportRef,
                 &Scan::suppressMessages>},
  };
  static constexpr int kCodes = 128;
  // Letter -> position in kRows, from 1; 0: no row. Not pointers, because the
  // sanitizers of g++ do not compare pointers at compile time.
  static constexpr auto kRowOfLetter = [] {
    std::array<std::uint8_t, kCodes> rows{};
    std::uint8_t position = 0;
    for (const MacroRow& row : kRows)
      rows[static_cast<unsigned char>(row.text[1])] = ++position;
    return rows;
  }();
  static_assert(
      [] {
        for (const HX_Macro& macro : hx_macros::kLetters)
          if ((kRowOfLetter[static_cast<unsigned char>(macro.text[1])] != 0) !=
              (macro.stage == hx_macros::kTemplate))
            return false;
        return true;
      }(),
      "the rows are the letters of the template stage");
  if (letter >= kCodes || kRowOfLetter[letter] == 0) return nullptr;
  return &kRows[kRowOfLetter[letter] - 1];
}

// $$
int HxCNames::expandDollar(HxCNames&, Scan& scan) {
  scan.result += '$';
  return 2;
}

// $D: the data dictionary object, else the identification of the Stateflow
// object or block. A retained or provisional $D is not looked up.
int HxCNames::expandDollarD(HxCNames& names, Scan& scan) {
  constexpr const HX_Macro& kMacro = HX_MacroOf("$D");
  unsigned int provisional = scan.provisional;
  unsigned int retained = scan.retained;
  if (FLAG_GetFlag(&provisional, kMacro.bit)) {
    scan.result += kMacro.placeholder;
    names.m_NameComplete = false;
  } else if (FLAG_GetFlag(&retained, kMacro.bit)) {
    scan.result += kMacro.text;
    names.m_NameComplete = false;
  } else if (scan.pId->m_pDdSourceRef != nullptr) {
    return names.evaluateDdObjectNameMacro(scan.result, retained, provisional,
                                           scan.ddName);
  } else if (scan.sfObject != nullptr) {
    scan.result += "DD_";
    names.evaluateSFObjectIDMacro(scan.result, kNone, kNone, scan.sfObject,
                                  scan.systemId, scan.changeable);
    scan.result += "_";
    names.evaluateSFObjectNameMacro(scan.result, kNone, kNone, scan.sfObject);
  } else if (scan.block != nullptr) {
    scan.result += "DD_";
    names.evaluateSystemNumberMacro(scan.result, kNone, kNone, scan.block,
                                    scan.systemId, scan.changeable);
    scan.result += "_";
    names.evaluateBlockNameMacro(scan.result, kNone, kNone, scan.block,
                                 scan.ivBlock);
  } else {
    scan.result += kMacro.placeholder;
  }
  return 2;
}

// A macro of no row stays in the name and is reported.
void HxCNames::keepForeignMacro(Scan& scan, unsigned short letter) {
  const KyCXString& form = scan.form();
  const KyCXString macro = form.sub(scan.pos, scan.pos + 1);
  scan.result += macro;
  scan.pos += 2;
  if (letter == 'E' && form[scan.pos] == '(') {
    const int length = findDollarELength(form, scan.pos);
    KyCXString argument = form.sub(scan.pos, scan.pos + length - 1);
    argument.makeCIdentifier(false);
    scan.result += argument;
    scan.pos += length;
  }
  if (!scan.suppressMessages) reportForeignMacro(scan, macro);
}

// Where both cases of the letter are known, the message names both: "'$V' and
// '$v'".
void HxCNames::reportForeignMacro(Scan& scan, const KyCXString& macro) {
  const auto isKnown = [](const KyCXString& text) {
    const HX_Macro* row = HX_FindMacro(text);
    return row != nullptr && row->message == 1202;
  };
  const KyCXString& raw = scan.pId->getRawName(kActive);
  KyCXString shown = "'" + macro + "'";
  if (!isKnown(macro)) {
    ERR_Msg1203(scan.reportRef, shown.cstring(), raw.cstring());
    return;
  }
  KyCXString upper(macro);
  KyCXString lower(macro);
  upper.toUpper();
  lower.toLower();
  if (isKnown(upper) && isKnown(lower))
    shown = "'" + upper + "' and '" + lower + "'";
  ERR_Msg1202(scan.reportRef, shown.cstring(), raw.cstring());
}
