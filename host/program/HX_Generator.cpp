#include "host/program/HX_Generator.h"

#include <algorithm>

#include "host/base/HX_NameText.h"
#include "host/base/HX_Sha256.h"
#include "host/base/HX_Text.h"
#include "host/names/HX_Ordering.h"
#include "host/program/HX_Version.h"
#include "host/write/HX_CWriter.h"
#include "host/write/HX_NameMap.h"

namespace {

void sortById(std::vector<const HX_FormedName*>& names) {
  struct Key {
    std::uint64_t prefix;
    const HX_FormedName* name;
  };
  std::vector<Key> keys;
  keys.reserve(names.size());
  for (const HX_FormedName* name : names)
    keys.push_back({HX_PrefixOf(name->wanted->id), name});
  std::sort(keys.begin(), keys.end(), [](const Key& a, const Key& b) {
    if (a.prefix != b.prefix) return a.prefix < b.prefix;
    return a.name->wanted->id < b.name->wanted->id;
  });
  for (std::size_t i = 0; i < keys.size(); ++i) names[i] = keys[i].name;
}

}  // namespace

HX_Generator::HX_Generator(HX_Profile& timing, HX_Progress& shown,
                           HX_Document read,
                           const std::vector<std::string>& keywordFolders,
                           const HX_ReservedChoice& more)
    : profile(timing), progress(shown), document(std::move(read)) {
  const HX_Profile::Phase phase(profile, "Build model");
  std::vector<std::string> folders;
  for (const std::string& folder : keywordFolders)
    folders.push_back((profile.start / folder).lexically_normal().string());
  model.emplace(document, folders, progress, more);
  if (model->code.hasBanner) {
    const std::string version = HX_VersionText();
    banner = version.substr(0, version.find('\n')) + ", document SHA-256 " +
             HX_Sha256(document.text);
  }
  profile.setModel(HX_NameText(model->name).cstring());
}

void HX_Generator::run(HX_NameLock* lock) {
  {
    const HX_Profile::Phase phase(profile, "Order types");
    result.types = HX_OrderTypes(*model);
  }
  if (!model->typeCircle.items.empty()) {
    result.findings.back().source = model->typeCircle.place;
    return;
  }
  spaces.emplace(*model, result.types, lock);
  for (const HX_NameSpaces::ReservedUse& use : spaces->reservedUses())
    document.faults.add(
        use.place, HX_Quoted(use.name),
        (use.conflict.reason == HX_Change::ePattern ? "a name that is not "
                                                    : "a name that is no ") +
            use.conflict.text(),
        kHxReservedType);
  document.throwIfFaulty();
  std::string().swap(document.text);  // long, and not needed any more
  {
    const HX_Profile::Phase phase(profile, "Form names");
    result.formed = forming.emplace(*spaces).formAll(model->names, progress);
  }
  for (const HX_FormedName& name : result.formed) result.names.push_back(&name);
  if (!keepsSpaces) spaces.reset();
  const HX_Profile::Phase phase(profile, "Order variables");
  progress.begin("ordering variables");
  const std::size_t before = result.findings.size();
  result.variables = HX_OrderVariables(*model, result.formed);
  if (result.findings.size() > before)
    result.findings.back().source = model->variableCircle.place;
  progress.end();
  profile.note(std::to_string(result.names.size()) + " names, " +
               std::to_string(result.variables.size()) + " variables, " +
               std::to_string(result.types.size()) + " types");
}

std::size_t HX_Generator::write(HX_Output& output, bool asLines) {
  const HX_Profile::Phase phase(profile, "Write C");
  sortById(result.names);
  HX_CWriter(*model, result, banner, progress).write(output);
  HX_WriteNameMap(output.open(asLines ? "name_map.jsonl" : "name_map.json"),
                  output.open("name_map.csv"), *model, result, asLines,
                  progress);
  progress.end();
  return output.finish();
}
