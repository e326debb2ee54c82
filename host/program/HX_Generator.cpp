#include "host/program/HX_Generator.h"

#include <algorithm>

#include "host/base/HX_NameText.h"
#include "host/base/HX_Text.h"
#include "host/names/HX_Ordering.h"
#include "host/write/HX_CWriter.h"
#include "host/write/HX_NameMap.h"

HX_Generator::HX_Generator(HX_Profile& timing, HX_Document read,
                           const std::vector<std::string>& keywordFolders)
    : profile(timing), document(std::move(read)) {
  const HX_Profile::Phase phase(profile, "Build model");
  std::vector<std::string> folders;
  for (const std::string& folder : keywordFolders)
    folders.push_back((profile.start / folder).lexically_normal().string());
  model.emplace(document, folders);
  profile.setModel(HX_NameText(model->name).cstring());
}

void HX_Generator::run(const HX_NameForming::Progress& progress,
                       HX_NameLock* lock) {
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
    document.faults.add(use.place, HX_Quoted(use.name),
                        "a name that is no " + use.conflict.text(),
                        kHxReservedType);
  document.throwIfFaulty();
  document.text = {};
  {
    const HX_Profile::Phase phase(profile, "Form names");
    result.formed = forming.emplace(*spaces).formAll(model->names, progress);
  }
  for (const HX_FormedName& name : result.formed) result.names.push_back(&name);
  const HX_Profile::Phase phase(profile, "Order variables");
  const std::size_t before = result.findings.size();
  result.variables = HX_OrderVariables(*model, result.formed);
  if (result.findings.size() > before)
    result.findings.back().source = model->variableCircle.place;
  profile.note(std::to_string(result.names.size()) + " names, " +
               std::to_string(result.variables.size()) + " variables, " +
               std::to_string(result.types.size()) + " types");
}

std::size_t HX_Generator::write(HX_Output& output) {
  const HX_Profile::Phase phase(profile, "Write C");
  std::sort(result.names.begin(), result.names.end(),
            [](const HX_FormedName* a, const HX_FormedName* b) {
              return a->wanted->id < b->wanted->id;
            });
  HX_CWriter(*model, result).write(output);
  HX_WriteJson(output.open("name_map.json"), result);
  HX_WriteCsv(output.open("name_map.csv"), result);
  return output.finish();
}
