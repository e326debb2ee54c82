#include "host/names/HX_NameForming.h"

#include "Trace/HxCTransformationTracer.h"
#include "host/base/HX_Text.h"
#include "host/names/HX_FormingOrder.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HxCGlobal.h"

namespace {

void remark(HX_FormedName& name, HX_MessageNumber number,
            std::initializer_list<std::string_view> arguments = {}) {
  name.findings.push_back(HX_Remark(number, arguments, name.sourcePath()));
}

// Values of macros may hold macros of later substitutions: 1000 substitutions
// could fill any memory.
constexpr int kMostUnits = 65536;

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
  std::optional<KyCXString> HX_RareWishes::*text;
  void (HxCNames::*replace)(HxCCIdentifier&, const HxCCIdentifier&);
};

constexpr OsTextRow kOsTexts[] = {
    {&HX_RareWishes::event, &HxCNames::replaceMultirateEventName},
    {&HX_RareWishes::counter, &HxCNames::replaceMultirateCtrName},
    {&HX_RareWishes::message, &HxCNames::replaceMultirateMsgName},
    {&HX_RareWishes::osObject, &HxCNames::replaceMultirateObjName},
};

}  // namespace

std::deque<HX_FormedName> HX_NameForming::formAll(
    const std::deque<HX_WantedName>& names, const std::vector<bool>& chosen,
    HX_Progress& progress) {
  std::deque<HX_FormedName> formed;
  for (const HX_WantedName& name : names) formed.emplace_back(name);
  progress.begin("names", names.size());
  for (const std::size_t index : HX_FormingOrder(names, chosen)) {
    form(formed[index]);
    progress.step();
  }
  return formed;
}

void HX_NameForming::form(HX_FormedName& name) {
  const HX_MessageCollector collector(name.findings);
  const HX_WantedName& wanted = *name.wanted;
  if (countOf(':', wanted.nameTemplate->text) > 1) remark(name, kHxManyParts);
  HxCCIdentifier id(wanted.nameTemplate->text);
  const std::optional<bool> isComplete = expand(wanted, id, false);
  if (!isComplete)
    return remark(name, kHxMacrosInMacros, {std::to_string(kMostUnits)});
  name.isComplete = *isComplete;

  // A name that still holds macros is no C name yet.
  const bool isFinal = name.isComplete || wanted.rare().retained == 0;
  if (isFinal) define(id, name);
  name.actual = id.getCookedName(HxCCIdentifier::eActualName);
  if (isFinal) name.setWantedText(m_Safe.wanted());
  name.setFormal(id.getCookedName(HxCCIdentifier::eFormalName));
  if (wanted.isTask()) m_TaskNames[&wanted] = id;
}

std::optional<bool> HX_NameForming::expand(const HX_WantedName& name,
                                           HxCCIdentifier& id,
                                           bool suppressMessages) {
  id.setSourceRef(name.source);
  id.setDdSourceRef(name.dd);
  id.setSignalLabel(name.label);
  const HX_RareWishes& rare = name.rare();
  id.setDollarXValue(rare.x);
  HX_BdBlock ivBlock(rare.ivBlock.value_or(KyCXString()), name.source);
  if (rare.ivBlock) id.setSourceIVBlock(&ivBlock);

  if (!substitute(name, id)) {
    id.setSourceIVBlock(nullptr);
    return std::nullopt;
  }
  const bool isComplete =
      name.kind == HX_NameKind::eFile
          ? m_Names.handleFileNameMacro(id, rare.modelContext)
          : m_Names.createNameFromForm(
                id, name.type != nullptr ? &name.type->type : nullptr,
                rare.retained, rare.provisional, suppressMessages);
  id.setSourceIVBlock(nullptr);
  return isComplete;
}

// Symbol macros go before the expansion. The expansion finds the "$R" of their
// values and does not report symbol macros as unsupported.
bool HX_NameForming::substitute(const HX_WantedName& name, HxCCIdentifier& id) {
  for (const HX_Substitution& entry : name.rare().substitutions) {
    m_Names.substAllDollarZByValue(id, entry.macro, HxCCIdentifier(entry.value),
                                   entry.kind);
    if (id.getCookedName(HxCCIdentifier::eActualName).length() > kMostUnits)
      return false;
  }
  replaceMultirate(name, id);
  if (HxCSymbol* symbol = name.rare().symbol.get())
    m_Names.handleSymbolNameMacro(id, symbol);
  return true;
}

void HX_NameForming::replaceMultirate(const HX_WantedName& name,
                                      HxCCIdentifier& id) {
  if (const HX_WantedName* timed = name.timed()) {
    m_Names.replaceMultirateTaskISRName(id, m_TaskNames[name.rare().task],
                                        m_TaskNames[name.rare().isr],
                                        name.kind == HX_NameKind::eTask);
    m_Names.replaceMultirateTimeName(
        id, timed->rare().period, timed->rare().offset, timed->rare().cyclic);
  }
  for (const OsTextRow& row : kOsTexts) {
    if (const auto& text = name.rare().*row.text)
      (m_Names.*row.replace)(id, finalName(*text));
  }
  if (const auto& text = name.rare().messageVariable)
    m_Names.replaceMultirateMsgVarName(id, *text);
}

void HX_NameForming::define(HxCCIdentifier& id, HX_FormedName& name) {
  const bool isWatched = !m_Watched.empty() && name.wanted->id == m_Watched;
  const KyCXString expanded =
      isWatched ? id.getCookedName(HxCCIdentifier::eActualName) : KyCXString();
  name.isDefined = m_Spaces.define(*name.wanted, id, m_Safe);
  if (isWatched) keepSteps(expanded);
  for (int i = 0; i < m_Safe.stepCount(); ++i) note(m_Safe.step(i), name);
  if (!name.isDefined || m_Safe.text() == m_Safe.wanted()) return;
  HxCTransformationTracer::logTransformation(
      (name.wanted->id + ": " + m_Safe.wanted().cstring() + " -> " +
       m_Safe.text().cstring() + " (" + name.changes.back().text() + ")")
          .c_str());
}

void HX_NameForming::keepSteps(const KyCXString& expanded) {
  m_Steps = {{"uncut", HX_ToUtf8(expanded)}};
  for (int i = 0; i < m_Safe.stepCount(); ++i) {
    const HX_SafeName::Step& step = m_Safe.step(i);
    const HX_Change change = HX_NameSpaces::changeOf(step);
    std::string what = change.text();
    if (step.kind == HX_SafeName::eDerived) what = "variant";
    if (step.kind == HX_SafeName::eTooLong) what = "too long, but fixed";
    if (what.empty()) continue;
    m_Steps.push_back(
        {what, HX_ToUtf8(step.text), HX_NameSpaces::isConflict(change)});
  }
}

void HX_NameForming::note(const HX_SafeName::Step& step, HX_FormedName& name) {
  switch (step.kind) {
    case HX_SafeName::eEmpty:
      return remark(name, kHxEmptyName);
    case HX_SafeName::eTooLong:
      return remark(name, kHxTooLong,
                    {std::to_string(HxCSymbol::sm_MaxNameLength)});
    case HX_SafeName::eDerived:
      return;  // the conflict before it is the reason
    default:
      break;
  }
  const HX_Change change = HX_NameSpaces::changeOf(step);
  if (name.isDefined || !HX_NameSpaces::isConflict(change))
    return name.changes.push_back(change);
  if (HX_NameSpaces::isReported(change)) {
    m_Names.isStringValidCVariableName(step.text);
    return;
  }
  remark(name, kHxTaken, {HX_ToUtf8(step.text), change.text()});
}
