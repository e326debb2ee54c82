// The names of a model, and what each is for.
#include "Naming/HxCNames.h"
#include "host/HX_Model.h"
#include "host/HX_ModelIds.h"
#include "host/HX_Text.h"

namespace {

constexpr Choice<unsigned int> kMacroBits[] = {
    {"$L", HxCNames::eMacroLabel},
    {"$B", HxCNames::eMacroBlockName},
    {"$S", HxCNames::eMacroSystemNumber},
    {"$I", HxCNames::eMacroSystemId},
    {"$M", HxCNames::eMacroModelName},
    {"$N", HxCNames::eMacroSubsystemName},
    {"$H", HxCNames::eMacroStateHierarchy},
    {"$O", HxCNames::eMacroSFObjectName},
    {"$C", HxCNames::eMacroSFObjectId},
    {"$D", HxCNames::eMacroDdObjectName},
    {"$T", HxCNames::eMacroTypeName},
    {"$X", HxCNames::eMacroXName},
    {"$R", HxCNames::eMacroChangeable},
    {"$(Type)", HxCNames::eMacroLongTypeName},
};

constexpr Choice<int> kSubstitutionKinds[] = {
    {"exact", HxCNames::eMacroKindExact},
    {"any", HxCNames::eMacroKindAnyCase},
    {"selects", HxCNames::eMacroKindCaseSelectsValue},
};

constexpr Choice<int> kSymbolKinds[] = {
    {"variable", HxCSymbol::eVariable},
    {"constant", HxCSymbol::eConstant},
    {"function", HxCSymbol::eFunction},
};

unsigned int macroBits(const HX_DocumentNode& node, const char* field) {
  unsigned int bits = 0;
  node.forEach(field, [&](const HX_DocumentNode& macro) {
    bits |= valueOf(kMacroBits, macro.value());
  });
  return bits;
}

constexpr char kSource[] = "a block, a chart object or a dictionary object";

}  // namespace

void HX_Model::readNames(const HX_DocumentNode& root) {
  root.forEach("names", [&](const HX_DocumentNode& node) {
    m_Names.push_back(std::make_unique<HX_NameItem>());
    HX_NameItem& item = *m_Names.back();
    item.id = node.text("id");
    item.kind = node.text("kind", "object");
    enter(node, m_NamesById, &item);
  });
  // Names refer to tasks and variables that may stand after them.
  std::size_t index = 0;
  root.forEach("names", [&](const HX_DocumentNode& node) {
    readName(node, *m_Names[index++]);
  });
}

void HX_Model::readName(const HX_DocumentNode& node, HX_NameItem& item) {
  item.nameTemplate = node.text("template");
  item.source = findIn(node, "source", m_SourcesById, kSource);
  item.dd = findIn(node, "dd", m_SourcesById, kSource);
  if (item.dd != nullptr && item.dd->isDd() == nullptr)
    node.at("dd").fail("the id of a dictionary object");
  node.forEach("alsoFrom", [&](const HX_DocumentNode& id) {
    item.alsoFrom.push_back(find(id, m_SourcesById, kSource));
  });
  if (node.has("ivBlock")) item.ivBlock = node.text("ivBlock");
  item.label = node.text("label");
  item.x = node.text("x");
  item.type = findIn(node, "type", m_TypesById, "a type");
  item.scope = node.has("scope")
                   ? find(node.at("scope"), m_ScopesById, "a scope")
                   : m_DefaultScope;
  const bool isGlobal = item.isTask() || item.kind == "function";
  if (isGlobal && item.scope->kind != "file")
    node.at("scope").fail("the id of a file scope for a function");
  item.retained = macroBits(node, "retained");
  item.provisional = macroBits(node, "provisional");
  item.modelContext = node.flag("modelContext", false);
  node.forEach("substitute", [&](const HX_DocumentNode& entry) {
    item.substitutions.push_back(
        {entry.text("macro"), entry.text("value"),
         valueOf(kSubstitutionKinds, entry.text("case", "exact"))});
  });
  if (node.has("symbol")) readSymbol(node.at("symbol"), item);
  readMultirate(node, item);
  if (item.kind == "variable") readVariable(node, item);
}

void HX_Model::readSymbol(const HX_DocumentNode& node, HX_NameItem& item) {
  HX_TypeItem* type = findIn(node, "type", m_TypesById, "a type");
  item.symbol = std::make_unique<HxCSymbol>(
      HX_FromUtf8(node.text("name")), valueOf(kSymbolKinds, node.text("kind")),
      type != nullptr ? &type->type : nullptr);
  item.symbol->setDollarX(HX_Utf8ToLatin1(node.text("x")).c_str());
}

void HX_Model::readMultirate(const HX_DocumentNode& node, HX_NameItem& item) {
  for (const char* field : {"task", "isr"}) {
    if (!node.has(field)) continue;
    const HX_NameItem* named = find(node.at(field), m_NamesById, "a name");
    if (named->kind != field || named == &item)
      node.at(field).fail(std::string("the id of another name of kind ") +
                          field);
    (std::string(field) == "task" ? item.task : item.isr) = named;
  }
  for (const char* field :
       {"event", "counter", "message", "messageVariable", "osObject"}) {
    if (node.has(field)) item.osTexts[field] = node.text(field);
  }
  item.period = node.number("period", 0);
  item.offset = node.number("offset", 0);
  item.cyclic = node.flag("cyclic", true);
}

void HX_Model::readVariable(const HX_DocumentNode& node, HX_NameItem& item) {
  findNamedType(node.at("type"));
  if (item.scope->kind == "flat")
    node.at("scope").fail("the id of a scope that is not flat");
  node.forEach("dependsOn", [&](const HX_DocumentNode& id) {
    const HX_NameItem* other = find(id, m_NamesById, "a name");
    if (other->kind != "variable") id.fail("the id of a variable");
    item.dependsOn.push_back(other);
  });
  item.lsb = node.number("lsb", 1);
  item.zero = node.number("zero", 0);
  if (!node.has("initial")) return;

  const HX_DocumentNode initial = node.at("initial");
  const HX_TypeItem* scalar = item.type->scalar();
  if (scalar != nullptr && !scalar->numerical)
    initial.fail("no initial value for a structure or an enumeration");
  if (initial.value().is_array())
    item.initial = initial.value().get<std::vector<double>>();
  else
    item.initial = {initial.value().get<double>()};
  const auto room = item.type->elementCount();
  if (item.initial.size() > room || item.initial.empty())
    initial.fail("1 to " + std::to_string(room) + " values");
}
