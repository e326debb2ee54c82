// Sources of names: blocks, charts and the data dictionary.
#include "host/model/HX_ModelReading.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/model/HX_StateflowBlock.h"

namespace {

using Reading = HX_ModelReading;
using Value = HX_BoundValue;

HX_BlockRecord& block(Reading& r) {
  return r.sources
      .blocks[static_cast<std::size_t>(r.sources.openBlocks.back())];
}

void beginBlock(Reading& r, HX_TokenEnd) {
  HX_SourceRecords& sources = r.sources;
  HX_BlockRecord& record = sources.blocks.emplace_back();
  if (!sources.openBlocks.empty()) record.parent = sources.openBlocks.back();
  sources.openBlocks.push_back(static_cast<int>(sources.blocks.size()) - 1);
}

void endBlock(Reading& r, bool) {
  if (!block(r).id.isGiven()) r.sources.ids.isWhole = false;
  r.sources.openBlocks.pop_back();
}

void setBlockName(Reading& r, const Value& value) {
  block(r).name = value.nameText();
  if (HX_IsForeign(value.text))
    r.sources.foreignNames.emplace(r.sources.openBlocks.back(), value.text);
}

void beginSubsystem(Reading& r, HX_TokenEnd) {
  block(r).subsystem = static_cast<int>(r.sources.subsystems.size());
  r.sources.subsystems.emplace_back();
}

void beginChart(Reading& r, HX_TokenEnd) {
  block(r).chart = static_cast<int>(r.sources.charts.size());
  r.sources.charts.emplace_back();
}

HX_ChartObjectRecord& object(Reading& r) {
  return r.sources.charts.back()
      .objects[static_cast<std::size_t>(r.sources.openObjects.back())];
}

void beginObject(Reading& r, HX_TokenEnd) {
  std::vector<int>& open = r.sources.openObjects;
  auto& objects = r.sources.charts.back().objects;
  HX_ChartObjectRecord& record = objects.emplace_back();
  if (!open.empty()) record.parent = open.back();
  open.push_back(static_cast<int>(objects.size()) - 1);
}

void endObject(Reading& r, bool) {
  if (!object(r).id.isGiven()) r.sources.ids.isWhole = false;
  r.sources.openObjects.pop_back();
}

void setObjectName(Reading& r, const Value& value) {
  object(r).name = value.nameText();
  if (HX_IsForeign(value.text))
    r.sources.foreignObjects.emplace(
        std::pair(static_cast<int>(r.sources.charts.size()) - 1,
                  r.sources.openObjects.back()),
        value.text);
}

std::string asciiText(const Value& value) { return value.nameText().cstring(); }

void setDdPath(Reading& r, const Value& value) {
  HX_SourceRecords::DdRecord& record = r.sources.ddObjects.back();
  record.path = asciiText(value);
  if (HX_IsForeign(value.text)) record.shownPath = value.text;
}

constexpr HX_FieldBinding kBindings[] = {
    {"block", nullptr, beginBlock, endBlock},
    {"block.id",
     [](Reading& r, const Value& v) { block(r).id = r.sources.ids.use(v); }},
    {"block.name", setBlockName},
    {"block.namedThroughParent",
     [](Reading& r, const Value& v) {
       block(r).isNamedThroughParent = v.boolean;
     }},
    {"block.subsystem", nullptr, beginSubsystem},
    {"block.subsystem.id",
     [](Reading& r, const Value& v) {
       r.sources.subsystems.back().id = v.nameText();
     }},
    {"block.subsystem.number",
     [](Reading& r, const Value& v) {
       r.sources.subsystems.back().number = static_cast<unsigned int>(v.number);
     }},
    {"block.chart", nullptr, beginChart},
    {"block.chart.number",
     [](Reading& r, const Value& v) {
       r.sources.charts.back().number = v.integer();
     }},
    {"chartObject", nullptr, beginObject, endObject},
    {"chartObject.id",
     [](Reading& r, const Value& v) { object(r).id = r.sources.ids.use(v); }},
    {"chartObject.name", setObjectName},
    {"chartObject.number",
     [](Reading& r, const Value& v) { object(r).number = v.integer(); }},
    {"dataDictionary.objects", nullptr,
     [](Reading& r, HX_TokenEnd) { r.sources.ddObjects.emplace_back(); },
     [](Reading& r, bool) {
       if (!r.sources.ddObjects.back().id.isGiven())
         r.sources.ids.isWhole = false;
     }},
    {"dataDictionary.objects.id",
     [](Reading& r, const Value& v) {
       r.sources.ddObjects.back().id = r.sources.ids.use(v);
     }},
    {"dataDictionary.objects.path", setDdPath},
    {"dataDictionary.components", nullptr,
     [](Reading& r, HX_TokenEnd) { r.sources.components.emplace_back(); }},
    {"dataDictionary.components.name",
     [](Reading& r, const Value& v) {
       r.sources.components.back().name = v.nameText();
       r.sources.components.back().namePlace = v.place;
     }},
    {"dataDictionary.components.related", nullptr,
     [](Reading& r, HX_TokenEnd) {
       r.sources.components.back().related.emplace_back();
     }},
    {"dataDictionary.components.related.property",
     [](Reading& r, const Value& v) {
       r.sources.components.back().related.back().property = asciiText(v);
     }},
    {"dataDictionary.components.related.path",
     [](Reading& r, const Value& v) {
       r.sources.components.back().related.back().path = asciiText(v);
     }},
};

/// Makes the items of the library from the records.
class Maker {
 public:
  explicit Maker(Reading& reading)
      : m_Reading(reading),
        m_Sources(reading.sources),
        m_Model(reading.model) {}

  // A record is freed when the block exists.
  void makeBlocks() {
    m_Model.blocks.reserve(m_Sources.blocks.size());
    for (int index = 0; !m_Sources.blocks.empty(); ++index) {
      makeBlock(m_Sources.blocks.front(), index);
      m_Sources.blocks.pop_front();
    }
  }

  void makeDdObjects() {
    for (const HX_SourceRecords::DdRecord& record : m_Sources.ddObjects) {
      const HxCDdSrcRef& made =
          m_Model.ddRefs.emplace_back(HX_DdTree::instance().add(record.path));
      define(record.id, &made);
      if (!record.shownPath.empty())
        m_Model.paths.enter(&made, record.shownPath);
    }
  }

  // A variable belongs to the first component with the name of the variable.
  // Components are entered by name: the order of the document has no
  // influence.
  void makeComponents() {
    std::map<KyCXString, const HX_ComponentRecord*> byName;
    for (const HX_ComponentRecord& record : m_Sources.components) {
      if (!byName.emplace(record.name, &record).second)
        m_Reading.faults.add(record.namePlace,
                             HX_Quoted(record.name.cstring()) + " again",
                             "a name that no other component has");
    }
    HX_DdTree& tree = HX_DdTree::instance();
    for (const auto& [name, record] : byName) {
      const std::string path =
          std::string("/Pool/Autosar/SoftwareComponents/") + name.cstring();
      tree.add(path, HX_DdTree::kSoftwareComponent);
      const unsigned long related = tree.add(path + "/RelatedVariables");
      for (const HX_ComponentRecord::Related& entry : record->related)
        tree.addReference(related, entry.property, entry.path);
    }
  }

 private:
  void define(const HX_Use& id, const HxCSrcRef* srcRef) {
    m_Reading.define(m_Sources.ids, id, m_Sources.items.size());
    m_Sources.items.push_back(srcRef);
  }

  void makeBlock(const HX_BlockRecord& record, int index) {
    HX_Block* parent =
        record.parent < 0
            ? nullptr
            : m_Model.blocks[static_cast<std::size_t>(record.parent)].get();
    if (record.chart >= 0)
      m_Model.blocks.push_back(
          std::make_unique<HX_StateflowBlock>(record.name, parent));
    else
      m_Model.blocks.push_back(std::make_unique<HX_Block>(record.name, parent));
    HX_Block& block = *m_Model.blocks.back();
    if (record.subsystem >= 0) {
      const HX_SubsystemRecord& subsystem =
          m_Sources.subsystems[static_cast<std::size_t>(record.subsystem)];
      block.setSubsystem(subsystem.id, subsystem.number);
    }
    block.setNamedThroughParent(record.isNamedThroughParent);
    define(record.id, block.getSrcRef());
    const auto foreign = m_Sources.foreignNames.find(index);
    if (foreign != m_Sources.foreignNames.end())
      m_Model.paths.enter(&block, foreign->second);
    if (HX_StateflowBlock* chartBlock = block.isStateflowBlock())
      makeChart(record.chart, *chartBlock);
  }

  void makeChart(int index, HX_StateflowBlock& block) {
    HX_ChartRecord& record = m_Sources.charts[static_cast<std::size_t>(index)];
    SC_Chart& chart = m_Model.charts.emplace_back(*block.getSubsystemId());
    KyCXString path;
    block.getFullPathName(path, false, false);
    SC_State& state = addState(record.number, block.getName(), chart);
    enterState(state, block, state, path, block.getName());
    block.setChartState(&state);
    const std::string shownPath = m_Model.paths.pathOf(block.getSrcRef());
    makeObjects(index, state, {path, block.getName(), shownPath});
    record.objects.clear();
  }

  /// Data of an object for the objects inside.
  struct Around {
    KyCXString path;
    KyCXString hierarchy;
    std::string shownPath;
  };

  // Data and states alike: names depend on no difference.
  void makeObjects(int chartIndex, SC_State& chart, const Around& outermost) {
    const auto& objects =
        m_Sources.charts[static_cast<std::size_t>(chartIndex)].objects;
    std::deque<Around> made;  // by index
    for (const HX_ChartObjectRecord& record : objects) {
      const Around& around =
          record.parent < 0 ? outermost
                            : made[static_cast<std::size_t>(record.parent)];
      const int index = static_cast<int>(made.size());
      SC_State& object =
          addState(record.number, record.name, *chart.getChart());
      KyCXString hierarchy = around.hierarchy;
      const KyCXString path = around.path + "/" + record.name;
      enterState(object, *chart.getContainingBlock(), chart, path,
                 hierarchy.makeCIdentifier(false));
      define(record.id, object.getStateflowSrcRef());
      const auto foreign = m_Sources.foreignObjects.find({chartIndex, index});
      const std::string shownPath =
          around.shownPath + "/" +
          (foreign != m_Sources.foreignObjects.end() ? foreign->second
                                                     : record.name.cstring());
      if (HX_IsForeign(shownPath))
        m_Model.paths.enter(object.getStateflowSrcRef(), shownPath);
      made.push_back({path, around.hierarchy + "_" + record.name, shownPath});
    }
  }

  SC_State& addState(int number, const KyCXString& name, SC_Chart& chart) {
    return m_Model.chartObjects.emplace_back(
        static_cast<int>(m_Model.chartObjects.size()), number, name, &chart);
  }

  static void enterState(SC_State& state, HX_Block& block, SC_State& chart,
                         const KyCXString& path, const KyCXString& hierarchy) {
    state.setSFName(path);
    state.setHierarchy(hierarchy);
    state.setContainingBlock(&block);
    SC_ModelAccess::setChartState(&state, &chart);
  }

  Reading& m_Reading;
  HX_SourceRecords& m_Sources;
  HX_Model& m_Model;
};

}  // namespace

HX_Bindings HX_SourceBindings() { return {kBindings, std::size(kBindings)}; }

void HX_ResolveSources(HX_ModelReading& reading) {
  Maker maker(reading);
  maker.makeBlocks();
  maker.makeDdObjects();
  maker.makeComponents();
}
