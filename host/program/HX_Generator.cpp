#include "host/program/HX_Generator.h"

#include <algorithm>

#include "host/base/HX_Text.h"
#include "host/model/HX_Document.h"
#include "host/names/HX_Ordering.h"
#include "host/write/HX_CWriter.h"
#include "platform/messages/HX_MessageHandler.h"

HX_Generator::HX_Generator(HX_Profile& timing, const std::string& file,
                           const std::string& keywordFolder)
    : profile(timing) {
  HX_MessageHandler::instance().setSink({});
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

void HX_Generator::run(const HX_NameRun::Progress& progress) {
  HX_MessageHandler::instance().clear();
  {
    const HX_Profile::Phase phase(profile, "Order types");
    result.types = HX_OrderTypes(*model);
    HX_TakeMessages(result.findings);
  }
  if (result.hasErrors()) return;

  spaces.emplace(*model, result.types);
  HX_TakeMessages(result.findings);
  {
    const HX_Profile::Phase phase(profile, "Form names");
    nameRun.emplace(*spaces).formAll(model->names, progress);
  }
  for (const HX_Name& name : model->names) result.names.push_back(&name);
  const HX_Profile::Phase phase(profile, "Order variables");
  result.variables = HX_OrderVariables(*model);
  HX_TakeMessages(result.findings);
  profile.note(std::to_string(result.names.size()) + " names, " +
               std::to_string(result.variables.size()) + " variables, " +
               std::to_string(result.types.size()) + " types");
}

std::size_t HX_Generator::write(HX_Output& output) {
  const HX_Profile::Phase phase(profile, "Write C");
  std::sort(result.names.begin(), result.names.end(),
            [](const HX_Name* a, const HX_Name* b) { return a->id < b->id; });
  HX_CWriter(*model, result).write(output);
  HX_WriteJson(output.open("name_map.json"), result);
  HX_WriteCsv(output.open("name_map.csv"), result);
  return output.finish();
}
