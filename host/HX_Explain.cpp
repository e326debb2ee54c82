// HX_NameRun::explain(): what each macro of a template gives.
#include <algorithm>

#include "host/HX_NameRun.h"
#include "host/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HX_BdBlock.h"

namespace {

enum Origin { eNone, eSource, eDictionary, eType, eTask, eModel };

struct MeaningRow {
  const char* macro;  // the beginning of the macro
  const char* meaning;
  Origin origin;
};

// The first row that fits counts.
constexpr MeaningRow kMeanings[] = {
    {"$(Type)", "name of the type", eType},
    {"$(BaseType)", "name of the base type", eType},
    {"$(Component)", "software component of the variable", eDictionary},
    {"$(Task)", "name of the task", eTask},
    {"$(ISR)", "name of the interrupt service routine", eTask},
    {"$(Time", "period and offset", eTask},
    {"$(Period", "period", eTask},
    {"$(Offset", "offset", eTask},
    {"$(", "given with the name", eNone},
    {"$E", "given with the name", eNone},
    {"$L", "signal label, else block name", eSource},
    {"$B", "block name", eSource},
    {"$S", "subsystem id and number", eSource},
    {"$I", "subsystem id", eSource},
    {"$M", "model name", eModel},
    {"$N", "name of the subsystem under generation", eModel},
    {"$H", "states around the chart object", eSource},
    {"$O", "name of the chart object", eSource},
    {"$C", "subsystem id and number of the chart object", eSource},
    {"$D", "name of the dictionary object", eDictionary},
    {"$X", "text given with the name", eNone},
    {"$T", "short name of the type", eType},
    {"$R", "nothing; the name may be changed", eNone},
    {"$$", "one dollar sign", eNone},
    {"$x", "text of the symbol", eNone},
    {"$f", "name of the symbol, a function", eNone},
    {"$F", "the same in upper case", eNone},
    {"$v", "name of the symbol", eNone},
    {"$V", "the same in upper case", eNone},
    {"$t", "short name of the symbol's type", eNone},
    {"$", "no macro of the language", eNone},
    {"", "as written", eNone},
};

std::string pathOf(const HxCSrcRef* srcRef) {
  if (srcRef == nullptr) return "no source";
  KyCXString text;
  srcRef->toString(text);
  return HX_ToUtf8(text);
}

std::string originOf(const HX_NameItem& item, const std::string& macro) {
  const MeaningRow* row = kMeanings;
  while (macro.compare(0, std::string(row->macro).size(), row->macro) != 0)
    ++row;
  std::string meaning = row->meaning;
  const HX_NameItem* timed = item.isTask() ? &item : item.task;
  if (timed == nullptr) timed = item.isr;
  switch (row->origin) {
    case eNone:
      return meaning;
    case eModel:
      return meaning + ", from the model";
    case eSource:
      return meaning + ", from " + pathOf(item.source);
    case eDictionary:
      return meaning + ", from " +
             pathOf(item.dd != nullptr ? item.dd : item.source);
    case eType:
      return meaning + ", from " +
             (item.type != nullptr ? "type '" + item.type->id + "'"
                                   : "no type");
    case eTask:
      return meaning + ", from " +
             (timed != nullptr ? timed->kind + " '" + timed->id + "'"
                               : "no task");
  }
  return meaning;
}

// The end of the macro or of the literal text that begins at \p from.
std::size_t endOfToken(const std::string& text, std::size_t from) {
  if (text[from] != '$') return std::min(text.find('$', from), text.size());
  const bool hasArgument =
      text.compare(from, 2, "$(") == 0 || text.compare(from, 3, "$E(") == 0;
  if (!hasArgument) return std::min(from + 2, text.size());
  const std::size_t close = text.find(')', from);
  return close == std::string::npos ? text.size() : close + 1;
}

}  // namespace

std::vector<HX_ExplainedMacro> HX_NameRun::explain(const HX_NameItem& item) {
  std::vector<HX_ExplainedMacro> steps;
  const std::string& text = item.nameTemplate;
  for (std::size_t from = 0; from < text.size();) {
    const std::size_t end = endOfToken(text, from);
    const std::string macro = text.substr(from, end - from);
    from = end;
    if (macro[0] != '$') {
      steps.push_back({macro, macro, originOf(item, "")});
      continue;
    }
    HX_BdBlock ivBlock(HX_FromUtf8(item.ivBlock.value_or("")), item.source);
    HxCCIdentifier id = begin(item, macro);
    if (item.ivBlock) id.setSourceIVBlock(&ivBlock);
    expand(item, id, true);
    steps.push_back({macro,
                     HX_ToUtf8(id.getCookedName(HxCCIdentifier::eFormalName)),
                     originOf(item, macro)});
  }
  HX_MessageHandler::instance().clear();
  return steps;
}
