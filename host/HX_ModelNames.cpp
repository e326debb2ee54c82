// The names of a model, and what each is for.
#include "Naming/HxCNames.h"
#include "host/HX_ModelReader.h"
#include "host/HX_Text.h"

namespace {

const std::map<std::string, unsigned int> kMacroBits = {
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

const std::map<std::string, int> kSubstitutionKinds = {
    {"exact", HxCNames::eMacroKindExact},
    {"any", HxCNames::eMacroKindAnyCase},
    {"selects", HxCNames::eMacroKindCaseSelectsValue},
};

const std::map<std::string, int> kSymbolKinds = {
    {"variable", HxCSymbol::eVariable},
    {"constant", HxCSymbol::eConstant},
    {"function", HxCSymbol::eFunction},
};

unsigned int macroBits(const HX_Json& macros) {
  unsigned int bits = 0;
  for (const HX_Json& macro : macros) bits |= kMacroBits.at(macro);
  return bits;
}

// 1 for what is no array; elements of nested arrays are counted in all.
std::size_t elementCount(const HX_TypeItem* type) {
  std::size_t count = 1;
  if (type->scalar() == nullptr) return count;
  for (; type != nullptr; type = type->of) {
    if (type->kind == "array") count *= static_cast<std::size_t>(type->length);
  }
  return count;
}

}  // namespace

void HX_ModelReader::readNames(HX_Json& names) {
  for (Json node : names) {
    HX_Name& name = m_Model.names.emplace_back();
    name.id = node["id"];
    name.kind = node.value("kind", "object");
    m_Names.enter(node, &name);
  }
  // Names refer to tasks and variables that may stand after them.
  std::size_t index = 0;
  for (HX_Json& node : names) {
    readName(node, m_Model.names[index++]);
    node = nullptr;
  }
}

void HX_ModelReader::readName(Json node, HX_Name& name) {
  name.nameTemplate = node["template"];
  name.source = m_Sources.findIn(node, "source");
  name.dd = m_Sources.findIn(node, "dd");
  if (name.dd != nullptr && name.dd->isDd() == nullptr)
    m_Document.fail(node["dd"], "the id of a dictionary object");
  name.sources.addSrcRef(name.source);
  name.sources.addSrcRef(name.dd);
  for (Json id : HX_FieldOf(node, "alsoFrom"))
    name.sources.addSrcRef(m_Sources.find(id));
  if (node.contains("ivBlock")) name.ivBlock = node["ivBlock"];
  name.label = node.value("label", "");
  name.x = node.value("x", "");
  name.type = m_Types.findIn(node, "type");
  name.scope = m_Scopes.findIn(node, "scope");
  if (name.scope == nullptr) name.scope = m_FileScope;
  if (name.isFunction() && name.scope->kind != "file")
    m_Document.fail(node["scope"], "the id of a file scope for a function");
  name.retained = macroBits(HX_FieldOf(node, "retained"));
  name.provisional = macroBits(HX_FieldOf(node, "provisional"));
  name.modelContext = node.value("modelContext", false);
  for (Json entry : HX_FieldOf(node, "substitute"))
    name.substitutions.push_back(
        {entry["macro"], entry["value"],
         kSubstitutionKinds.at(entry.value("case", "exact"))});
  if (node.contains("symbol")) readSymbol(node["symbol"], name);
  readMultirate(node, name);
  if (name.kind == "variable") readVariable(node, name);
}

void HX_ModelReader::readSymbol(Json node, HX_Name& name) {
  HX_TypeItem* type = m_Types.findIn(node, "type");
  name.symbol = std::make_unique<HxCSymbol>(
      HX_FromUtf8(node["name"]), kSymbolKinds.at(node["kind"]),
      type != nullptr ? &type->type : nullptr);
  name.symbol->setDollarX(HX_Utf8ToLatin1(node.value("x", "")).c_str());
}

void HX_ModelReader::readMultirate(Json node, HX_Name& name) {
  name.task = m_Names.findIn(node, "task");
  name.isr = m_Names.findIn(node, "isr");
  for (const auto& [kind, named] :
       {std::make_pair("task", name.task), std::make_pair("isr", name.isr)}) {
    if (named != nullptr && (named->kind != kind || named == &name))
      m_Document.fail(node[kind],
                      std::string("the id of another name of kind ") + kind);
  }
  for (const char* field :
       {"event", "counter", "message", "messageVariable", "osObject"}) {
    if (node.contains(field)) name.osTexts[field] = node[field];
  }
  name.period = node.value("period", 0.0);
  name.offset = node.value("offset", 0.0);
  name.cyclic = node.value("cyclic", true);
}

void HX_ModelReader::readVariable(Json node, HX_Name& name) {
  findNamedType(node["type"]);
  if (name.scope->kind == "flat")
    m_Document.fail(node["scope"], "the id of a scope that is not flat");
  for (Json id : HX_FieldOf(node, "dependsOn")) {
    name.dependsOn.push_back(m_Names.find(id));
    if (name.dependsOn.back()->kind != "variable")
      m_Document.fail(id, "the id of a variable");
  }
  name.lsb = node.value("lsb", 1.0);
  name.zero = node.value("zero", 0.0);
  if (!node.contains("initial")) return;

  Json initial = node["initial"];
  const HX_TypeItem* scalar = name.type->scalar();
  if (scalar != nullptr && !scalar->numerical)
    m_Document.fail(initial,
                    "no initial value for a structure or an enumeration");
  if (initial.is_array())
    name.initial = initial.get<std::vector<double>>();
  else
    name.initial = {initial.get<double>()};
  const std::size_t room = elementCount(name.type);
  if (name.initial.size() > room || name.initial.empty())
    m_Document.fail(initial, "1 to " + std::to_string(room) + " values");
}
