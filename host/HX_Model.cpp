#include "host/HX_Model.h"

#include <fstream>

#include "host/HX_ModelReader.h"
#include "host/HX_Text.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/model/HX_StateflowBlock.h"
#include "platform/model/HxCGlobal.h"

HX_Model::HX_Model(HX_Document& document, const std::string& keywordFolder) {
  HxCGlobal::setOptions(&options);
  HxCGlobal::setDataTypeServer(&typeServer);
  HX_DdTree::instance().clear();
  HX_ModelReader(document, *this).read(keywordFolder);
}

HX_Model::~HX_Model() {
  HxCGlobal::setOptions(nullptr);
  HxCGlobal::setDataTypeServer(nullptr);
  HX_DdTree::instance().clear();
}

void HX_ModelReader::read(const std::string& keywordFolder) {
  HX_Json& root = m_Document.root;
  readModel(root["model"]);
  readOptions(HX_FieldOf(root, "options"), keywordFolder);
  for (Json block : HX_FieldOf(root, "blocks")) readBlock(block, nullptr);
  root.erase("blocks");
  Json dictionary = HX_FieldOf(root, "dataDictionary");
  readDdObjects(HX_FieldOf(dictionary, "objects"));
  readComponents(HX_FieldOf(dictionary, "components"));
  readTypes(HX_FieldOf(root, "types"));
  for (Json scope : HX_FieldOf(root, "scopes")) readScope(scope, nullptr);
  if (m_FileScope == nullptr)
    m_FileScope = &m_Model.scopes.emplace_back(HX_ScopeItem{"file", "file"});
  readNames(root["names"]);
  std::size_t index = 0;
  for (Json scope : HX_FieldOf(root, "scopes")) completeScope(scope, index);
}

void HX_ModelReader::readModel(Json model) {
  m_Model.name = model["name"];
  GLB_SetModelName(HX_FromUtf8(m_Model.name));
  GLB_SetSubsystemName(HX_FromUtf8(model.value("subsystem", "")));
  m_Model.options.setHxSystemID(HX_FromUtf8(model.value("systemId", "")));
}

// One word on a line; lines that begin with '#' are comments.
void HX_ModelReader::readOptions(Json options,
                                 const std::string& keywordFolder) {
  m_Model.options.setLimitVariableNameLength(
      options.value("limitNames", false));
  for (Json list : HX_FieldOf(options, "keywords")) {
    std::ifstream file(keywordFolder + "/" + list.get<std::string>() + ".txt");
    if (!file)
      m_Document.fail(list, "the name of a word list in " + keywordFolder +
                                ", found " + list.dump());
    for (std::string line; std::getline(file, line);) {
      if (!line.empty() && line[0] != '#') m_Model.words.insert(line);
    }
  }
}

void HX_ModelReader::readBlock(Json node, HX_Block* parent) {
  const KyCXString name = HX_FromUtf8(node["name"]);
  if (node.contains("chart"))
    m_Model.blocks.push_back(std::make_unique<HX_StateflowBlock>(name, parent));
  else
    m_Model.blocks.push_back(std::make_unique<HX_Block>(name, parent));
  HX_Block& block = *m_Model.blocks.back();
  if (node.contains("subsystem")) {
    Json subsystem = node["subsystem"];
    block.setSubsystem(HX_FromUtf8(subsystem["id"]), subsystem["number"]);
  }
  block.setNamedThroughParent(node.value("namedThroughParent", false));
  m_Sources.enter(node, block.getSrcRef());
  if (HX_StateflowBlock* chart = block.isStateflowBlock())
    readChart(node["chart"], *chart);
  for (Json inner : HX_FieldOf(node, "blocks")) readBlock(inner, &block);
}

void HX_ModelReader::readChart(Json node, HX_StateflowBlock& block) {
  SC_Chart& chart = m_Model.charts.emplace_back(*block.getSubsystemId());
  KyCXString path;
  block.getFullPathName(path, false, false);
  SC_State& state =
      addState(node, block.getName(), chart, path, block.getName());
  state.setContainingBlock(&block);
  SC_ModelAccess::setChartState(&state, &state);
  block.setChartState(&state);
  for (Json object : HX_FieldOf(node, "objects"))
    readChartObject(object, state, path, block.getName());
}

// Data and states alike: names depend on no difference between them.
void HX_ModelReader::readChartObject(Json node, SC_State& chart,
                                     const KyCXString& path,
                                     const KyCXString& hierarchy) {
  const KyCXString name = HX_FromUtf8(node["name"]);
  const KyCXString ownPath = path + "/" + name;
  KyCXString states = hierarchy;
  SC_State& object = addState(node, name, *chart.getChart(), ownPath,
                              states.makeCIdentifier(false));
  object.setContainingBlock(chart.getContainingBlock());
  SC_ModelAccess::setChartState(&object, &chart);
  m_Sources.enter(node, object.getStateflowSrcRef());
  for (Json inner : HX_FieldOf(node, "objects"))
    readChartObject(inner, chart, ownPath, hierarchy + "_" + name);
}

SC_State& HX_ModelReader::addState(Json node, const KyCXString& name,
                                   SC_Chart& chart, const KyCXString& path,
                                   const KyCXString& hierarchy) {
  SC_State& state = m_Model.chartObjects.emplace_back(
      static_cast<int>(m_Model.chartObjects.size()), node["number"].get<int>(),
      name, &chart);
  state.setSFName(path);
  state.setHierarchy(hierarchy);
  return state;
}

void HX_ModelReader::readDdObjects(Json objects) {
  for (Json object : objects) {
    const unsigned long handle =
        HX_DdTree::instance().add(HX_Utf8ToLatin1(object["path"]));
    m_Sources.enter(object, &m_Model.ddRefs.emplace_back(handle));
  }
}

// The first component wins a variable: they are entered by name, so that their
// order in the document does not matter.
void HX_ModelReader::readComponents(Json components) {
  std::map<std::string, const HX_Json*> byName;
  for (Json component : components) {
    Json name = component["name"];
    if (!byName.emplace(name, &component).second)
      m_Document.fail(name,
                      "a name that is not taken yet, found " + name.dump());
  }
  HX_DdTree& tree = HX_DdTree::instance();
  for (const auto& [name, component] : byName) {
    const std::string path =
        "/Pool/Autosar/SoftwareComponents/" + HX_Utf8ToLatin1(name);
    tree.add(path, HX_DdTree::kSoftwareComponent);
    const unsigned long related = tree.add(path + "/RelatedVariables");
    for (Json entry : HX_FieldOf(*component, "related"))
      tree.addReference(related, HX_Utf8ToLatin1(entry["property"]),
                        HX_Utf8ToLatin1(entry["path"]));
  }
}

void HX_ModelReader::readScope(Json node, const HX_ScopeItem* parent) {
  // Where a scope may stand. A block may also stand in a block.
  static const std::map<std::string, std::string> kParents = {
      {"file", "the document"},
      {"flat", "the document"},
      {"function", "file"},
      {"block", "function"}};
  HX_ScopeItem& scope = m_Model.scopes.emplace_back(
      HX_ScopeItem{node["id"], node["kind"], parent});
  m_Scopes.enter(node, &scope);
  const std::string around = parent != nullptr ? parent->kind : "the document";
  const bool isBlockInBlock = scope.kind == "block" && around == "block";
  if (around != kParents.at(scope.kind) && !isBlockInBlock)
    m_Document.fail(node["kind"],
                    "a scope of this kind only in " + kParents.at(scope.kind));
  if (scope.kind == "file") {
    if (m_FileScope != nullptr) m_Document.fail(node["kind"], "one file scope");
    m_FileScope = &scope;
  }
  for (Json inner : HX_FieldOf(node, "scopes")) readScope(inner, &scope);
}

// Names are known only now. Visits the scopes in the order of readScope().
void HX_ModelReader::completeScope(Json node, std::size_t& index) {
  HX_ScopeItem& scope = m_Model.scopes[index++];
  if (scope.kind == "function") {
    scope.function = m_Names.find(node["function"]);
    if (!scope.function->isFunction() ||
        !m_Bodies.insert(scope.function).second)
      m_Document.fail(
          node["function"],
          "the id of a function, task or isr without another scope");
  }
  for (Json inner : HX_FieldOf(node, "scopes")) completeScope(inner, index);
}
