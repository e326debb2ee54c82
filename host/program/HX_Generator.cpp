#include "host/program/HX_Generator.h"

#include <algorithm>

#include "host/base/HX_Text.h"
#include "host/model/HX_Document.h"
#include "host/names/HX_Ordering.h"
#include "host/write/HX_CWriter.h"
#include "host/write/HX_NameMap.h"

HX_Generator::HX_Generator(HX_Profile& timing, const std::string& file,
                           const std::string& keywordFolder)
    : profile(timing) {
  std::optional<HX_Document> document;
  {
    const HX_Profile::Phase phase(profile, "Read document");
    document.emplace(file, profile.start);
  }
  {
    const HX_Profile::Phase phase(profile, "Build model");
    model.emplace(*document,
                  (profile.start / keywordFolder).lexically_normal());
  }
  profile.setModel(HX_Utf8ToLatin1(model->name));
}

void HX_Generator::run(const HX_NameForming::Progress& progress) {
  {
    const HX_Profile::Phase phase(profile, "Order types");
    result.types = HX_OrderTypes(*model);
  }
  if (result.hasErrors()) return;

  spaces.emplace(*model, result.types);
  {
    const HX_Profile::Phase phase(profile, "Form names");
    result.formed = forming.emplace(*spaces).formAll(model->names, progress);
  }
  for (const HX_FormedName& name : result.formed) result.names.push_back(&name);
  const HX_Profile::Phase phase(profile, "Order variables");
  result.variables = HX_OrderVariables(result.formed);
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
