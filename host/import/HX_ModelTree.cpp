#include "host/import/HX_ModelTree.h"

#include <algorithm>
#include <map>

#include "host/base/HX_NaturalOrder.h"
#include "host/import/HX_ModelFile.h"
#include "host/import/HX_Notes.h"
#include "host/import/HX_PartText.h"
#include "host/import/HX_References.h"

namespace {

// A subsystem with a control block inside runs as a unit.
constexpr std::string_view kControlBlocks[] = {
    "TriggerPort", "EnablePort",  "ActionPort",   "ResetPort",
    "ForEach",     "ForIterator", "WhileIterator"};

bool isControlBlock(const HX_ModelBlock& block) {
  return std::find(std::begin(kControlBlocks), std::end(kControlBlocks),
                   block.type) != std::end(kControlBlocks);
}

bool comesFirst(const HX_ModelBlock& a, const HX_ModelBlock& b) {
  if (a.name != b.name) return HX_NaturalLess(a.name, b.name);
  return HX_NaturalLess(a.id, b.id);
}

// Sorting has moved the blocks.
void setParents(HX_ModelBlock& parent) {
  for (HX_ModelBlock& block : parent.blocks) {
    block.parent = &parent;
    setParents(block);
  }
}

// The number N of "SID#out:N", 0 for further ends of a line.
int outputOf(std::string_view source, std::string_view& sid) {
  constexpr std::string_view kOut = "#out:";
  const std::size_t mark = source.find(kOut);
  if (mark == std::string_view::npos) return 0;
  sid = source.substr(0, mark);
  return std::atoi(std::string(source.substr(mark + kOut.size())).c_str());
}

// "Logic/Compare//Equal/Inner" into "Logic", "Compare/Equal", "Inner".
std::vector<std::string> stepsOf(std::string_view path) {
  std::vector<std::string> steps(1);
  for (std::size_t i = 0; i < path.size(); ++i) {
    if (path[i] != '/') {
      steps.back() += path[i];
    } else if (i + 1 < path.size() && path[i + 1] == '/') {
      steps.back() += '/';
      ++i;
    } else {
      steps.emplace_back();
    }
  }
  for (std::string& step : steps) step = HX_OneLine(step);
  return steps;
}

pugi::xml_node blockAt(const HX_ModelFile& file, std::string_view path) {
  pugi::xml_node system = file.rootSystem();
  pugi::xml_node found;
  for (const std::string& step : stepsOf(path)) {
    found = {};
    for (const pugi::xml_node block : system.children("Block")) {
      if (HX_OneLine(block.attribute("Name").value()) == step) found = block;
    }
    system = file.contentOf(found);
  }
  return found;
}

}  // namespace

const char* HX_ModelBlock::find(std::string_view parameter) const {
  for (const pugi::xml_node holder :
       {node, node.child("InstanceData"), linked}) {
    if (const char* text = HX_FindParameter(holder, parameter)) return text;
  }
  return file->defaultOf(type, parameter);
}

std::string_view HX_ModelBlock::get(std::string_view parameter) const {
  const char* text = find(parameter);
  return text == nullptr ? std::string_view() : std::string_view(text);
}

std::string HX_ModelBlock::path() const {
  return parent == nullptr ? name : parent->path() + "/" + name;
}

HX_ModelTree::HX_ModelTree(const HX_ModelFile& file, HX_References& references,
                           const HX_ImportLimits& limits, HX_Notes& notes)
    : m_References(references), m_Limits(limits), m_Notes(notes) {
  m_Root.id = "root";
  m_Root.name = file.name();
  m_Root.type = "Model";
  m_Root.file = &file;
  m_Root.isFunction = true;
  m_Root.hasContent = true;
  m_Expanding.push_back(file.path());
  addSystem(file.rootSystem(), m_Root, {&file, "", "", 0});
  setParents(m_Root);
}

void HX_ModelTree::addSystem(pugi::xml_node system, HX_ModelBlock& parent,
                             const Place& place) {
  if (place.depth > m_Limits.depth)
    place.file->fail("systems nested deeper than " +
                     std::to_string(m_Limits.depth));
  const auto blocks = system.children("Block");
  parent.blocks.reserve(
      static_cast<std::size_t>(std::distance(blocks.begin(), blocks.end())));
  for (const pugi::xml_node node : blocks) {
    HX_ModelBlock& block = parent.blocks.emplace_back();
    block.parent = &parent;
    addBlock(node, block, place);
    if (isControlBlock(block)) parent.isFunction = true;
  }
  addSignals(system, parent);
}

void HX_ModelTree::addBlock(pugi::xml_node node, HX_ModelBlock& block,
                            const Place& place) {
  if (++m_Count > m_Limits.blocks)
    place.file->fail("more than " + std::to_string(m_Limits.blocks) +
                     " blocks with references expanded");
  block.node = node;
  block.file = place.file;
  block.name = HX_OneLine(node.attribute("Name").value());
  block.id =
      uniqueId(place.prefix + HX_OneLine(node.attribute("SID").value()), block);
  const Place inner{
      place.file, place.prefix,
      place.path.empty() ? block.name : place.path + "/" + block.name,
      place.depth + 1};
  addContent(block, node, inner);
}

// `node` is the block itself, or the linked block of a library.
void HX_ModelTree::addContent(HX_ModelBlock& block, pugi::xml_node node,
                              const Place& place) {
  block.type = node.attribute("BlockType").value();
  if (const pugi::xml_node chart = place.file->chartOf(place.path)) {
    block.isChart = block.isFunction = true;
    if (!HX_ReadChart(chart, block.id, m_Limits.depth - place.depth,
                      block.chart))
      place.file->fail("systems and states nested deeper than " +
                       std::to_string(m_Limits.depth) + " in " + place.path);
  }
  if (block.get("TreatAsAtomicUnit") == "on") block.isFunction = true;
  if (const pugi::xml_node system = place.file->contentOf(node)) {
    block.hasContent = true;
    return addSystem(system, block, place);
  }
  std::string_view file = HX_Parameter(node, "ReferencedSubsystem");
  std::string_view inner;
  if (block.type == "ModelReference") {
    block.isFunction = true;
    file = HX_Parameter(node, "ModelNameDialog");
    if (file.empty()) file = HX_Parameter(node, "ModelName");
  } else if (block.type == "Reference") {
    const std::string_view source = HX_Parameter(node, "SourceBlock");
    file = source.substr(0, source.find('/'));
    inner = source.substr(std::min(file.size() + 1, source.size()));
  }
  if (!file.empty()) addReferenced(block, place, HX_OneLine(file), inner);
}

// Expands the whole file, or the block of the file with the path `inner`.
void HX_ModelTree::addReferenced(HX_ModelBlock& block, const Place& place,
                                 const std::string& name,
                                 std::string_view inner) {
  const auto leaveEmpty = [&](const std::string& reason) {
    m_Notes.add("warning",
                "'" + name + "' " + reason + ": the block has no content",
                block.path());
  };
  const HX_ModelFile* file = m_References.find(name);
  if (file == nullptr)
    return leaveEmpty("was found neither beside the model nor on --path");
  const std::string target =
      file->path() + (inner.empty() ? "" : "/") + HX_OneLine(inner);
  if (std::find(m_Expanding.begin(), m_Expanding.end(), target) !=
      m_Expanding.end())
    return leaveEmpty("refers to itself");
  m_Expanding.push_back(target);
  block.file = file;
  Place content{file, block.id + ":", "", place.depth};
  if (inner.empty()) {
    block.hasContent = true;
    addSystem(file->rootSystem(), block, content);
  } else if ((block.linked = blockAt(*file, inner))) {
    content.path = HX_OneLine(inner);
    addContent(block, block.linked, content);
  } else {
    leaveEmpty("has no block '" + HX_OneLine(inner) + "'");
  }
  m_Expanding.pop_back();
}

void HX_ModelTree::addSignals(pugi::xml_node system, HX_ModelBlock& parent) {
  std::map<std::string_view, HX_ModelBlock*> bySid;
  for (HX_ModelBlock& block : parent.blocks)
    bySid[block.node.attribute("SID").value()] = &block;
  for (const pugi::xml_node line : system.children("Line")) {
    std::string_view sid;
    const int port = outputOf(HX_Parameter(line, "Src"), sid);
    const auto block = bySid.find(sid);
    if (port > 0 && block != bySid.end())
      block->second->signals.push_back(
          {port, HX_OneLine(HX_Parameter(line, "Name"))});
  }
  std::sort(parent.blocks.begin(), parent.blocks.end(), comesFirst);
  for (HX_ModelBlock& block : parent.blocks) {
    auto& signals = block.signals;
    std::sort(signals.begin(), signals.end(),
              [](const HX_ModelSignal& a, const HX_ModelSignal& b) {
                return a.port < b.port;
              });
  }
}

// A repeated or missing SID still gives a new id.
std::string HX_ModelTree::uniqueId(std::string id, const HX_ModelBlock& block) {
  if (id.empty() || id.back() == ':') id += block.name;
  if (m_Ids.insert(id).second) return id;
  m_Notes.add("warning", "the SID '" + id + "' occurs more than once",
              block.path());
  for (int i = 2;; ++i) {
    const std::string variant = id + "~" + std::to_string(i);
    if (m_Ids.insert(variant).second) return variant;
  }
}
