// HX_NameForming::explain(): the value of each macro of a template.
#include <algorithm>

#include "Naming/HX_MacroTable.h"
#include "host/base/HX_NameText.h"
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

// The object that gives the value of \p macro, for the rows of the macro table
// with an object.
std::string originOf(const HX_WantedName& name, const HX_Macro& macro) {
  switch (macro.origin) {
    case HX_Macro::eOriginModel:
      return "the model";
    case HX_Macro::eOriginSource:
      return fromSource(name);
    case HX_Macro::eOriginDdObject:
      return fromDictionary(name);
    case HX_Macro::eOriginType:
      return fromType(name);
    case HX_Macro::eOriginTask:
      return fromTask(name);
    case HX_Macro::eOriginNone:
    case HX_Macro::eOriginSymbol:
      break;
  }
  return {};
}

std::string meaningOf(const HX_WantedName& name, const std::string& token) {
  if (token[0] != '$') return "as written";
  const HX_Macro* macro = HX_FindMacro(HX_FromUtf8(token));
  if (macro == nullptr) return "no macro of the language";
  const std::string origin = originOf(name, *macro);
  return macro->meaning + (origin.empty() ? "" : ", from " + origin);
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
  const std::string text = *name.nameTemplate->shown;
  for (std::size_t from = 0; from < text.size();) {
    const std::size_t end = endOfToken(text, from);
    const std::string token = text.substr(from, end - from);
    from = end;
    if (token[0] != '$') {
      steps.push_back({token, token, meaningOf(name, token)});
      continue;
    }
    HxCCIdentifier id(HX_NameText(token));
    expand(name, id, true);
    steps.push_back({token,
                     HX_ToUtf8(id.getCookedName(HxCCIdentifier::eFormalName)),
                     meaningOf(name, token)});
  }
  return steps;
}
