#include "host/names/HX_NameForming.h"

#include "Trace/HxCTransformationTracer.h"
#include "host/base/HX_Text.h"
#include "host/names/HX_FormingOrder.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HxCGlobal.h"

namespace {

void remark(HX_FormedName& name, HX_Finding::HxESeverityTag severity,
            const std::string& text) {
  name.findings.push_back({0, severity, text, name.sourcePath()});
}

int countOf(char character, const KyCXString& text) {
  int count = 0;
  for (int at = text.find(character); at >= 0;
       at = text.find(character, at + 1))
    ++count;
  return count;
}

// An identifier without the "$R" that a template would get: "$R" would become
// part of the C identifier.
HxCCIdentifier finalName(const KyCXString& text) {
  HxCCIdentifier id(text);
  id.setCookedName(text, HxCCIdentifier::eActualName);
  return id;
}

struct OsTextRow {
  std::optional<KyCXString> HX_WantedName::OsTexts::*text;
  void (HxCNames::*replace)(HxCCIdentifier&, const HxCCIdentifier&);
};

constexpr OsTextRow kOsTexts[] = {
    {&HX_WantedName::OsTexts::event, &HxCNames::replaceMultirateEventName},
    {&HX_WantedName::OsTexts::counter, &HxCNames::replaceMultirateCtrName},
    {&HX_WantedName::OsTexts::message, &HxCNames::replaceMultirateMsgName},
    {&HX_WantedName::OsTexts::osObject, &HxCNames::replaceMultirateObjName},
};

}  // namespace

std::deque<HX_FormedName> HX_NameForming::formAll(
    const std::deque<HX_WantedName>& names, const Progress& progress) {
  std::deque<HX_FormedName> formed;
  for (const HX_WantedName& name : names) formed.emplace_back(name);
  std::size_t done = 0;
  for (const std::size_t index : HX_FormingOrder(names)) {
    form(formed[index]);
    progress(++done, names.size());
  }
  return formed;
}

void HX_NameForming::form(HX_FormedName& name) {
  const HX_MessageCollector collector(name.findings);
  const HX_WantedName& wanted = *name.wanted;
  if (countOf(':', wanted.nameTemplate) > 1)
    remark(name, HX_Finding::eWarning,
           "The name template has more than two parts; the first two count.");
  HxCCIdentifier id(wanted.nameTemplate);
  name.isComplete = expand(wanted, id, false);

  // A name that still holds macros is no C name yet.
  if (name.isComplete || wanted.retained == 0) {
    makeCName(id, name);
    define(id, name);
  }
  name.formal = id.getCookedName(HxCCIdentifier::eFormalName);
  name.actual = id.getCookedName(HxCCIdentifier::eActualName);
  if (wanted.isTask()) m_TaskNames[&wanted] = id;
}

bool HX_NameForming::expand(const HX_WantedName& name, HxCCIdentifier& id,
                            bool suppressMessages) {
  id.setSourceRef(name.source);
  id.setDdSourceRef(name.dd);
  id.setSignalLabel(name.label);
  id.setDollarXValue(name.x);
  HX_BdBlock ivBlock(name.ivBlock.value_or(KyCXString()), name.source);
  if (name.ivBlock) id.setSourceIVBlock(&ivBlock);

  substitute(name, id);
  const bool isComplete =
      name.kind == HX_NameKind::eFile
          ? m_Names.handleFileNameMacro(id, name.modelContext)
          : m_Names.createNameFromForm(
                id, name.type != nullptr ? &name.type->type : nullptr,
                name.retained, name.provisional, suppressMessages);
  id.setSourceIVBlock(nullptr);
  return isComplete;
}

// Symbol macros go before the expansion. The expansion finds the "$R" of their
// values and does not report symbol macros as unsupported.
void HX_NameForming::substitute(const HX_WantedName& name, HxCCIdentifier& id) {
  for (const HX_Substitution& entry : name.substitutions)
    m_Names.substAllDollarZByValue(id, entry.macro, HxCCIdentifier(entry.value),
                                   entry.kind);
  replaceMultirate(name, id);
  if (name.symbol) m_Names.handleSymbolNameMacro(id, name.symbol.get());
}

void HX_NameForming::replaceMultirate(const HX_WantedName& name,
                                      HxCCIdentifier& id) {
  if (const HX_WantedName* timed = name.timed()) {
    m_Names.replaceMultirateTaskISRName(id, m_TaskNames[name.task],
                                        m_TaskNames[name.isr],
                                        name.kind == HX_NameKind::eTask);
    m_Names.replaceMultirateTimeName(id, timed->period, timed->offset,
                                     timed->cyclic);
  }
  for (const OsTextRow& row : kOsTexts) {
    if (const auto& text = name.osTexts.*row.text)
      (m_Names.*row.replace)(id, finalName(*text));
  }
  if (const auto& text = name.osTexts.messageVariable)
    m_Names.replaceMultirateMsgVarName(id, *text);
}

void HX_NameForming::makeCName(HxCCIdentifier& id, HX_FormedName& name) {
  id.activateActualName();
  const KyCXString expanded = id.getCookedName(HxCCIdentifier::eActualName);
  id.makeCIdentifier();
  const KyCXString whole = id.getCookedName(HxCCIdentifier::eActualName);
  if (!(whole == expanded))
    name.changes.push_back({HX_Change::eMadeIdentifier});
  id.adaptSize();
  const KyCXString& fitted = id.getCookedName(HxCCIdentifier::eActualName);
  if (!(fitted == whole)) name.changes.push_back({HX_Change::eShortened});
  if (HxCGlobal::getOptions()->getLimitVariableNameLength() &&
      fitted.length() > HxCSymbol::sm_MaxNameLength)
    remark(name, HX_Finding::eWarning,
           "The name is longer than " +
               std::to_string(HxCSymbol::sm_MaxNameLength) +
               " characters, and its template does not let it change ($R).");
}

void HX_NameForming::define(HxCCIdentifier& id, HX_FormedName& name) {
  const KyCXString wanted = id.getCookedName(HxCCIdentifier::eActualName);
  if (wanted.isEmpty())
    return remark(name, HX_Finding::eError,
                  "The name is empty: nothing is defined.");

  KyCXString text = wanted;
  const bool isChangeable =
      id.getIdentifierChangeable(HxCCIdentifier::eActualName);
  const HX_Change conflict = m_Spaces.define(*name.wanted, text, isChangeable);
  name.isDefined = conflict.reason == HX_Change::eNone || isChangeable;
  if (conflict.reason == HX_Change::eNone) return;
  if (name.isDefined) {
    name.changes.push_back(conflict);
    id.setCookedName(text, HxCCIdentifier::eActualName);
    HxCTransformationTracer::logTransformation(
        (name.wanted->id + ": " + wanted.cstring() + " -> " + text.cstring() +
         " (" + conflict.text() + ")")
            .c_str());
  } else if (!HX_NameSpaces::isReported(conflict)) {
    remark(name, HX_Finding::eError,
           "The name '" + HX_ToUtf8(wanted) + "' is " + conflict.text() +
               ", and its template does not let it change ($R).");
  }
}
