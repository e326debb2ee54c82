#include "host/HX_Generator.h"

#include <algorithm>

#include "host/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

// Reading and building are phases of the run as well.
HX_Model build(const HX_Document& document, HX_Profile& profile) {
  const HX_Profile::Phase phase(profile, "Build model");
  return HX_Model(document.root());
}

}  // namespace

HX_Generator::HX_Generator(const HX_Document& document,
                           const std::filesystem::path& keywordFolder,
                           HX_Profile& profile)
    : m_Profile(profile), m_Model(build(document, profile)) {
  profile.setModel(HX_Utf8ToLatin1(m_Model.name()));
  HX_MessageHandler::instance().setSink({});
  HX_MessageHandler::instance().clear();
  loadKeywords(document, keywordFolder);
}

HX_Generator::~HX_Generator() = default;

void HX_Generator::loadKeywords(const HX_Document& document,
                                const std::filesystem::path& folder) {
  const HX_DocumentNode root = document.root();
  if (!root.has("options")) return;
  root.at("options").forEach("keywords", [&](const HX_DocumentNode& list) {
    if (!m_Keywords.loadList(folder.string(), list.value()))
      list.fail("the name of a word list in " + folder.string() + ", found " +
                list.value().dump());
  });
}

HX_RunResult& HX_Generator::run(Order order,
                                const HX_NameRun::Progress& progress) {
  {
    const HX_Profile::Phase phase(m_Profile, "Order types");
    HX_OrderTypes(m_Model, m_Result.types);
    takeMessages();
  }
  if (m_Result.hasErrors()) return m_Result;

  m_Spaces = std::make_unique<HX_NameSpaces>(m_Model.scopes(), m_Keywords);
  enterTypeNames();
  m_NameRun = std::make_unique<HX_NameRun>(m_Model, *m_Spaces);
  {
    const HX_Profile::Phase phase(m_Profile, "Form names");
    m_Result.names = m_NameRun->formAll(progress);
  }
  if (order == eById)
    std::sort(m_Result.names.begin(), m_Result.names.end(),
              [](const HX_FormedName& a, const HX_FormedName& b) {
                return a.item->id < b.item->id;
              });
  const HX_Profile::Phase phase(m_Profile, "Order variables");
  HX_OrderVariables(m_Result.names, m_Result.variables);
  takeMessages();
  m_Profile.note(std::to_string(m_Result.names.size()) + " names, " +
                 std::to_string(m_Result.variables.size()) + " variables, " +
                 std::to_string(m_Result.types.size()) + " types");
  return m_Result;
}

// The names of types are not formed but given; each is checked before it
// becomes a reserved word itself.
void HX_Generator::enterTypeNames() {
  HxCNames names;
  for (const HX_TypeItem* type : m_Result.types) {
    for (const auto& [field, fieldType] : type->fields)
      names.isStringValidCVariableName(field.c_str());
    for (const auto& [constant, value] : type->values) {
      names.isStringValidCVariableName(constant.c_str());
      m_Spaces->takeInFiles(constant);
    }
    if (!type->isNameless) names.isStringValidCVariableName(type->name.c_str());
  }
  takeMessages();
  for (const HX_TypeItem* type : m_Result.types) {
    if (!type->isNameless)
      m_Keywords.add(type->name, type->kind == "base"
                                     ? HxCNames::eDictBaseTypeName
                                     : HxCNames::eDictUserTypeName);
  }
}

void HX_Generator::takeMessages() {
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  for (const HX_Message& message : handler.messages())
    m_Result.findings.push_back({message.id, message.severity,
                                 HX_Latin1ToUtf8(message.text),
                                 HX_Latin1ToUtf8(message.source)});
  handler.clear();
}

const HX_FormedName* HX_Generator::find(const std::string& id) const {
  for (const HX_FormedName& name : m_Result.names) {
    if (name.item->id == id) return &name;
  }
  return nullptr;
}

std::vector<HX_ExplainedMacro> HX_Generator::explain(
    const HX_FormedName& name) {
  return m_NameRun->explain(*name.item);
}
