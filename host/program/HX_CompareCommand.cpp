// hx_codegen diff: two sets of names, each a document, a lock or a name map.
#include <iostream>
#include <nlohmann/json.hpp>

#include "SafeNames/HX_NameDiff.h"
#include "host/base/HX_Text.h"
#include "host/program/HX_Commands.h"
#include "host/program/HX_Generator.h"
#include "host/program/HX_ImportCommands.h"
#include "host/program/HX_LockFile.h"

namespace {

using Json = nlohmann::json;
using nlohmann::ordered_json;

constexpr const char* kChanges[] = {"kept", "added", "removed", "renamed"};

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
    const auto texts = name.find("changes");
    if (texts != name.end() && texts->is_array())
      for (const Json& text : *texts)
        if (text.is_string())
          changes += (changes.empty() ? "" : ", ") + text.get<std::string>();
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
                         HX_ReadDocument(file, arguments, profile), folders);
  generator.run(nullptr);
  for (const HX_FormedName* name : generator.result.names)
    add(diff, side,
        {name->wanted->id,
         HX_ToUtf8(name->actual),
         {},
         *name->wanted->nameTemplate->shown,
         name->sourcePath(),
         HX_JoinedChanges(*name, ", ")});
}

void addFile(HX_NameDiff& diff, HX_NameDiff::HxESideTag side,
             const std::string& file, const HX_Arguments& arguments) {
  const std::string text =
      HX_ReadWholeFile(file, std::filesystem::current_path() / file);
  if (text.find("hx_names_lock") <= 3 || text.rfind("<<<<<<<", 0) == 0)
    return addLock(diff, side, file, text);
  const Json root = Json::parse(text, nullptr, false);
  const bool isMap = root.is_object() && !root.contains("model") &&
                     root.contains("names") && root["names"].is_array();
  if (isMap) return addMap(diff, side, root["names"]);
  addDocument(diff, side, file, arguments);
}

std::string reasonOf(const HX_NameDiff::Row& row) {
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

void writeTable(const HX_NameDiff& diff) {
  for (int i = 0; i < diff.rowCount(); ++i) {
    const HX_NameDiff::Row& row = diff.row(i);
    if (row.change == HX_NameDiff::eKept) continue;
    const bool isGone = row.change == HX_NameDiff::eRemoved;
    const std::string reason = reasonOf(row);
    std::cout << kChanges[row.change] << "  "
              << (isGone ? row.before.item : row.after.item) << "  "
              << row.before.name
              << (row.change == HX_NameDiff::eRenamed ? " -> " : "")
              << row.after.name << (reason.empty() ? "" : "  (" + reason + ")")
              << '\n';
  }
  const char* separator = "";
  for (const auto change : {HX_NameDiff::eKept, HX_NameDiff::eAdded,
                            HX_NameDiff::eRemoved, HX_NameDiff::eRenamed}) {
    std::cout << separator << diff.count(change) << ' ' << kChanges[change];
    separator = ", ";
  }
  std::cout << '\n';
}

void writeJson(const HX_NameDiff& diff) {
  ordered_json rows = ordered_json::array();
  for (int i = 0; i < diff.rowCount(); ++i) {
    const HX_NameDiff::Row& row = diff.row(i);
    ordered_json entry{
        {"change", kChanges[row.change]},
        {"id", row.before.item.empty() ? row.after.item : row.before.item}};
    if (row.change != HX_NameDiff::eAdded) entry["old"] = row.before.name;
    if (row.change != HX_NameDiff::eRemoved) entry["new"] = row.after.name;
    const std::string reason = reasonOf(row);
    if (!reason.empty()) entry["reason"] = reason;
    rows.push_back(entry);
  }
  std::cout << ordered_json{{"names", rows}}.dump(2) << '\n';
}

// A script for sed. Names are C identifiers, so nothing needs an escape.
void writeSubstitutions(const HX_NameDiff& diff) {
  for (int i = 0; i < diff.ambiguousCount(); ++i)
    std::cout << "# " << diff.ambiguous(i)
              << ": several new names, depending on the scope\n";
  for (int i = 0; i < diff.substitutionCount(); ++i)
    std::cout << "s/\\b" << diff.substitution(i).from << "\\b/"
              << diff.substitution(i).to << "/g\n";
}

}  // namespace

HX_ExitCode HX_CompareNames(const HX_Arguments& arguments) {
  HX_NameDiff diff;
  addFile(diff, HX_NameDiff::eOld, arguments.older, arguments);
  addFile(diff, HX_NameDiff::eNew, arguments.model, arguments);
  if (!diff.compare()) throw std::bad_alloc();
  if (arguments.format == "json")
    writeJson(diff);
  else if (arguments.format == "sed")
    writeSubstitutions(diff);
  else
    writeTable(diff);
  return kHxDone;
}
