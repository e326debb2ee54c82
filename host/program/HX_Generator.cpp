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

void HX_Generator::run(HX_NameLock* lock, const std::string& path,
                       const std::string& watched) {
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
    forming.emplace(*spaces).watch(watched);
    result.formed = forming->formAll(model->names, choose(path), progress);
  }
  for (const HX_FormedName& name : result.formed) {
    if (component < 0 || m_ComponentOf[name.wanted->index] == component)
      result.names.push_back(&name);
  }
  if (!keepsSpaces) spaces.reset();
  const HX_Profile::Phase phase(profile, "Order variables");
  progress.begin("ordering variables");
  const std::size_t before = result.findings.size();
  result.variables =
      component < 0 ? HX_OrderVariables(*model, result.formed)
                    : HX_OrderVariables(result.names, result.formed.size());
  if (result.findings.size() > before)
    result.findings.back().source = model->variableCircle.place;
  progress.end();
  profile.note(std::to_string(result.names.size()) + " names, " +
               std::to_string(result.variables.size()) + " variables, " +
               std::to_string(result.types.size()) + " types");
}

void HX_Generator::splitIntoComponents() {
  if (components) return;
  components.emplace(*model);
  m_ComponentOf.reserve(model->names.size());
  for (const HX_WantedName& name : model->names)
    m_ComponentOf.push_back(components->of(name));
}

// The names of a component, and the tasks: further names contain their names.
std::vector<bool> HX_Generator::choose(const std::string& path) {
  if (path.empty()) return {};
  splitIntoComponents();
  component = components->find(path);
  if (component < 0) {
    std::string known;
    for (const auto& each : components->all())
      known += (known.empty() ? "" : ", ") + HX_Quoted(each.path);
    throw HX_InputError(
        HX_MessageText(kHxUnknownComponent,
                       {HX_Visible(document.file), HX_Quoted(path), known}),
        kHxUnknownComponent);
  }
  std::vector<bool> chosen;
  chosen.reserve(model->names.size());
  for (const HX_WantedName& name : model->names)
    chosen.push_back(name.isTask() || m_ComponentOf[name.index] == component);
  return chosen;
}

HX_RunResult HX_Generator::resultOf(int index) {
  HX_RunResult part;
  part.types = result.types;
  for (const HX_FormedName* name : result.names) {
    if (m_ComponentOf[name->wanted->index] == index) part.names.push_back(name);
  }
  part.variables = HX_OrderVariables(part.names, result.formed.size());
  return part;
}

void HX_Generator::write(int index, HX_FileSink& output) {
  const HX_Profile::Phase phase(profile, "Write C");
  if (index < 0) {
    sortById(result.names);
    writeCode(output);
    writeNameMap(output, result);
    return progress.end();
  }
  HX_RunResult part = resultOf(index);
  sortById(part.names);
  const HX_CFiles& files =
      components->all()[static_cast<std::size_t>(index)].files;
  HX_CWriter writer(*model, part, files, banner, progress);
  if (index == 0) writer.writeTypes(output);
  writer.writeCode(output);
  part.codeFile = files.code;
  writeNameMap(output, part);
  result.findings.insert(result.findings.end(), part.findings.begin(),
                         part.findings.end());
  progress.end();
}

void HX_Generator::writeNameMap(HX_FileSink& output, const HX_RunResult& part) {
  HX_WriteNameMap(output.open(asLines ? "name_map.jsonl" : "name_map.json"),
                  output.open("name_map.csv"), *model, part, asLines, progress);
}

void HX_Generator::writeCode(HX_FileSink& output) {
  HX_CWriter writer(*model, result, HX_CFiles::ofModel(), banner, progress);
  writer.writeTypes(output);
  writer.writeCode(output);
}
