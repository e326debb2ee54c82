#include "host/HX_NameRun.h"

#include <algorithm>
#include <tuple>

#include "SourceRef/HxCSrcRefServer.h"
#include "Trace/HxCTransformationTracer.h"
#include "host/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HxCGlobal.h"

namespace {

constexpr int kWarning = 1;
constexpr int kError = 2;

void remark(HX_FormedName& formed, int severity, const std::string& text) {
  formed.findings.push_back({0, severity, text, formed.sourcePath});
}

std::string textOf(const HxCSrcRef* srcRef) {
  if (srcRef == nullptr) return {};
  KyCXString text;
  srcRef->toString(text);
  return HX_ToUtf8(text);
}

HxCSrcRefSet sourcesOf(const HX_NameItem& item) {
  HxCSrcRefSet sources(item.source);
  sources.addSrcRef(item.dd);
  for (const HxCSrcRef* srcRef : item.alsoFrom) sources.addSrcRef(srcRef);
  return sources;
}

// A value that needs no expansion: without the "$R" of a template, which would
// become part of the C identifier.
HxCCIdentifier finalName(const KyCXString& text) {
  HxCCIdentifier id(text);
  id.setCookedName(text, HxCCIdentifier::eActualName);
  return id;
}

void takeMessages(HX_FormedName& formed) {
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  for (const HX_Message& message : handler.messages()) {
    formed.findings.push_back({message.id, message.severity,
                               HX_Latin1ToUtf8(message.text),
                               HX_Latin1ToUtf8(message.source)});
  }
  handler.clear();
}

}  // namespace

const HxCSrcRef* HX_ChooseSrcRef(const HxCSrcRefSet& sources) {
  const HxCSrcRef* block = nullptr;
  const HxCSrcRef* dd = nullptr;
  const HxCSrcRef* other = nullptr;
  HxCSrcRefServer::getSpecificSrcRefFromSet(&sources, &block, &dd, &other);
  if (block != nullptr) return block;
  return dd != nullptr ? dd : other;
}

HX_NameRun::HX_NameRun(const HX_Model& model, HX_NameSpaces& spaces)
    : m_Model(model), m_Spaces(spaces) {}

std::vector<HX_FormedName> HX_NameRun::formAll(const Progress& progress) {
  HX_MessageHandler::instance().clear();
  const auto& items = m_Model.names();
  std::vector<std::size_t> order(items.size());
  for (std::size_t i = 0; i < order.size(); ++i) order[i] = i;
  // Other names contain those of tasks, and names of tasks that of an isr.
  const auto rank = [&](std::size_t i) {
    const std::string& kind = items[i]->kind;
    return std::make_tuple(kind == "isr"    ? 0
                           : kind == "task" ? 1
                                            : 2,
                           std::cref(items[i]->id));
  };
  std::sort(order.begin(), order.end(),
            [&](std::size_t a, std::size_t b) { return rank(a) < rank(b); });

  std::vector<HX_FormedName> names(items.size());
  std::size_t done = 0;
  for (const std::size_t i : order) {
    names[i] = form(*items[i]);
    progress(++done, items.size());
  }
  return names;
}

HX_FormedName HX_NameRun::form(const HX_NameItem& item) {
  HX_FormedName formed;
  formed.item = &item;
  formed.sources = sourcesOf(item);
  formed.sourcePath = textOf(HX_ChooseSrcRef(formed.sources));
  if (std::count(item.nameTemplate.begin(), item.nameTemplate.end(), ':') > 1)
    remark(formed, kWarning,
           "The name template has more than two parts; the first two count.");

  HX_BdBlock ivBlock(HX_FromUtf8(item.ivBlock.value_or("")), item.source);
  HxCCIdentifier id = begin(item, item.nameTemplate);
  if (item.ivBlock) id.setSourceIVBlock(&ivBlock);
  formed.isComplete = expand(item, id, false);
  id.setSourceIVBlock(nullptr);

  // A name that still holds macros is no C name yet.
  if (formed.isComplete || item.retained == 0) {
    makeCName(id, formed);
    define(id, formed);
  }
  formed.formal = HX_ToUtf8(id.getCookedName(HxCCIdentifier::eFormalName));
  formed.actual = HX_ToUtf8(id.getCookedName(HxCCIdentifier::eActualName));
  takeMessages(formed);
  if (item.isTask()) m_TaskNames[&item] = id;
  return formed;
}

HxCCIdentifier HX_NameRun::begin(const HX_NameItem& item,
                                 const std::string& nameTemplate) {
  HxCCIdentifier id(HX_FromUtf8(nameTemplate));
  id.setSourceRef(item.source);
  id.setDdSourceRef(item.dd);
  id.setSignalLabel(HX_FromUtf8(item.label));
  id.setDollarXValue(HX_FromUtf8(item.x));
  return id;
}

// Symbol macros go first: the expansion then finds the "$R" that they bring,
// and does not report them as unknown here.
bool HX_NameRun::expand(const HX_NameItem& item, HxCCIdentifier& id,
                        bool suppressMessages) {
  substitute(item, id);
  replaceMultirate(item, id);
  if (item.symbol) m_Names.handleSymbolNameMacro(id, item.symbol.get());
  if (item.kind == "file")
    return m_Names.handleFileNameMacro(id, item.modelContext);
  return m_Names.createNameFromForm(
      id, item.type != nullptr ? &item.type->type : nullptr, item.retained,
      item.provisional, suppressMessages);
}

void HX_NameRun::substitute(const HX_NameItem& item, HxCCIdentifier& id) {
  for (const HX_NameItem::Substitution& entry : item.substitutions) {
    m_Names.substAllDollarZByValue(
        id, HX_FromUtf8(entry.macro), HxCCIdentifier(HX_FromUtf8(entry.value)),
        static_cast<HxCNames::tagMacroKindEnum>(entry.kind));
  }
}

const HxCCIdentifier& HX_NameRun::taskName(const HX_NameItem* item) const {
  static const HxCCIdentifier none;
  const auto found = m_TaskNames.find(item);
  return found == m_TaskNames.end() ? none : found->second;
}

void HX_NameRun::replaceMultirate(const HX_NameItem& item, HxCCIdentifier& id) {
  const HX_NameItem* timed = item.isTask()          ? &item
                             : item.task != nullptr ? item.task
                                                    : item.isr;
  if (timed != nullptr) {
    m_Names.replaceMultirateTaskISRName(
        id, taskName(item.task), taskName(item.isr), item.kind == "task");
    m_Names.replaceMultirateTimeName(id, timed->period, timed->offset,
                                     timed->cyclic);
  }

  using Replace = void (HxCNames::*)(HxCCIdentifier&, const HxCCIdentifier&);
  struct Row {
    const char* field;
    Replace replace;
  };
  static constexpr Row kRows[] = {
      {"event", &HxCNames::replaceMultirateEventName},
      {"counter", &HxCNames::replaceMultirateCtrName},
      {"message", &HxCNames::replaceMultirateMsgName},
      {"osObject", &HxCNames::replaceMultirateObjName},
  };
  for (const Row& row : kRows) {
    const auto text = item.osTexts.find(row.field);
    if (text != item.osTexts.end())
      (m_Names.*row.replace)(id, finalName(HX_FromUtf8(text->second)));
  }
  const auto variable = item.osTexts.find("messageVariable");
  if (variable != item.osTexts.end())
    m_Names.replaceMultirateMsgVarName(id, HX_FromUtf8(variable->second));
}

void HX_NameRun::makeCName(HxCCIdentifier& id, HX_FormedName& formed) {
  id.activateActualName();
  KyCXString before = id.getCookedName(HxCCIdentifier::eActiveName);
  id.makeCIdentifier();
  if (!(before == id.getCookedName(HxCCIdentifier::eActiveName)))
    formed.changes.push_back("made an identifier");

  before = id.getCookedName(HxCCIdentifier::eActiveName);
  id.adaptSize();
  const KyCXString& name = id.getCookedName(HxCCIdentifier::eActiveName);
  if (!(before == name)) formed.changes.push_back("shortened");
  if (HxCGlobal::getOptions()->getLimitVariableNameLength() &&
      name.length() > HxCSymbol::sm_MaxNameLength)
    remark(formed, kWarning,
           "The name is longer than " +
               std::to_string(HxCSymbol::sm_MaxNameLength) +
               " characters, and its template does not let it change ($R).");
}

void HX_NameRun::define(HxCCIdentifier& id, HX_FormedName& formed) {
  KyCXString name = id.getCookedName(HxCCIdentifier::eActualName);
  if (name.isEmpty())
    return remark(formed, kError, "The name is empty: nothing is defined.");

  const bool changeable =
      id.getIdentifierChangeable(HxCCIdentifier::eActualName);
  const HX_NameSpaces::Result result =
      m_Spaces.define(*formed.item, name, changeable);
  if (!result.isDefined) {
    // The library's own check reports words; other names are ours to report.
    if (m_Names.isStringValidCVariableName(name))
      remark(formed, kError,
             "The name '" + HX_ToUtf8(name) + "' is " + result.conflict +
                 ", and its template does not let it change ($R).");
    return;
  }
  if (!result.conflict.empty()) {
    formed.changes.push_back(result.conflict);
    const KyCXString wanted = id.getCookedName(HxCCIdentifier::eActualName);
    HxCTransformationTracer::logTransformation(
        (formed.item->id + ": " + wanted.cstring() + " -> " + name.cstring() +
         " (" + result.conflict + ")")
            .c_str());
    id.setCookedName(name, HxCCIdentifier::eActualName);
  }
  formed.isDefined = m_Names.isStringValidCVariableName(name);
}
