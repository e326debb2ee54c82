#include "host/model/HX_Model.h"

#include <fstream>
#include <optional>
#include <string_view>

#include "Naming/HX_MacroTable.h"
#include "Naming/HxCNames.h"
#include "host/base/HX_Text.h"
#include "host/model/HX_ModelReaders.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/model/HxCGlobal.h"

namespace {

using Json = const HX_Json&;

constexpr HX_Word<HxCNames::tagMacroKindEnum> kSubstitutionKinds[] = {
    {"exact", HxCNames::eMacroKindExact},
    {"any", HxCNames::eMacroKindAnyCase},
    {"selects", HxCNames::eMacroKindCaseSelectsValue},
};

constexpr HX_Word<int> kSymbolKinds[] = {
    {"variable", HxCSymbol::eVariable},
    {"constant", HxCSymbol::eConstant},
    {"function", HxCSymbol::eFunction},
};

// The kind of scope that a kind of scope may stand in; no value means the
// document itself. A block may also stand in a block.
const std::map<HX_ScopeKind, std::optional<HX_ScopeKind>> kParents = {
    {HX_ScopeKind::eFile, {}},
    {HX_ScopeKind::eFlat, {}},
    {HX_ScopeKind::eFunction, HX_ScopeKind::eFile},
    {HX_ScopeKind::eBlock, HX_ScopeKind::eFunction}};

KyCXString textIn(const HX_Json& node, const char* field) {
  return HX_FromUtf8(node.value(field, ""));
}

std::optional<KyCXString> optionalTextIn(const HX_Json& node,
                                         const char* field) {
  if (!node.contains(field)) return {};
  return HX_FromUtf8(node[field]);
}

// The schema admits macros with a bit only.
unsigned int macroBits(const HX_Json& macros) {
  unsigned int bits = 0;
  for (const HX_Json& macro : macros)
    bits |= HX_FindMacro(HX_FromUtf8(macro))->bit;
  return bits;
}

// 1 for what is no array; elements of nested arrays are counted in all.
std::size_t elementCount(const HX_TypeItem* type) {
  std::size_t count = 1;
  if (type->scalar() == nullptr) return count;
  for (; type != nullptr; type = type->of) {
    if (type->kind == HX_TypeKind::eArray)
      count *= static_cast<std::size_t>(type->length);
  }
  return count;
}

class Reader {
 public:
  Reader(HX_Document& document, HX_Model& model)
      : m_Document(document), m_Model(model) {}

  void read(const std::string& keywordFolder) {
    HX_Json& root = m_Document.root;
    readModel(root["model"]);
    readOptions(HX_FieldOrEmpty(root, "options"), keywordFolder);
    HX_ReadSources(root, m_Model, m_Sources);
    root.erase("blocks");
    HX_ReadTypes(HX_FieldOrEmpty(root, "types"), m_Model, m_Types);
    // Scopes refer to functions, and names to scopes and other names.
    for (Json name : root["names"]) enterName(name);
    for (Json scope : HX_FieldOrEmpty(root, "scopes"))
      readScope(scope, nullptr);
    if (m_Model.fileScope == nullptr) {
      m_Model.fileScope = &m_Model.scopes.emplace_back();
      m_Model.fileScope->id = "file";
    }
    readNames(root["names"]);
  }

 private:
  void readModel(Json model) {
    m_Model.name = model["name"];
    GLB_SetModelName(HX_FromUtf8(m_Model.name));
    GLB_SetSubsystemName(HX_FromUtf8(model.value("subsystem", "")));
    m_Model.options.setHxSystemID(HX_FromUtf8(model.value("systemId", "")));
  }

  // One word on a line; lines that begin with '#' are comments.
  void readOptions(Json options, const std::string& keywordFolder) {
    m_Model.options.setLimitVariableNameLength(
        options.value("limitNames", false));
    for (Json list : HX_FieldOrEmpty(options, "keywords")) {
      std::ifstream file(keywordFolder + "/" + list.get<std::string>() +
                         ".txt");
      if (!file)
        m_Document.fail(list, "the name of a word list in " + keywordFolder +
                                  ", found " + list.dump());
      for (std::string line; std::getline(file, line);) {
        if (!line.empty() && line[0] != '#') m_Model.words.insert(line);
      }
    }
  }

  void readScope(Json node, HX_ScopeItem* parent) {
    HX_ScopeItem& scope = m_Model.scopes.emplace_back();
    scope.id = node["id"];
    scope.kind =
        HX_ValueOf(kHxScopeKinds, node["kind"].get_ref<const std::string&>());
    scope.parent = parent;
    m_Scopes.enter(node, &scope);
    checkParent(node, scope);
    if (scope.kind == HX_ScopeKind::eBlock) parent->blocks[scope.id] = &scope;
    if (scope.kind == HX_ScopeKind::eFile) {
      if (m_Model.fileScope != nullptr)
        m_Document.fail(node["kind"], "one file scope");
      m_Model.fileScope = &scope;
    }
    if (scope.kind == HX_ScopeKind::eFunction)
      readFunction(node["function"], scope);
    for (Json inner : HX_FieldOrEmpty(node, "scopes")) readScope(inner, &scope);
  }

  void checkParent(Json node, const HX_ScopeItem& scope) {
    const std::optional<HX_ScopeKind> wanted = kParents.at(scope.kind);
    std::optional<HX_ScopeKind> found;
    if (scope.parent != nullptr) found = scope.parent->kind;
    const bool isBlockInBlock =
        scope.kind == HX_ScopeKind::eBlock && found == HX_ScopeKind::eBlock;
    if (found == wanted || isBlockInBlock) return;
    m_Document.fail(node["kind"],
                    "a scope of this kind only in " +
                        std::string(wanted ? HX_WordOf(kHxScopeKinds, *wanted)
                                           : std::string_view("the document")));
  }

  // The function that a scope is the body of.
  void readFunction(Json id, const HX_ScopeItem& scope) {
    HX_WantedName* function = m_Names.find(id);
    if (!function->isFunction() || function->body != nullptr)
      m_Document.fail(
          id, "the id of a function, task or isr without another scope");
    function->body = &scope;
  }

  void enterName(Json node) {
    HX_WantedName& name = m_Model.names.emplace_back();
    name.id = node["id"];
    if (node.contains("kind"))
      name.kind =
          HX_ValueOf(kHxNameKinds, node["kind"].get_ref<const std::string&>());
    m_Names.enter(node, &name);
  }

  void readNames(HX_Json& names) {
    std::size_t index = 0;
    for (HX_Json& node : names) {
      readName(node, m_Model.names[index++]);
      node = nullptr;
    }
  }

  void readName(Json node, HX_WantedName& name) {
    name.nameTemplate = HX_FromUtf8(node["template"]);
    name.source = m_Sources.findIn(node, "source");
    name.dd = m_Sources.findIn(node, "dd");
    if (name.dd != nullptr && name.dd->isDd() == nullptr)
      m_Document.fail(node["dd"], "the id of a dictionary object");
    name.sources.addSrcRef(name.source);
    name.sources.addSrcRef(name.dd);
    for (Json id : HX_FieldOrEmpty(node, "alsoFrom"))
      name.sources.addSrcRef(m_Sources.find(id));
    name.ivBlock = optionalTextIn(node, "ivBlock");
    name.label = textIn(node, "label");
    name.x = textIn(node, "x");
    name.type = m_Types.findIn(node, "type");
    name.scope = m_Scopes.findIn(node, "scope");
    if (name.scope == nullptr) name.scope = m_Model.fileScope;
    if (name.isFunction() && name.scope->kind != HX_ScopeKind::eFile)
      m_Document.fail(node["scope"], "the id of a file scope for a function");
    name.retained = macroBits(HX_FieldOrEmpty(node, "retained"));
    name.provisional = macroBits(HX_FieldOrEmpty(node, "provisional"));
    name.modelContext = node.value("modelContext", false);
    for (Json entry : HX_FieldOrEmpty(node, "substitute"))
      name.substitutions.push_back(
          {HX_FromUtf8(entry["macro"]), HX_FromUtf8(entry["value"]),
           HX_ValueOf(kSubstitutionKinds, entry.value("case", "exact"))});
    if (node.contains("symbol")) readSymbol(node["symbol"], name);
    readMultirate(node, name);
    if (name.kind == HX_NameKind::eVariable) readVariable(node, name);
  }

  void readSymbol(Json node, HX_WantedName& name) {
    HX_TypeItem* type = m_Types.findIn(node, "type");
    name.symbol = std::make_unique<HxCSymbol>(
        HX_FromUtf8(node["name"]),
        HX_ValueOf(kSymbolKinds, node["kind"].get_ref<const std::string&>()),
        type != nullptr ? &type->type : nullptr);
    name.symbol->setDollarX(HX_Utf8ToLatin1(node.value("x", "")).c_str());
  }

  void readMultirate(Json node, HX_WantedName& name) {
    name.task = findTimed(node, HX_NameKind::eTask, name);
    name.isr = findTimed(node, HX_NameKind::eIsr, name);
    name.osTexts = {optionalTextIn(node, "event"),
                    optionalTextIn(node, "counter"),
                    optionalTextIn(node, "message"),
                    optionalTextIn(node, "messageVariable"),
                    optionalTextIn(node, "osObject")};
    name.period = node.value("period", 0.0);
    name.offset = node.value("offset", 0.0);
    name.cyclic = node.value("cyclic", true);
  }

  // The field has the name of the kind.
  const HX_WantedName* findTimed(Json node, HX_NameKind kind,
                                 const HX_WantedName& name) {
    const std::string field(HX_WordOf(kHxNameKinds, kind));
    const HX_WantedName* timed = m_Names.findIn(node, field.c_str());
    if (timed != nullptr && (timed->kind != kind || timed == &name))
      m_Document.fail(node[field], "the id of another name of kind " + field);
    return timed;
  }

  void readVariable(Json node, HX_WantedName& name) {
    HX_FindDeclarableType(m_Types, node["type"]);
    if (name.scope->kind == HX_ScopeKind::eFlat)
      m_Document.fail(node["scope"], "the id of a scope that is not flat");
    for (Json id : HX_FieldOrEmpty(node, "dependsOn")) {
      name.dependsOn.push_back(m_Names.find(id));
      if (name.dependsOn.back()->kind != HX_NameKind::eVariable)
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

  HX_Document& m_Document;
  HX_Model& m_Model;
  HX_SourceIds m_Sources{m_Document,
                         "a block, a chart object or a dictionary object"};
  HX_TypeIds m_Types{m_Document, "a type"};
  HX_Ids<HX_ScopeItem> m_Scopes{m_Document, "a scope"};
  HX_Ids<HX_WantedName> m_Names{m_Document, "a name"};
};

}  // namespace

HX_Model::HX_Model(HX_Document& document, const std::string& keywordFolder) {
  HxCGlobal::setOptions(&options);
  HxCGlobal::setDataTypeServer(&typeServer);
  HX_DdTree::instance().clear();
  Reader(document, *this).read(keywordFolder);
}

HX_Model::~HX_Model() {
  HxCGlobal::setOptions(nullptr);
  HxCGlobal::setDataTypeServer(nullptr);
  HX_DdTree::instance().clear();
}
