#include "host/HX_Model.h"

#include "host/HX_Document.h"
#include "host/HX_ModelIds.h"
#include "host/HX_Text.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/model/HX_StateflowBlock.h"
#include "platform/model/HxCGlobal.h"

namespace {

// Where a scope may stand. A block may also stand in a block.
struct NestingRow {
  const char* kind;
  const char* parent;
};

constexpr NestingRow kNesting[] = {{"file", "the document"},
                                   {"flat", "the document"},
                                   {"function", "file"},
                                   {"block", "function"}};

}  // namespace

HX_Model::HX_Model(const HX_DocumentNode& root) {
  readModel(root);
  root.forEach("blocks",
               [&](const HX_DocumentNode& b) { readBlock(b, nullptr); });
  if (root.has("dataDictionary")) readDataDictionary(root.at("dataDictionary"));
  readTypes(root);
  readScopes(root);
  readNames(root);
  std::size_t index = 0;
  root.forEach("scopes",
               [&](const HX_DocumentNode& s) { completeScope(s, index); });
}

HX_Model::~HX_Model() {
  HxCGlobal::setOptions(nullptr);
  HxCGlobal::setDataTypeServer(nullptr);
  HX_DdTree::instance().clear();
}

void HX_Model::readModel(const HX_DocumentNode& root) {
  const HX_DocumentNode model = root.at("model");
  m_Name = model.text("name");
  GLB_SetModelName(HX_FromUtf8(m_Name));
  GLB_SetSubsystemName(HX_FromUtf8(model.text("subsystem")));
  m_Options.setHxSystemID(HX_FromUtf8(model.text("systemId")));
  if (root.has("options")) {
    const HX_DocumentNode options = root.at("options");
    m_Options.setLimitVariableNameLength(options.flag("limitNames", false));
    options.forEach("keywords", [&](const HX_DocumentNode& list) {
      m_Keywords.push_back(list.value());
    });
  }
  HxCGlobal::setOptions(&m_Options);
  HxCGlobal::setDataTypeServer(&m_TypeServer);
  HX_DdTree::instance().clear();
}

void HX_Model::addSource(const HX_DocumentNode& node, const HxCSrcRef* srcRef) {
  enter(node, m_SourcesById, srcRef);
}

void HX_Model::readBlock(const HX_DocumentNode& node, HX_Block* parent) {
  const KyCXString name = HX_FromUtf8(node.text("name"));
  if (node.has("chart")) {
    m_Blocks.push_back(std::make_unique<HX_StateflowBlock>(name, parent));
  } else {
    m_Blocks.push_back(std::make_unique<HX_Block>(name, parent));
  }
  HX_Block& block = *m_Blocks.back();
  if (node.has("subsystem")) {
    const HX_DocumentNode subsystem = node.at("subsystem");
    block.setSubsystem(
        HX_FromUtf8(subsystem.text("id")),
        static_cast<unsigned int>(subsystem.integer("number", 0)));
  }
  block.setNamedThroughParent(node.flag("namedThroughParent", false));
  addSource(node, block.getSrcRef());
  if (HX_StateflowBlock* chart = block.isStateflowBlock())
    readChart(node.at("chart"), *chart);
  node.forEach("blocks",
               [&](const HX_DocumentNode& b) { readBlock(b, &block); });
}

void HX_Model::readChart(const HX_DocumentNode& node,
                         HX_StateflowBlock& block) {
  m_Charts.push_back(std::make_unique<SC_Chart>(*block.getSubsystemId()));
  m_ChartObjects.push_back(std::make_unique<SC_State>(
      static_cast<int>(m_ChartObjects.size()), node.integer("number", 0),
      block.getName(), m_Charts.back().get()));
  SC_State& chart = *m_ChartObjects.back();
  KyCXString path;
  block.getFullPathName(path, false, false);
  chart.setSFName(path);
  chart.setHierarchy(block.getName());
  chart.setContainingBlock(&block);
  SC_ModelAccess::setChartState(&chart, &chart);
  block.setChartState(&chart);
  node.forEach("objects", [&](const HX_DocumentNode& object) {
    readChartObject(object, chart, HX_ToUtf8(path), HX_ToUtf8(block.getName()));
  });
}

// Data and states alike: names depend on no difference between them.
void HX_Model::readChartObject(const HX_DocumentNode& node, SC_State& chart,
                               const std::string& path,
                               const std::string& hierarchy) {
  const std::string name = node.text("name");
  m_ChartObjects.push_back(std::make_unique<SC_State>(
      static_cast<int>(m_ChartObjects.size()), node.integer("number", 0),
      HX_FromUtf8(name), chart.getChart()));
  SC_State& object = *m_ChartObjects.back();
  object.setSFName(HX_FromUtf8(path + "/" + name));
  KyCXString states = HX_FromUtf8(hierarchy);
  object.setHierarchy(states.makeCIdentifier(false));
  object.setContainingBlock(chart.getContainingBlock());
  SC_ModelAccess::setChartState(&object, &chart);
  addSource(node, object.getStateflowSrcRef());
  node.forEach("objects", [&](const HX_DocumentNode& inner) {
    readChartObject(inner, chart, path + "/" + name, hierarchy + "_" + name);
  });
}

void HX_Model::readDataDictionary(const HX_DocumentNode& node) {
  HX_DdTree& tree = HX_DdTree::instance();
  node.forEach("objects", [&](const HX_DocumentNode& object) {
    m_DdRefs.push_back(std::make_unique<HxCDdSrcRef>(
        tree.add(HX_Utf8ToLatin1(object.text("path")))));
    addSource(object, m_DdRefs.back().get());
  });

  // The first component wins a variable: enter them by name, so that their
  // order in the document does not matter.
  std::map<std::string, std::size_t> components;
  std::size_t index = 0;
  node.forEach("components", [&](const HX_DocumentNode& component) {
    const HX_DocumentNode name = component.at("name");
    if (!components.emplace(name.value(), index++).second)
      name.fail("a name that is not taken yet, found " + name.value().dump());
  });
  for (const auto& [name, position] : components) {
    const HX_DocumentNode list = node.at("components");
    const std::string path =
        "/Pool/Autosar/SoftwareComponents/" + HX_Utf8ToLatin1(name);
    tree.add(path, HX_DdTree::kSoftwareComponent);
    const unsigned long related = tree.add(path + "/RelatedVariables");
    list.at(position).forEach("related", [&](const HX_DocumentNode& entry) {
      tree.addReference(related, HX_Utf8ToLatin1(entry.text("property")),
                        HX_Utf8ToLatin1(entry.text("path")));
    });
  }
}

void HX_Model::readScopes(const HX_DocumentNode& root) {
  root.forEach("scopes",
               [&](const HX_DocumentNode& s) { readScope(s, nullptr); });
  if (m_DefaultScope != nullptr) return;
  m_Scopes.push_back(std::make_unique<HX_ScopeItem>());
  m_Scopes.back()->id = m_Scopes.back()->kind = "file";
  m_DefaultScope = m_Scopes.back().get();
}

void HX_Model::readScope(const HX_DocumentNode& node,
                         const HX_ScopeItem* parent) {
  m_Scopes.push_back(std::make_unique<HX_ScopeItem>());
  HX_ScopeItem& item = *m_Scopes.back();
  item.id = node.text("id");
  item.kind = node.text("kind");
  item.parent = parent;
  enter(node, m_ScopesById, &item);
  const std::string around = parent != nullptr ? parent->kind : "the document";
  for (const NestingRow& row : kNesting) {
    if (item.kind == row.kind && around != row.parent &&
        !(item.kind == "block" && around == "block"))
      node.at("kind").fail(std::string("a scope of this kind only in ") +
                           row.parent);
  }
  if (item.kind == "file" && m_DefaultScope != nullptr)
    node.at("kind").fail("one file scope");
  if (item.kind == "file") m_DefaultScope = &item;
  node.forEach("scopes",
               [&](const HX_DocumentNode& s) { readScope(s, &item); });
}

// Names are known only now. Visits the scopes in the order of readScope().
void HX_Model::completeScope(const HX_DocumentNode& node, std::size_t& index) {
  HX_ScopeItem& item = *m_Scopes[index++];
  if (item.kind == "function") {
    const HX_DocumentNode id = node.at("function");
    item.function = find(id, m_NamesById, "a name");
    const bool isFunction =
        item.function->isTask() || item.function->kind == "function";
    if (!isFunction || !m_Bodies.insert(item.function).second)
      id.fail("the id of a function, task or isr without another scope");
  }
  node.forEach("scopes",
               [&](const HX_DocumentNode& s) { completeScope(s, index); });
}
