#include "host/import/HX_ModelFile.h"

#include <vector>

#include "host/import/HX_PartText.h"

namespace {

constexpr char kDiagram[] = "simulink/blockdiagram.xml";
constexpr char kDefaults[] = "simulink/bddefaults.xml";
constexpr char kOldCharts[] = "simulink/stateflow.xml";
constexpr char kNewCharts[] = "simulink/stateflow/machine.xml";
constexpr char kSystemFolder[] = "simulink/systems/";
constexpr char kChartFolder[] = "simulink/stateflow/";

// A slash inside a name is doubled in a path; some writers leave the slash
// single. A key has a single slash for both.
std::string chartKey(std::string_view path) {
  std::string key;
  for (const char c : HX_OneLine(path)) {
    if (c != '/' || key.empty() || key.back() != '/') key += c;
  }
  return key;
}

}  // namespace

HX_ModelFile::HX_ModelFile(const std::filesystem::path& file,
                           const HX_ImportLimits& limits)
    : m_Archive(file, limits), m_Name(HX_OneLine(file.stem().string())) {
  const pugi::xml_node information = load(kDiagram, "ModelInformation");
  for (const char* kind : {"Model", "Library", "Subsystem"}) {
    if (!m_Root) m_Root = information.child(kind);
  }
  if (!m_Root)
    m_Archive.fail(kDiagram,
                   "expected one of the elements <Model>, <Library>, "
                   "<Subsystem> in <ModelInformation>");
  loadReferences(m_Root, "System", kSystemFolder);
  loadDefaults();
  loadCharts();
}

pugi::xml_node HX_ModelFile::load(const std::string& part,
                                  const char* rootName) {
  std::unique_ptr<HX_XmlPart>& known = m_Parts[part];
  if (!known) known = std::make_unique<HX_XmlPart>(m_Archive, part, rootName);
  return known->root();
}

// Loads the parts named in `parent`, and the parts named in loaded parts. No
// recursion: a list holds the open elements. A loaded part is not walked again.
void HX_ModelFile::loadReferences(pugi::xml_node parent, const char* element,
                                  const char* folder) {
  std::vector<pugi::xml_node> open = {parent};
  while (!open.empty()) {
    const pugi::xml_node node = open.back();
    open.pop_back();
    for (const pugi::xml_node child : node.children()) {
      const std::string_view name = child.name();
      if (name == element && child.attribute("Ref")) {
        const std::string part =
            folder + std::string(child.attribute("Ref").value()) + ".xml";
        const bool isNew = m_Parts.find(part) == m_Parts.end();
        const pugi::xml_node root = load(part, element);
        if (isNew) open.push_back(root);
      } else if (name == "System" || name == "Block" || name == "Children") {
        open.push_back(child);
      }
    }
  }
}

void HX_ModelFile::loadDefaults() {
  if (!m_Archive.has(kDefaults)) return;
  const pugi::xml_node defaults = load(kDefaults, "BlockDiagramDefaults");
  for (const pugi::xml_node block :
       defaults.child("BlockParameterDefaults").children("Block"))
    m_Defaults[block.attribute("BlockType").value()] = block;
}

void HX_ModelFile::loadCharts() {
  const char* part = m_Archive.has(kNewCharts) ? kNewCharts : kOldCharts;
  if (!m_Archive.has(part)) return;
  const pugi::xml_node root = load(part, "Stateflow");
  std::map<std::string_view, pugi::xml_node> byId;
  for (const pugi::xml_node machine : root.children("machine")) {
    const pugi::xml_node children = machine.child("Children");
    loadReferences(children, "chart", kChartFolder);
    for (const pugi::xml_node node : children.children("chart")) {
      const pugi::xml_node chart = follow(node, kChartFolder);
      byId[chart.attribute("id").value()] = chart;
      m_Charts[chartKey(HX_Parameter(chart, "name"))] = chart;
    }
  }
  // An instance knows better where the chart is used than the chart's name.
  for (const pugi::xml_node instance : root.children("instance")) {
    const auto chart = byId.find(HX_Parameter(instance, "chart"));
    if (chart != byId.end())
      m_Charts[chartKey(HX_Parameter(instance, "name"))] = chart->second;
  }
}

pugi::xml_node HX_ModelFile::follow(pugi::xml_node node,
                                    const char* folder) const {
  const pugi::xml_attribute reference = node.attribute("Ref");
  if (!reference) return node;
  const auto found =
      m_Parts.find(folder + std::string(reference.value()) + ".xml");
  return found == m_Parts.end() ? pugi::xml_node() : found->second->root();
}

bool HX_ModelFile::isLibrary() const {
  return std::string_view(m_Root.name()) == "Library";
}

pugi::xml_node HX_ModelFile::rootSystem() const {
  return follow(m_Root.child("System"), kSystemFolder);
}

pugi::xml_node HX_ModelFile::contentOf(pugi::xml_node block) const {
  return follow(block.child("System"), kSystemFolder);
}

pugi::xml_node HX_ModelFile::chartOf(const std::string& path) const {
  const auto found = m_Charts.find(chartKey(path));
  return found == m_Charts.end() ? pugi::xml_node() : found->second;
}

const char* HX_ModelFile::defaultOf(std::string_view blockType,
                                    std::string_view parameter) const {
  const auto found = m_Defaults.find(blockType);
  return found == m_Defaults.end() ? nullptr
                                   : HX_FindParameter(found->second, parameter);
}

std::string_view HX_ModelFile::dictionary() const {
  return HX_Parameter(m_Root, "DataDictionary");
}

void HX_ModelFile::fail(const std::string& reason) const {
  throw HX_ImportError(path() + ": " + reason);
}
