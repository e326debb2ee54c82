#include "plain/HX_PlainCase.h"

#include "plain/HX_PlainNames.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HxCGlobal.h"

namespace plain {

namespace {

Text nameFrom(Choices& c, const char* what) {
  return c.text(what, 3,
                {u"a", u"B", u"1", u"_", u" ", u"x y", u"-", u"<b>", u"$N",
                 u"\n", u"/", u"\u00FC", u"\u0416", u":", u"abcdefghijklmno"});
}
// No character that the dictionary or a char* would change.
Text narrowFrom(Choices& c, const char* what) {
  return c.text(what, 2, {u"a", u"B", u"7", u"_", u" ", u"-", u"$x", u":"});
}
int idOf(std::size_t i) { return static_cast<int>(i); }

Type typeFrom(Choices& c, const std::vector<Type>& before) {
  Type t;
  t.name = nameFrom(c, "type");
  t.hasCut = c.flag("hasCut");
  t.unnamed = c.rarely("isUnnamed", 4) ? 1 + c.below("unnamed", 2) : 0;
  t.hasNameObject = c.flag("hasNameObject");
  t.isBitfield = c.rarely("isBitfield", 4);
  t.isBase = c.flag("isBase");
  t.isNumerical = c.flag("isNumerical");
  t.is64Bit = t.isNumerical && c.flag("is64Bit");
  t.isSigned = c.flag("isSigned");
  t.element = c.rarely("isArray", 4) ? c.index("element", before.size()) : -1;
  t.origin = c.index("origin", before.size());
  t.underlying = c.index("underlying", before.size());
  t.isDerived = c.flag("isDerived");
  // Base types have a cut, and so has the origin of a derived type.
  t.hasCut = t.hasCut || t.isBase;
  if (t.isDerived && t.origin != kNone && !Model::at(before, t.origin).hasCut)
    t.origin = kNone;
  if (t.isNumerical && t.underlying == kNone) t.hasCut = true;
  if (t.hasCut) t.cut = nameFrom(c, "cut");
  return t;
}

Ref refFrom(Choices& c, const Model& m) {
  Ref ref;
  ref.kind = c.of("kind", {Ref::eDd, Ref::eBlock, Ref::eStateflow,
                           Ref::eInternal, Ref::eOther, Ref::eInput});
  switch (ref.kind) {
    case Ref::eDd: {
      const int object = c.index("dd", m.dd.size());
      ref.handle =
          object == kNone ? kUnknownHandle : Model::at(m.dd, object).handle;
      ref.target = object;
      break;
    }
    case Ref::eBlock:
      ref.target = c.index("block", m.blocks.size());
      break;
    case Ref::eInternal:
      ref.file = nameFrom(c, "file");
      ref.line = c.of("line", {12, -1});
      ref.cause = nameFrom(c, "cause");
      break;
    case Ref::eInput:
      ref.target = c.index("input", m.inputs.size());
      break;
    default:
      break;
  }
  return ref;
}

void addBlocksAndObjects(Choices& c, Model& m) {
  m.charts.resize(static_cast<std::size_t>(c.below("charts", 3)));
  for (Text& chart : m.charts) chart = nameFrom(c, "chartId");
  m.blocks.resize(static_cast<std::size_t>(c.below("\n  blocks", 5)));
  m.objects.resize(static_cast<std::size_t>(c.below("objects", 4)));
  std::vector<int> states{kNone};
  for (std::size_t i = 0; i < m.objects.size(); ++i) {
    Object& o = m.objects[i];
    c.tell("\n  object " + std::to_string(i));
    o.id = c.of("id", {1, 42, -5});
    o.number = c.of("number", {0, 7, -3, 2147483647});
    o.name = narrowFrom(c, "name");
    o.sfName = nameFrom(c, "sfName");
    o.hierarchy = nameFrom(c, "hierarchy");
    o.block = c.index("block", m.blocks.size());
    o.chart = c.index("chart", m.charts.size());
    if (o.chart != kNone) states.push_back(idOf(i));
  }
  const auto state = [&] {
    return Model::at(states, c.below("state", idOf(states.size())));
  };
  for (Object& o : m.objects) o.chartState = state();
  for (std::size_t i = 0; i < m.blocks.size(); ++i) {
    Block& b = m.blocks[i];
    c.tell("\n  block " + std::to_string(i));
    b.name = nameFrom(c, "name");
    b.parent = c.index("parent", i);
    b.isSubsystem = c.flag("isSubsystem");
    b.systemId = b.isSubsystem ? nameFrom(c, "systemId") : u"";
    if (b.isSubsystem)
      b.number = c.of("number", {3u, 0u, 0xFFFFFFFFu, 0x80000000u, 12345u});
    b.isNamedThroughParent = c.flag("isNamedThroughParent");
    b.isChart = c.flag("isChart");
    if (b.isChart) b.chartState = state();
    b.handle = c.of("handle", {-1.0, 17.25, 3.0});
  }
}

void addDictionary(Choices& c, Model& m) {
  m.dd.resize(static_cast<std::size_t>(c.below("\n  dd", 4)));
  for (DdObject& object : m.dd) {
    const char* const paths[] = {"//DD0/Pool/Variables/Ctrl/speed",
                                 "//DD0/Pool/Variables/x",
                                 "//DD0/Pool/Variables",
                                 "//DD0/Pool/CGTmpData/x",
                                 "//DD0/CGTmpData/hxscript_C/3/g/h",
                                 "//DD0/CGTmpData/hxscript_C/g"};
    object.path = paths[c.below("path", 6)] + narrow(narrowFrom(c, "more"));
  }
  m.hasComponents = c.flag("hasComponents");
  if (m.hasComponents)
    m.components.resize(static_cast<std::size_t>(c.below("components", 4)));
  for (std::size_t i = 0; i < m.components.size(); ++i) {
    Component& component = m.components[i];
    component.name = "C" + std::to_string(i) + narrow(narrowFrom(c, "more"));
    component.relatedVariables.resize(
        static_cast<std::size_t>(c.below("properties", 4)));
    for (Component::Property& property : component.relatedVariables) {
      const char* const paths[] = {
          "Variables/Ctrl",       "Variables/", "Other", "",
          "Variables/Ctrl/speed", "ariables"};
      property.name = narrow(narrowFrom(c, "property"));
      property.path = paths[c.below("refers", 6)];
    }
  }
}

}  // namespace

Model randomModel(Choices& c) {
  Model m;
  m.modelName = nameFrom(c, "model");
  m.subsystemName = nameFrom(c, "subsystem");
  m.rootDepth = c.below("rootDepth", 4);
  m.contextId = nameFrom(c, "contextId");
  m.optionsId = nameFrom(c, "optionsId");
  m.limitsNames = c.flag("limitsNames");
  addBlocksAndObjects(c, m);
  addDictionary(c, m);
  const auto types = static_cast<std::size_t>(c.below("\n  types", 5));
  while (m.types.size() < types) m.types.push_back(typeFrom(c, m.types));
  m.bitfieldBase = c.index("bitfieldBase", types);
  m.symbols.resize(static_cast<std::size_t>(c.below("\n  symbols", 3)));
  for (Symbol& symbol : m.symbols)
    symbol = {nameFrom(c, "name"), 1 + c.below("kind", 4),
              narrowFrom(c, "dollarX"), c.index("type", types)};
  m.inputs.resize(static_cast<std::size_t>(c.below("\n  inputs", 4)));
  for (std::size_t i = 0; i < m.inputs.size(); ++i) {
    const Text number = decimal(idOf(i));
    m.inputs[i].name = nameFrom(c, "name") + number;
    m.inputs[i].parent = c.index("parent", m.inputs.size());
  }
  m.system = c.index("system", m.inputs.size());
  for (std::size_t i = 0; i < m.blocks.size(); ++i) {
    m.refs.emplace_back();
    m.refs.back().kind = Ref::eBlock;
    m.refs.back().target = idOf(i);
  }
  for (std::size_t i = 0; i < m.objects.size(); ++i) {
    m.refs.emplace_back();
    m.refs.back().kind = Ref::eStateflow;
    m.refs.back().target = idOf(i);
  }
  for (int more = c.below("\n  refs", 5); more > 0; --more)
    m.refs.push_back(refFrom(c, m));
  for (std::size_t i = 0; i < m.refs.size(); ++i) m.refs[i].id = idOf(i);
  m.ivBlocks.resize(static_cast<std::size_t>(c.below("\n  ivBlocks", 3)));
  for (IvBlock& block : m.ivBlocks)
    block = {nameFrom(c, "rawName"), c.index("ref", m.refs.size())};
  return m;
}

KyCXString kyText(const Text& text) {
  KyCXString result;
  for (const char16_t c : text) result.appendUnit(c);
  return result;
}
Text textOf(const KyCXString& text) {
  Text result;
  for (int i = 0; i < text.length(); ++i)
    result += static_cast<char16_t>(text[i]);
  return result;
}

std::string shownMessage(int row, int severity, const std::string& text,
                         int ref, const std::string& source) {
  return std::to_string(row) + "/" + std::to_string(severity) + " " + text +
         " [" + (ref == kNone ? "" : "ref " + std::to_string(ref)) + "|" +
         source + "]";
}

LibraryModel::LibraryModel(Model& model)
    : m_Context(kyText(model.contextId)),
      m_Partition(model.rootDepth < 3 ? nullptr : &m_Context),
      m_IvData(model.rootDepth < 2 ? nullptr : &m_Partition) {
  HX_MessageHandler::instance().clear();
  GLB_SetModelName(kyText(model.modelName));
  GLB_SetSubsystemName(kyText(model.subsystemName));
  m_Options.setHxSystemID(kyText(model.optionsId));
  m_Options.setLimitVariableNameLength(model.limitsNames);
  HxCGlobal::setOptions(&m_Options);
  HxCGlobal::setDataTypeServer(&m_TypeServer);
  HxCGlobal::setIvData(model.rootDepth == 0 ? nullptr : &m_IvData);
  HxCGlobal::setSlBlockHandlesDB(&m_Handles);
  for (const Text& id : model.charts) m_Charts.emplace_back(kyText(id));
  for (const Object& o : model.objects) {
    SC_Chart* const chart = entry(m_Charts, o.chart);
    if (chart != nullptr)
      objects.emplace_back(new SC_State(o.id, o.number, kyText(o.name), chart));
    else
      objects.emplace_back(new SC_Model(o.id, o.number, kyText(o.name)));
    objects.back()->setSFName(kyText(o.sfName));
    objects.back()->setHierarchy(kyText(o.hierarchy));
  }
  const auto stateOf = [this](int object) {
    return static_cast<SC_State*>(entry(objects, object));
  };
  for (const Block& b : model.blocks) {
    HX_Block* const parent = entry(blocks, b.parent);
    if (b.isChart) {
      auto block = std::make_unique<HX_StateflowBlock>(kyText(b.name), parent);
      block->setChartState(stateOf(b.chartState));
      blocks.push_back(std::move(block));
    } else {
      blocks.emplace_back(new HX_Block(kyText(b.name), parent));
    }
    if (b.isSubsystem)
      blocks.back()->setSubsystem(kyText(b.systemId), b.number);
    blocks.back()->setNamedThroughParent(b.isNamedThroughParent);
    if (b.handle >= 0)
      m_Handles.setSlBlockHandle(blocks.back().get(), b.handle);
  }
  for (std::size_t i = 0; i < objects.size(); ++i) {
    objects[i]->setContainingBlock(entry(blocks, model.objects[i].block));
    SC_ModelAccess::setChartState(objects[i].get(),
                                  stateOf(model.objects[i].chartState));
  }
  for (InputBlock& input : model.inputs)
    input.handle = m_Tree.addBlock(kyText(input.name));
  for (std::size_t i = 0; i < model.inputs.size(); ++i) {
    const int parent = model.inputs[i].parent, number = idOf(i);
    const InputBlock* above = entry(model.inputs, parent);
    m_Tree.setParentPath(model.inputs[i].handle,
                         above != nullptr ? m_Tree.getPath(above->handle) : "");
    m_InputHandles.setSlBlockHandle(number, model.inputs[i].handle);
    inputs.push_back(std::make_unique<HX_InputBlockId>(m_InputHandles, number));
  }
  inputs.push_back(std::make_unique<HX_InputBlockId>(m_InputHandles, 99));
  const InputBlock* const system = entry(model.inputs, model.system);
  GLB_SetFullSystemPath(system != nullptr ? m_Tree.getPath(system->handle)
                                          : "");
  HX_SimulinkInterface::setTree(&m_Tree);
  makeDictionary(model);
  makeTypes(model);
  makeRefs(model);
  for (const IvBlock& b : model.ivBlocks)
    ivBlocks.emplace_back(kyText(b.rawName), entry(refs, b.ref));
  for (const Symbol& s : model.symbols) {
    symbols.emplace_back(kyText(s.name), s.kind, entry(types, s.type));
    symbols.back().setDollarX(narrow(s.dollarX).c_str());
  }
}

LibraryModel::~LibraryModel() {
  HxCGlobal::setOptions(nullptr);
  HxCGlobal::setDataTypeServer(nullptr);
  HxCGlobal::setIvData(nullptr);
  HxCGlobal::setSlBlockHandlesDB(nullptr);
  HX_SimulinkInterface::setTree(nullptr);
  GLB_SetFullSystemPath("");
  HX_DdTree::instance().clear();
  HX_MessageHandler::instance().clear();
}

void LibraryModel::makeTypes(const Model& model) {
  for (const Type& t : model.types) {
    types.emplace_back(kyText(t.name));
    HX_DataType& type = types.back();
    if (t.hasCut) type.setCut(kyText(t.cut));
    if (t.unnamed != 0)
      type.setUnnamed(t.unnamed == 1 ? HX_DataType::eUnnamedStruct
                                     : HX_DataType::eUnnamedEnum,
                      t.hasNameObject);
    if (t.isBitfield) type.setBitfield();
    if (t.isBase) type.setBase();
    if (t.is64Bit) type.set64BitInteger();
    if (t.isNumerical) type.setNumerical(t.isSigned ? &m_Signed : &m_Unsigned);
    type.setOrigin(entry(types, t.origin));
    if (t.isDerived) type.setDerivedFrom(entry(types, t.origin));
    type.setUnderlyingType(entry(types, t.underlying));
    type.setElement(entry(types, t.element));
  }
  m_TypeServer.getBaseServer()->setBitfieldBaseType(
      entry(types, model.bitfieldBase));
}

void LibraryModel::makeDictionary(Model& model) {
  HX_DdTree& tree = HX_DdTree::instance();
  tree.clear();
  for (DdObject& object : model.dd) object.handle = tree.add(object.path);
  const std::string pool = "//DD0/Pool/Autosar/SoftwareComponents";
  if (model.hasComponents) tree.add(pool);
  for (const Component& component : model.components) {
    const std::string path = pool + "/" + component.name;
    tree.add(path, HX_DdTree::kSoftwareComponent);
    if (component.relatedVariables.empty()) continue;
    const unsigned long list = tree.add(path + "/RelatedVariables");
    for (const Component::Property& property : component.relatedVariables)
      tree.addReference(list, property.name, property.path);
  }
  for (Ref& ref : model.refs)
    if (ref.kind == Ref::eDd && ref.target != kNone)
      ref.handle = Model::at(model.dd, ref.target).handle;
}

void LibraryModel::makeRefs(const Model& model) {
  firstNumber = HxCSrcRef().getSrcRefId() + 1;
  const std::size_t own = blocks.size() + objects.size();
  for (std::size_t i = 0; i < model.refs.size(); ++i) {
    const Ref& r = model.refs[i];
    HxCSrcRef* made = nullptr;
    if (r.kind == Ref::eBlock && i < own) {
      refs.push_back(entry(blocks, r.target)->getSrcRef());
    } else if (r.kind == Ref::eStateflow && i < own) {
      refs.push_back(entry(objects, r.target)->getStateflowSrcRef());
    } else if (r.kind == Ref::eBlock) {
      const HX_Block other("other");
      HxCBlockSrcRef* block = HX_Block::dupSrcRef(*other.getSrcRef());
      block->setBlock(entry(blocks, r.target));
      made = block;
    } else if (r.kind == Ref::eStateflow) {
      made = new HxCStateflowSrcRef();
    } else if (r.kind == Ref::eDd) {
      made = new HxCDdSrcRef(r.handle);
    } else if (r.kind == Ref::eInput) {
      made = new HxCInputBlockSrcRef(
          r.target == kNone ? *inputs.back() : *entry(inputs, r.target));
    } else if (r.kind == Ref::eInternal) {
      made = new HxCInternalSrcRef(kyText(r.file), r.line, kyText(r.cause));
    } else {
      made = new HxCSrcRef();
    }
    if (made == nullptr) continue;
    m_OwnedRefs.emplace_back(made);
    refs.push_back(made);
  }
}

int LibraryModel::indexOf(const HxCSrcRef* ref) const {
  for (std::size_t i = 0; i < refs.size(); ++i)
    if (refs[i] == ref) return idOf(i);
  return ref == nullptr ? kNone : -2;
}

std::vector<std::string> LibraryModel::takeMessages() const {
  std::vector<std::string> texts;
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  for (const HX_Message& m : handler.messages())
    texts.push_back(m.row == 7 ? "7"
                               : shownMessage(m.row, m.severity, m.text,
                                              indexOf(m.srcRef), m.source));
  handler.clear();
  return texts;
}

std::string firstDifference(const std::vector<std::string>& calls,
                            const std::vector<std::string>& library,
                            const std::vector<std::string>& plain) {
  for (std::size_t i = 0; i < calls.size(); ++i)
    if (library[i] != plain[i])
      return "differs:" + calls[i] + "\nlibrary: " + library[i] +
             "\nplain:   " + plain[i];
  return "";
}

}  // namespace plain
