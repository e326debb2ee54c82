// HX_NameForming::explain(): the value of each macro of a template.
#include <algorithm>
#include <cstring>

#include "host/base/HX_Text.h"
#include "host/names/HX_NameForming.h"

namespace {

std::string fromSource(const HX_WantedName& name) {
  return name.source != nullptr ? HX_PathOf(name.source) : "no source";
}

std::string fromDictionary(const HX_WantedName& name) {
  return name.dd != nullptr ? HX_PathOf(name.dd) : fromSource(name);
}

std::string fromType(const HX_WantedName& name) {
  return name.type != nullptr ? "type '" + name.type->id + "'" : "no type";
}

std::string fromTask(const HX_WantedName& name) {
  const HX_WantedName* timed = name.timed();
  if (timed == nullptr) return "no task";
  return std::string(HX_WordOf(kHxNameKinds, timed->kind)) + " '" + timed->id +
         "'";
}

std::string fromModel(const HX_WantedName&) { return "the model"; }

struct MeaningRow {
  const char* macro;  // the beginning of the macro
  const char* meaning;
  std::string (*origin)(
      const HX_WantedName& name);  // null: given with the name
};

// The first row that fits counts.
constexpr MeaningRow kMeanings[] = {
    {"$(Type)", "name of the type", fromType},
    {"$(BaseType)", "name of the base type", fromType},
    {"$(Component)", "software component of the variable", fromDictionary},
    {"$(Task)", "name of the task", fromTask},
    {"$(ISR)", "name of the interrupt service routine", fromTask},
    {"$(Time", "period and offset", fromTask},
    {"$(Period", "period", fromTask},
    {"$(Offset", "offset", fromTask},
    {"$(", "given with the name", nullptr},
    {"$E", "given with the name", nullptr},
    {"$L", "signal label, else block name", fromSource},
    {"$B", "block name", fromSource},
    {"$S", "subsystem id and number", fromSource},
    {"$I", "subsystem id", fromSource},
    {"$M", "model name", fromModel},
    {"$N", "name of the subsystem under generation", fromModel},
    {"$H", "states around the chart object", fromSource},
    {"$O", "name of the chart object", fromSource},
    {"$C", "subsystem id and number of the chart object", fromSource},
    {"$D", "name of the dictionary object", fromDictionary},
    {"$X", "text given with the name", nullptr},
    {"$T", "short name of the type", fromType},
    {"$R", "nothing; the name may be changed", nullptr},
    {"$$", "one dollar sign", nullptr},
    {"$x", "text of the symbol", nullptr},
    {"$f", "name of the symbol, a function", nullptr},
    {"$F", "the same in upper case", nullptr},
    {"$v", "name of the symbol", nullptr},
    {"$V", "the same in upper case", nullptr},
    {"$t", "short name of the symbol's type", nullptr},
    {"$", "no macro of the language", nullptr},
    {"", "as written", nullptr},
};

std::string meaningOf(const HX_WantedName& name, const std::string& macro) {
  const MeaningRow* row = kMeanings;
  while (macro.compare(0, std::strlen(row->macro), row->macro) != 0) ++row;
  if (row->origin == nullptr) return row->meaning;
  return row->meaning + (", from " + row->origin(name));
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

std::vector<HX_ExplainedMacro> HX_NameForming::explain(
    const HX_WantedName& name) {
  std::vector<HX_ExplainedMacro> steps;
  std::vector<HX_Finding> unseen;
  const HX_MessageCollector collector(unseen);
  const std::string text = HX_ToUtf8(name.nameTemplate);
  for (std::size_t from = 0; from < text.size();) {
    const std::size_t end = endOfToken(text, from);
    const std::string token = text.substr(from, end - from);
    from = end;
    if (token[0] != '$') {
      steps.push_back({token, token, meaningOf(name, "")});
      continue;
    }
    HxCCIdentifier id(HX_FromUtf8(token));
    expand(name, id, true);
    steps.push_back({token,
                     HX_ToUtf8(id.getCookedName(HxCCIdentifier::eFormalName)),
                     meaningOf(name, token)});
  }
  return steps;
}
