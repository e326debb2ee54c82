#include "plain/HX_PlainCase.h"
#include "plain/HX_PlainNames.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/datadictionary/kyddapi.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HxCGlobal.h"

namespace plain {

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
    const int parent = model.inputs[i].parent, number = static_cast<int>(i);
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
  for (std::size_t i = 0; i < model.refs.size(); ++i) {
    const Ref& r = model.refs[i];
    HxCSrcRef* made = nullptr;
    if (r.kind == Ref::eBlock && i < ownRefs()) {
      refs.push_back(entry(blocks, r.target)->getSrcRef());
    } else if (r.kind == Ref::eStateflow && i < ownRefs()) {
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
    if (refs[i] == ref) return static_cast<int>(i);
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
  if (DDAPIHeapBalance() != 0) texts.push_back("text of the dictionary kept");
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
