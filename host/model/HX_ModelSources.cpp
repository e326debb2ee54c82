// What names come from: blocks, charts and the data dictionary.
#include "host/base/HX_Text.h"
#include "host/model/HX_ModelReaders.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/model/HX_StateflowBlock.h"

namespace {

using Json = const HX_Json&;

class SourceReader {
 public:
  SourceReader(HX_Model& model, HX_SourceIds& ids)
      : m_Model(model), m_Ids(ids) {}

  void readBlock(Json node, HX_Block* parent) {
    const KyCXString name = HX_FromUtf8(node["name"]);
    if (node.contains("chart"))
      m_Model.blocks.push_back(
          std::make_unique<HX_StateflowBlock>(name, parent));
    else
      m_Model.blocks.push_back(std::make_unique<HX_Block>(name, parent));
    HX_Block& block = *m_Model.blocks.back();
    if (node.contains("subsystem")) {
      Json subsystem = node["subsystem"];
      block.setSubsystem(HX_FromUtf8(subsystem["id"]), subsystem["number"]);
    }
    block.setNamedThroughParent(node.value("namedThroughParent", false));
    m_Ids.enter(node, block.getSrcRef());
    if (HX_StateflowBlock* chart = block.isStateflowBlock())
      readChart(node["chart"], *chart);
    for (Json inner : HX_FieldOrEmpty(node, "blocks")) readBlock(inner, &block);
  }

  void readChart(Json node, HX_StateflowBlock& block) {
    SC_Chart& chart = m_Model.charts.emplace_back(*block.getSubsystemId());
    KyCXString path;
    block.getFullPathName(path, false, false);
    SC_State& state =
        addState(node, block.getName(), chart, path, block.getName());
    state.setContainingBlock(&block);
    SC_ModelAccess::setChartState(&state, &state);
    block.setChartState(&state);
    for (Json object : HX_FieldOrEmpty(node, "objects"))
      readChartObject(object, state, path, block.getName());
  }

  // Data and states alike: names depend on no difference between them.
  void readChartObject(Json node, SC_State& chart, const KyCXString& path,
                       const KyCXString& hierarchy) {
    const KyCXString name = HX_FromUtf8(node["name"]);
    const KyCXString ownPath = path + "/" + name;
    KyCXString states = hierarchy;
    SC_State& object = addState(node, name, *chart.getChart(), ownPath,
                                states.makeCIdentifier(false));
    object.setContainingBlock(chart.getContainingBlock());
    SC_ModelAccess::setChartState(&object, &chart);
    m_Ids.enter(node, object.getStateflowSrcRef());
    for (Json inner : HX_FieldOrEmpty(node, "objects"))
      readChartObject(inner, chart, ownPath, hierarchy + "_" + name);
  }

  SC_State& addState(Json node, const KyCXString& name, SC_Chart& chart,
                     const KyCXString& path, const KyCXString& hierarchy) {
    SC_State& state = m_Model.chartObjects.emplace_back(
        static_cast<int>(m_Model.chartObjects.size()),
        node["number"].get<int>(), name, &chart);
    state.setSFName(path);
    state.setHierarchy(hierarchy);
    return state;
  }

  void readDdObjects(Json objects) {
    for (Json object : objects) {
      const unsigned long handle =
          HX_DdTree::instance().add(HX_Utf8ToLatin1(object["path"]));
      m_Ids.enter(object, &m_Model.ddRefs.emplace_back(handle));
    }
  }

  // The first component wins a variable: they are entered by name, so that
  // their order in the document does not matter.
  void readComponents(Json components) {
    std::map<std::string, const HX_Json*> byName;
    for (Json component : components) {
      Json name = component["name"];
      if (!byName.emplace(name, &component).second)
        m_Ids.document.fail(
            name, "a name that is not taken yet, found " + name.dump());
    }
    HX_DdTree& tree = HX_DdTree::instance();
    for (const auto& [name, component] : byName) {
      const std::string path =
          "/Pool/Autosar/SoftwareComponents/" + HX_Utf8ToLatin1(name);
      tree.add(path, HX_DdTree::kSoftwareComponent);
      const unsigned long related = tree.add(path + "/RelatedVariables");
      for (Json entry : HX_FieldOrEmpty(*component, "related"))
        tree.addReference(related, HX_Utf8ToLatin1(entry["property"]),
                          HX_Utf8ToLatin1(entry["path"]));
    }
  }

 private:
  HX_Model& m_Model;
  HX_SourceIds& m_Ids;
};

}  // namespace

void HX_ReadSources(const HX_Json& root, HX_Model& model, HX_SourceIds& ids) {
  SourceReader reader(model, ids);
  for (Json block : HX_FieldOrEmpty(root, "blocks"))
    reader.readBlock(block, nullptr);
  Json dictionary = HX_FieldOrEmpty(root, "dataDictionary");
  reader.readDdObjects(HX_FieldOrEmpty(dictionary, "objects"));
  reader.readComponents(HX_FieldOrEmpty(dictionary, "components"));
}
