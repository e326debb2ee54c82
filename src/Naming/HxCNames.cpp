// The engine: from an identifier to its naming context, and the scan loop.

#include "Naming/HxCNames.h"

#include <array>
#include <utility>

#include "Control/ERR_Messages.h"
#include "Control/HX_SelfCheck.h"
#include "FLAG.h"
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

constexpr char kErrorCode[] = __FILE__ "_";

constexpr int kLongForm = 40;
constexpr unsigned int kNone = 0;  // of the macros is retained

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

}  // namespace

HxCNames::~HxCNames() = default;

bool HxCNames::createNameFromForm(HxCCIdentifier& id, HX_DataType* type,
                                  unsigned int retainedMacros,
                                  unsigned int provisionalMacros,
                                  bool suppressMessages) {
  constexpr auto kActual = HxCCIdentifier::eActualName;
  m_NameComplete = true;
  if (id.getCookLevel() == HxCCIdentifier::eCookLevelFull)
    return m_NameComplete;

  const bool formalWasActive = id.isFormalNameActive();
  const Follows follows = followsFormal(
      id.getCookedName(kActual), id.getCookedName(HxCCIdentifier::eFormalName));
  id.activateFormalName();
  createSingleNameFromForm(id, type, retainedMacros, provisionalMacros,
                           suppressMessages);
  if (follows == Follows::eNo) {
    id.activateActualName();
    createSingleNameFromForm(id, type, retainedMacros, provisionalMacros,
                             suppressMessages);
  } else {
    id.setCookedName(id.getCookedName(kActive), kActual);
    id.setIdentifierChangeable(
        id.getIdentifierChangeable(kActive) || follows == Follows::eChangeable,
        kActual);
    // The level is not raised yet, so that below it the getters answer from
    // the expanded text.
    id.setDollarLUsed(id.getDollarLUsed(kActive), kActual);
    id.setDollarEUsed(id.getDollarEUsed(kActive), kActual);
    id.setDollarNUsed(id.getDollarNUsed(kActive), kActual);
  }
  if (formalWasActive)
    id.activateFormalName();
  else
    id.activateActualName();
  id.setCookLevel(HxCCIdentifier::eCookLevelFull);
  return m_NameComplete;
}

// Expands the active name.
void HxCNames::createSingleNameFromForm(HxCCIdentifier& id, HX_DataType* type,
                                        unsigned int retainedMacros,
                                        unsigned int provisionalMacros,
                                        bool suppressMessages) {
  Context context;
  deriveContext(id, context);
  const KyCXString& cooked = id.getCookedName(kActive);
  const KyCXString standIn =
      cooked.isEmpty() ? standInForm(context, suppressMessages) : KyCXString();
  const KyCXString& form = cooked.isEmpty() ? standIn : cooked;
  Scan scan{
      *this,   id,   type, retainedMacros, provisionalMacros, suppressMessages,
      context, form, {}};
  scanTemplate(scan);
  id.setCookedName(std::move(scan.result), kActive);
  if (context.changeable) id.setIdentifierChangeable(true, kActive);
}

void HxCNames::deriveContext(HxCCIdentifier& id, Context& context) {
  context.ivBlock = id.getSourceIVBlock();
  context.srcRef = id.getSourceRef();
  if (context.srcRef == nullptr && context.ivBlock != nullptr)
    context.srcRef = context.ivBlock->getSrcRef();
  context.reportRef = context.srcRef;
  if (context.srcRef != nullptr) {
    enterBlock(context);
    enterStateflowObject(context);
  }
  if (!context.hasSystemId) getRootDollarI(context.systemId);
  const HxCSrcRef* ddRef = id.getDdSourceRef();
  if (ddRef != nullptr && ddRef->isDd() != nullptr)
    HX_DataDictionary::getObjectName(ddRef->isDd()->getDdHandle(),
                                     context.ddName);
}

// From a block reference to the block that the name is for, and on to the
// chart that it holds.
void HxCNames::enterBlock(Context& context) {
  const HxCBlockSrcRef* blockRef = context.srcRef->isBlock();
  if (blockRef == nullptr || blockRef->getBlock() == nullptr) return;
  if (blockRef->getBlock()->isNamedThroughParent() != nullptr) {
    context.srcRef = blockRef->getBlock()->getParent()->getSrcRef();
    blockRef = context.srcRef->isBlock();
  }
  context.block = blockRef->getBlock();
  context.setSystemId(*context.block->getSubsystemId());
  HX_StateflowBlock* chartBlock = context.block->isStateflowBlock();
  if (chartBlock != nullptr && chartBlock->getChartState() != nullptr)
    context.srcRef = chartBlock->getChartState()->getStateflowSrcRef();
}

void HxCNames::enterStateflowObject(Context& context) {
  const HxCStateflowSrcRef* sfRef = context.srcRef->isStateflow();
  if (sfRef == nullptr || sfRef->getSfObject() == nullptr) return;
  context.sfObject = sfRef->getSfObject();
  context.block = context.sfObject->getContainingBlock();
  const SC_State* chartState = SC_ModelAccess::getChartState(context.sfObject);
  if (chartState != nullptr)
    context.setSystemId(chartState->getChart()->getSubsystemId());
  else if (context.block != nullptr)
    context.setSystemId(*context.block->getSubsystemId());
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

// What stands in for an empty template.
KyCXString HxCNames::standInForm(const Context& context,
                                 bool suppressMessages) {
  if (HX_Assert(context.reportRef != nullptr, kErrorCode) && !suppressMessages)
    ERR_Msg503(context.reportRef);
  const bool forStateflow =
      context.srcRef != nullptr && context.srcRef->isStateflow() != nullptr;
  return forStateflow ? "$C_$O" : "$S_$B";
}

void HxCNames::scanTemplate(Scan& scan) {
  const KyCXString& form = scan.form;
  // Where the template does not fit into a text object, neither will the name.
  if (form.length() >= kLongForm) scan.result.reserve(2 * form.length());
  while (scan.pos < form.length()) {
    const unsigned short unit = form[scan.pos];
    if (unit != '$') {
      // Text between macros is short: unit by unit is the fastest way.
      scan.result.appendUnit(unit);
      ++scan.pos;
      continue;
    }
    const unsigned short letter = form[scan.pos + 1];
    if (const MacroRow* row = findMacro(letter))
      scan.pos += row->expand(scan);
    else
      keepForeignMacro(scan, letter);
  }
}

// In the order of the list of macros; no letter stands twice.
// NOLINTNEXTLINE(readability-function-size): a table, not a course of steps
const HxCNames::MacroRow* HxCNames::findMacro(unsigned short letter) {
  static constexpr MacroRow kRows[] = {
      {'L',
       [](Scan& s) {
         const int length =
             s.names.evaluateLabelMacro(s.result, s.retained, s.provisional,
                                        s.id.getSignalLabel(), s.context.block);
         s.id.setDollarLUsed(true, kActive);
         return length;
       }},
      {'B',
       [](Scan& s) {
         return s.names.evaluateBlockNameMacro(s.result, s.retained,
                                               s.provisional, s.context.block,
                                               s.context.ivBlock);
       }},
      {'S',
       [](Scan& s) {
         return s.names.evaluateSystemNumberMacro(
             s.result, s.retained, s.provisional, s.context.block,
             s.context.systemId, s.context.changeable);
       }},
      {'I',
       [](Scan& s) {
         return s.names.evaluateSystemIDMacro(
             s.result, s.retained, s.provisional, s.context.systemId);
       }},
      {'M',
       [](Scan& s) {
         return s.names.evaluateModelNameMacro(s.result, s.retained,
                                               s.provisional);
       }},
      {'N',
       [](Scan& s) {
         const int length = s.names.evaluateSubsystemNameMacro(
             s.result, s.retained, s.provisional);
         s.id.setDollarNUsed(true, kActive);
         return length;
       }},
      {'H',
       [](Scan& s) {
         return s.names.evaluateStateHierarchyMacro(
             s.result, s.retained, s.provisional, s.context.sfObject);
       }},
      {'O',
       [](Scan& s) {
         return s.names.evaluateSFObjectNameMacro(
             s.result, s.retained, s.provisional, s.context.sfObject);
       }},
      {'C',
       [](Scan& s) {
         return s.names.evaluateSFObjectIDMacro(
             s.result, s.retained, s.provisional, s.context.sfObject,
             s.context.systemId, s.context.changeable);
       }},
      {'D', [](Scan& s) { return s.names.expandDollarD(s); }},
      {'X',
       [](Scan& s) {
         KyCXString value;
         s.id.getDollarXValue(value);
         return s.names.evaluateXNameMacro(s.result, s.retained, s.provisional,
                                           value);
       }},
      {'T',
       [](Scan& s) {
         return s.names.evaluateTypeNameMacro(s.result, s.retained,
                                              s.provisional, s.type);
       }},
      {'$',
       [](Scan& s) {
         s.result += '$';
         return 2;
       }},
      {'R',
       [](Scan& s) {
         return s.names.evaluateSFObjectRMacro(
             s.result, s.retained, s.provisional, s.context.changeable);
       }},
      {'(',
       [](Scan& s) {
         return s.names.evaluateExtendedNameMacro(
             s.result, s.retained, s.provisional, s.form, s.pos, s.id, s.type,
             s.context.srcRef, s.context.reportRef, s.suppressMessages);
       }},
  };
  static constexpr int kLetters = 128;
  static constexpr auto kRowOfLetter = [] {
    std::array<const MacroRow*, kLetters> rows{};
    for (const MacroRow& row : kRows)
      rows[static_cast<unsigned char>(row.letter)] = &row;
    return rows;
  }();
  return letter < kLetters ? kRowOfLetter[letter] : nullptr;
}

// $D: the data dictionary object, or else what identifies the Stateflow object
// or the block. A retained or provisional $D is not looked up.
int HxCNames::expandDollarD(Scan& scan) {
  Context& context = scan.context;
  unsigned int provisional = scan.provisional;
  unsigned int retained = scan.retained;
  if (FLAG_GetFlag(&provisional, eMacroDdObjectName)) {
    scan.result += "_D";
    m_NameComplete = false;
  } else if (FLAG_GetFlag(&retained, eMacroDdObjectName)) {
    scan.result += "$D";
    m_NameComplete = false;
  } else if (scan.id.getDdSourceRef() != nullptr) {
    return evaluateDdObjectNameMacro(scan.result, retained, provisional,
                                     context.ddName);
  } else if (context.sfObject != nullptr) {
    scan.result += "DD_";
    evaluateSFObjectIDMacro(scan.result, kNone, kNone, context.sfObject,
                            context.systemId, context.changeable);
    scan.result += "_";
    evaluateSFObjectNameMacro(scan.result, kNone, kNone, context.sfObject);
  } else if (context.block != nullptr) {
    scan.result += "DD_";
    evaluateSystemNumberMacro(scan.result, kNone, kNone, context.block,
                              context.systemId, context.changeable);
    scan.result += "_";
    evaluateBlockNameMacro(scan.result, kNone, kNone, context.block,
                           context.ivBlock);
  } else {
    scan.result += "_D";
  }
  return 2;
}

// A macro that is not expanded here stays in the name, and is reported.
void HxCNames::keepForeignMacro(Scan& scan, unsigned short letter) {
  struct ForeignRow {
    char letter;
    const char* shown;
  };
  static constexpr ForeignRow kForeign[] = {
      {'P', "'$P'"},          {'V', "'$V' and '$v'"}, {'v', "'$V' and '$v'"},
      {'F', "'$F' and '$f'"}, {'f', "'$F' and '$f'"}, {'E', "'$E'"}};

  scan.result.appendSub(scan.form, scan.pos, scan.pos + 1);
  const KyCXString macro = scan.form.sub(scan.pos, scan.pos + 1);
  scan.pos += 2;
  if (letter == 'E' && scan.form[scan.pos] == '(') {
    const int length = findDollarELength(scan.form, scan.pos);
    KyCXString argument = scan.form.sub(scan.pos, scan.pos + length - 1);
    scan.result += argument.makeCIdentifier(false);
    scan.pos += length;
  }
  if (scan.suppressMessages) return;
  const char* form = scan.id.getRawName(kActive).cstring();
  for (const ForeignRow& row : kForeign) {
    if (row.letter != letter) continue;
    ERR_Msg1202(scan.context.reportRef, row.shown, form);
    return;
  }
  const KyCXString shown = "'" + macro + "'";
  ERR_Msg1203(scan.context.reportRef, shown.cstring(), form);
}
