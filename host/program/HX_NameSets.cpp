#include "host/program/HX_NameSets.h"

#include <filesystem>
#include <new>
#include <nlohmann/json.hpp>

#include "host/base/HX_Text.h"
#include "host/program/HX_Generator.h"
#include "host/program/HX_ImportCommands.h"
#include "host/program/HX_LockFile.h"

namespace {

using Json = nlohmann::json;

void add(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
         const HX_NameDiff::Record& record) {
  if (!diff.add(side, record)) throw std::bad_alloc();
}

void addLock(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
             const std::string& file, const std::string& text) {
  HX_NameLock lock;
  HX_ReadLock(lock, file, text);
  for (int at = 0; at < lock.size(); ++at) {
    const HX_NameLock::Entry& entry = lock.entry(at);
    if (entry.retiredRuns < 0)
      add(diff, side, {entry.item, entry.name, entry.wanted, {}, {}, {}});
  }
}

// Empty for a field that is missing or no text.
std::string textOf(const Json& node, const char* field) {
  const auto found = node.find(field);
  return found != node.end() && found->is_string() ? found->get<std::string>()
                                                   : std::string();
}

void addMap(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
            const Json& names) {
  for (const Json& name : names) {
    std::string changes;
    const auto texts = name.find("reasons");
    if (texts != name.end() && texts->is_array())
      for (const Json& text : *texts)
        changes += (changes.empty() ? "" : ", ") + textOf(text, "text");
    add(diff, side,
        {textOf(name, "id"),
         textOf(name, "actual"),
         {},
         textOf(name, "template"),
         textOf(name, "source"),
         changes});
  }
}

void addDocument(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
                 const std::string& file, const HX_Arguments& arguments) {
  HX_Profile profile("");
  std::vector<std::string> folders{arguments.keywords};
  folders.insert(folders.end(), arguments.ownKeywords.begin(),
                 arguments.ownKeywords.end());
  HX_Progress silent(false);
  HX_Generator generator(profile, silent,
                         HX_ReadDocument(file, arguments, profile), folders,
                         {arguments.reserved, arguments.patterns});
  generator.run(nullptr, "");
  HX_AddFormedNames(diff, side, generator.result);
}

}  // namespace

void HX_AddFormedNames(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
                       const HX_RunResult& result) {
  for (const HX_FormedName* name : result.names)
    add(diff, side,
        {name->wanted->id,
         HX_ToUtf8(name->actual),
         {},
         *name->wanted->nameTemplate->shown,
         name->sourcePath(),
         HX_JoinedChanges(*name, ", ")});
}

void HX_AddNames(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
                 const std::string& file, const HX_Arguments& arguments) {
  const std::string text =
      HX_ReadWholeFile(file, std::filesystem::current_path() / file);
  if (text.find("hx_names_lock") <= 3 || text.rfind("<<<<<<<", 0) == 0)
    return addLock(diff, side, file, text);
  const Json root = Json::parse(text, nullptr, false);
  const bool isMap = root.is_object() && root.contains("nameMap") &&
                     root.contains("names") && root["names"].is_array();
  if (isMap) return addMap(diff, side, root["names"]);
  addDocument(diff, side, file, arguments);
}

std::string HX_ReasonOf(const HX_NameDiff::Row& row) {
  const auto from = [](std::string_view before, std::string_view after) {
    return std::string(before) + " -> " + std::string(after);
  };
  switch (row.reason) {
    case HX_NameDiff::eTemplate:
      return "template " +
             from(row.before.nameTemplate, row.after.nameTemplate);
    case HX_NameDiff::ePlace:
      return "block " + from(row.before.place, row.after.place);
    case HX_NameDiff::eWanted:
      return "wanted " + from(row.before.wanted, row.after.wanted);
    case HX_NameDiff::eChanges:
      return std::string(row.after.changes);
    case HX_NameDiff::eUnchanged:
      return "no longer " + std::string(row.before.changes);
    case HX_NameDiff::eNoReason:
      break;
  }
  return {};
}
