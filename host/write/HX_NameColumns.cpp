#include "host/write/HX_NameColumns.h"

#include <algorithm>
#include <string_view>
#include <utility>

#include "host/base/HX_NaturalOrder.h"
#include "host/base/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

using Name = const HX_FormedName&;

std::string messagesOf(Name name) {
  std::string all;
  for (const HX_Finding& finding : name.findings)
    all += (all.empty() ? "" : ", ") +
           std::string(HX_MessageHandler::severityName(finding.severity)) +
           " " + std::to_string(finding.id);
  return all;
}

struct Column {
  const char* name;
  std::string (*text)(Name);
};

constexpr Column kColumns[] = {
    {"name", [](Name name) { return name.wanted->id; }},
    {"source", [](Name name) { return name.sourcePath(); }},
    {"template", [](Name name) { return *name.wanted->nameTemplate->shown; }},
    {"formal", [](Name name) { return HX_ToUtf8(name.formal()); }},
    {"actual", [](Name name) { return HX_ToUtf8(name.actual); }},
    {"complete",
     [](Name name) { return std::string(name.isComplete ? "yes" : "no"); }},
    {"kind",
     [](Name name) {
       return std::string(HX_WordOf(kHxNameKinds, name.wanted->kind));
     }},
    {"scope", [](Name name) { return name.wanted->scope->id; }},
    {"type",
     [](Name name) {
       return name.wanted->type != nullptr ? name.wanted->type->name
                                           : std::string();
     }},
    {"changes", [](Name name) { return HX_JoinedChanges(name, ", "); }},
    {"messages", messagesOf},
};

const Column* findColumn(std::string_view name) {
  for (const Column& column : kColumns)
    if (column.name == name) return &column;
  return nullptr;
}

// '*' stands for any characters.
bool fits(std::string_view text, std::string_view pattern) {
  std::size_t at = 0;
  std::size_t in = 0;
  std::size_t star = pattern.npos;
  std::size_t retry = 0;
  while (at < text.size()) {
    if (in < pattern.size() && pattern[in] == '*') {
      star = in++;
      retry = at;
    } else if (in < pattern.size() && pattern[in] == text[at]) {
      ++in;
      ++at;
    } else if (star != pattern.npos) {
      in = star + 1;
      at = ++retry;
    } else {
      return false;
    }
  }
  return pattern.find_first_not_of('*', in) == pattern.npos;
}

bool passes(Name name, std::string_view filter) {
  const std::size_t equals = filter.find('=');
  if (equals == filter.npos)
    return std::any_of(
        std::begin(kColumns), std::end(kColumns), [&](const Column& column) {
          return column.text(name).find(filter) != std::string::npos;
        });
  const bool isNegative = equals > 0 && filter[equals - 1] == '!';
  const Column* column =
      findColumn(filter.substr(0, equals - (isNegative ? 1 : 0)));
  return fits(column->text(name), filter.substr(equals + 1)) != isNegative;
}

}  // namespace

std::vector<std::string> HX_NameColumns() {
  std::vector<std::string> names;
  for (const Column& column : kColumns) names.emplace_back(column.name);
  return names;
}

std::string HX_TailOf(const std::string& text, std::size_t width) {
  if (HX_WidthOf(text) <= width) return text;
  const KyCXString units = HX_FromUtf8(text);
  const int kept = std::max(0, static_cast<int>(width) - 3);
  return "..." + HX_ToUtf8(units.sub(units.length() - kept, units.length()));
}

std::vector<std::string> HX_RowOf(const HX_FormedName& name,
                                  const std::vector<std::string>& columns) {
  constexpr std::size_t kPathWidth = 40;
  std::vector<std::string> row;
  for (const std::string& column : columns) {
    std::string text = HX_Visible(findColumn(column)->text(name));
    // The end of a path tells more than its beginning.
    if (column == "source") text = HX_TailOf(text, kPathWidth);
    row.push_back(text.empty() ? "-" : text);
  }
  return row;
}

std::string HX_CheckFilter(const std::string& filter) {
  std::size_t equals = filter.find('=');
  if (equals == filter.npos) return {};
  if (equals > 0 && filter[equals - 1] == '!') --equals;
  const std::string name = filter.substr(0, equals);
  return findColumn(name) != nullptr ? std::string()
                                     : "unknown column " + HX_Quoted(name);
}

void HX_SelectNames(std::vector<const HX_FormedName*>& names,
                    const std::vector<std::string>& filters,
                    const std::string& sort) {
  std::erase_if(names, [&](const HX_FormedName* name) {
    return !std::all_of(
        filters.begin(), filters.end(),
        [&](const std::string& filter) { return passes(*name, filter); });
  });
  if (sort.empty()) return;
  const Column* column = findColumn(sort);
  std::vector<std::pair<std::string, const HX_FormedName*>> keys;
  for (const HX_FormedName* name : names)
    keys.emplace_back(column->text(*name), name);
  std::stable_sort(keys.begin(), keys.end(), [](const auto& a, const auto& b) {
    return HX_NaturalLess(a.first, b.first);
  });
  for (std::size_t i = 0; i < keys.size(); ++i) names[i] = keys[i].second;
}
