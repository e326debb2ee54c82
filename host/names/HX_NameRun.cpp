#include "host/names/HX_NameRun.h"

#include <algorithm>
#include <tuple>

#include "SourceRef/HxCSrcRefServer.h"
#include "Trace/HxCTransformationTracer.h"
#include "host/base/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HxCGlobal.h"

namespace {

constexpr int kWarning = 1;
constexpr int kError = 2;

void remark(HX_Name& name, int severity, const std::string& text) {
  name.findings.push_back({0, severity, text, name.sourcePath});
}

// A message is best attached to the last block, else to the last dictionary
// object, else to the last other reference; null for an empty set.
const HxCSrcRef* bestOf(const HxCSrcRefSet& sources) {
  const HxCSrcRef* block = nullptr;
  const HxCSrcRef* dd = nullptr;
  const HxCSrcRef* other = nullptr;
  HxCSrcRefServer::getSpecificSrcRefFromSet(&sources, &block, &dd, &other);
  if (block != nullptr) return block;
  return dd != nullptr ? dd : other;
}

// Other names contain those of tasks, and names of tasks that of an isr.
auto rankOf(const HX_Name& name) {
  const int group = name.kind == "isr" ? 0 : name.kind == "task" ? 1 : 2;
  return std::make_tuple(group, std::cref(name.id));
}

// A value that needs no expansion: without the "$R" of a template, which would
// become part of the C identifier.
HxCCIdentifier finalName(const KyCXString& text) {
  HxCCIdentifier id(text);
  id.setCookedName(text, HxCCIdentifier::eActualName);
  return id;
}

struct OsTextRow {
  const char* field;
  void (HxCNames::*replace)(HxCCIdentifier&, const HxCCIdentifier&);
};

constexpr OsTextRow kOsTexts[] = {
    {"event", &HxCNames::replaceMultirateEventName},
    {"counter", &HxCNames::replaceMultirateCtrName},
    {"message", &HxCNames::replaceMultirateMsgName},
    {"osObject", &HxCNames::replaceMultirateObjName},
};

}  // namespace

std::string HX_PathOf(const HxCSrcRef* srcRef) {
  if (srcRef == nullptr) return {};
  KyCXString text;
  srcRef->toString(text);
  return HX_ToUtf8(text);
}

void HX_TakeMessages(std::vector<HX_Finding>& findings) {
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  for (const HX_Message& message : handler.messages())
    findings.push_back({message.id, message.severity,
                        HX_Latin1ToUtf8(message.text),
                        HX_Latin1ToUtf8(message.source)});
  handler.clear();
}

void HX_NameRun::formAll(std::deque<HX_Name>& names, const Progress& progress) {
  std::vector<HX_Name*> order;
  order.reserve(names.size());
  for (HX_Name& name : names) order.push_back(&name);
  std::sort(order.begin(), order.end(), [](const HX_Name* a, const HX_Name* b) {
    return rankOf(*a) < rankOf(*b);
  });
  std::size_t done = 0;
  for (HX_Name* name : order) {
    form(*name);
    progress(++done, order.size());
  }
}

void HX_NameRun::form(HX_Name& name) {
  name.sourcePath = HX_PathOf(bestOf(name.sources));
  const std::string& text = name.nameTemplate;
  if (std::count(text.begin(), text.end(), ':') > 1)
    remark(name, kWarning,
           "The name template has more than two parts; the first two count.");
  HxCCIdentifier id(HX_FromUtf8(text));
  name.isComplete = expand(name, id, false);
  HX_TakeMessages(name.findings);

  // A name that still holds macros is no C name yet.
  if (name.isComplete || name.retained == 0) {
    makeCName(id, name);
    define(id, name);
    HX_TakeMessages(name.findings);
  }
  name.formal = HX_ToUtf8(id.getCookedName(HxCCIdentifier::eFormalName));
  name.actual = HX_ToUtf8(id.getCookedName(HxCCIdentifier::eActualName));
  if (name.isTask()) m_TaskNames[&name] = id;
}

// Symbol macros go first: the expansion then finds the "$R" that they bring,
// and does not report them as unknown here.
bool HX_NameRun::expand(const HX_Name& name, HxCCIdentifier& id,
                        bool suppressMessages) {
  id.setSourceRef(name.source);
  id.setDdSourceRef(name.dd);
  id.setSignalLabel(HX_FromUtf8(name.label));
  id.setDollarXValue(HX_FromUtf8(name.x));
  HX_BdBlock ivBlock(HX_FromUtf8(name.ivBlock.value_or("")), name.source);
  if (name.ivBlock) id.setSourceIVBlock(&ivBlock);

  for (const HX_Substitution& entry : name.substitutions)
    m_Names.substAllDollarZByValue(
        id, HX_FromUtf8(entry.macro), HxCCIdentifier(HX_FromUtf8(entry.value)),
        static_cast<HxCNames::tagMacroKindEnum>(entry.kind));
  replaceMultirate(name, id);
  if (name.symbol) m_Names.handleSymbolNameMacro(id, name.symbol.get());
  const bool isComplete =
      name.kind == "file"
          ? m_Names.handleFileNameMacro(id, name.modelContext)
          : m_Names.createNameFromForm(
                id, name.type != nullptr ? &name.type->type : nullptr,
                name.retained, name.provisional, suppressMessages);
  id.setSourceIVBlock(nullptr);
  return isComplete;
}

void HX_NameRun::replaceMultirate(const HX_Name& name, HxCCIdentifier& id) {
  if (const HX_Name* timed = name.timed()) {
    m_Names.replaceMultirateTaskISRName(
        id, m_TaskNames[name.task], m_TaskNames[name.isr], name.kind == "task");
    m_Names.replaceMultirateTimeName(id, timed->period, timed->offset,
                                     timed->cyclic);
  }
  for (const OsTextRow& row : kOsTexts) {
    const auto text = name.osTexts.find(row.field);
    if (text != name.osTexts.end())
      (m_Names.*row.replace)(id, finalName(HX_FromUtf8(text->second)));
  }
  const auto variable = name.osTexts.find("messageVariable");
  if (variable != name.osTexts.end())
    m_Names.replaceMultirateMsgVarName(id, HX_FromUtf8(variable->second));
}

void HX_NameRun::makeCName(HxCCIdentifier& id, HX_Name& name) {
  id.activateActualName();
  const KyCXString expanded = id.getCookedName(HxCCIdentifier::eActualName);
  id.makeCIdentifier();
  const KyCXString whole = id.getCookedName(HxCCIdentifier::eActualName);
  if (!(whole == expanded)) name.changes.push_back("made an identifier");
  id.adaptSize();
  const KyCXString& fitted = id.getCookedName(HxCCIdentifier::eActualName);
  if (!(fitted == whole)) name.changes.push_back("shortened");
  if (HxCGlobal::getOptions()->getLimitVariableNameLength() &&
      fitted.length() > HxCSymbol::sm_MaxNameLength)
    remark(name, kWarning,
           "The name is longer than " +
               std::to_string(HxCSymbol::sm_MaxNameLength) +
               " characters, and its template does not let it change ($R).");
}

void HX_NameRun::define(HxCCIdentifier& id, HX_Name& name) {
  const KyCXString wanted = id.getCookedName(HxCCIdentifier::eActualName);
  if (wanted.isEmpty())
    return remark(name, kError, "The name is empty: nothing is defined.");

  KyCXString text = wanted;
  const std::string conflict = m_Spaces.define(
      name, text, id.getIdentifierChangeable(HxCCIdentifier::eActualName));
  if (conflict.empty()) return;
  if (name.isDefined) {
    name.changes.push_back(conflict);
    id.setCookedName(text, HxCCIdentifier::eActualName);
    HxCTransformationTracer::logTransformation(
        (name.id + ": " + wanted.cstring() + " -> " + text.cstring() + " (" +
         conflict + ")")
            .c_str());
  } else if (HX_MessageHandler::instance().messages().empty()) {
    // The library has reported a word; other names are ours to report.
    remark(name, kError,
           "The name '" + HX_ToUtf8(wanted) + "' is " + conflict +
               ", and its template does not let it change ($R).");
  }
}
