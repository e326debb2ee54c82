// Names of an arbitrary model on the whole road from template to C name.
#include <cmath>
#include <cstdlib>
#include <set>

#include "NameSpace/HX_LimitedNameSpace.h"
#include "Naming/HxCNames.h"
#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCStateflowSrcRef.h"
#include "fuzz/HX_Fuzz.h"
#include "plain/HX_PlainCase.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/datatypes/HX_DataType.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HX_StateflowBlock.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/HxCSymbol.h"
#include "platform/model/SC_Chart.h"
#include "platform/model/SC_State.h"

namespace {

using Id = HxCCIdentifier;

// Blocks car / ctrl / gain and a chart block with an object, types of each
// kind, and dictionary objects in two components.
struct Model {
  explicit Model(HX_Bytes& bytes)
      : choices(bytes.line()),
        car(bytes.text()),
        ctrl(bytes.text(), &car),
        gain(bytes.text(), &ctrl),
        mode("Mode", &ctrl),
        ivBlock(bytes.text()),
        chart(bytes.text()),
        chartState(1, 4, bytes.text(), &chart),
        event(2, choices.number(), bytes.text()),
        types{{HX_DataType(bytes.text())}, {HX_DataType(bytes.text())},
              {HX_DataType("Array")},      {HX_DataType("unnamed")},
              {HX_DataType("Bits")},       {HX_DataType("Unknown")}},
        dd(HX_DdTree::instance().add(bytes.line())) {
    HxCNames::boot();
    HxCGlobal::setOptions(&options);
    HxCGlobal::setDataTypeServer(&typeServer);
    GLB_SetModelName(bytes.text());
    GLB_SetSubsystemName(bytes.text());
    options.setLimitVariableNameLength(choices.flag());
    options.setHxSystemID(bytes.text());
    ctrl.setSubsystem(bytes.text(), static_cast<unsigned>(choices.number()));
    gain.setNamedThroughParent(choices.flag());
    mode.setChartState(choices.flag() ? &chartState : nullptr);
    for (SC_Model* object : {static_cast<SC_Model*>(&chartState), &event}) {
      object->setContainingBlock(&mode);
      if (choices.flag()) SC_ModelAccess::setChartState(object, &chartState);
    }
    event.setHierarchy(bytes.text());
    types[0].setCut(bytes.text()).setBase();
    types[1].setDerivedFrom(choices.flag() ? &types[0] : nullptr);
    types[2].setElement(&types[choices.below(2)]);
    types[3].setUnnamed(choices.flag() ? HX_DataType::eUnnamedStruct
                                       : HX_DataType::eUnnamedEnum,
                        choices.flag());
    types[4].setBitfield();
    if (choices.flag())
      typeServer.getBaseServer()->setBitfieldBaseType(&types[0]);
    HX_DdTree& tree = HX_DdTree::instance();
    for (const std::string component : {"/Pool/C1", "/Pool/C2"}) {
      tree.add(component, HX_DdTree::kSoftwareComponent);
      const unsigned long list = tree.add(component + "/RelatedVariables");
      if (choices.flag()) tree.addReference(list, "Variable", bytes.line());
    }
  }
  Model(const Model&) = delete;
  Model& operator=(const Model&) = delete;
  ~Model() {
    HxCGlobal::setOptions(nullptr);
    HxCGlobal::setDataTypeServer(nullptr);
    HX_DdTree::instance().clear();
    HxCNames::shutdown();
    HX_MessageHandler::instance().clear();
  }

  HX_Bytes choices;
  HX_OptionsExt options;
  HX_DataTypeServer typeServer;
  HX_Block car, ctrl, gain;
  HX_StateflowBlock mode;
  HX_BdBlock ivBlock;
  SC_Chart chart;
  SC_State chartState;
  SC_Model event;
  HX_DataType types[6];
  HxCDdSrcRef dd;
};

std::size_t messageCount() {
  return HX_MessageHandler::instance().messages().size();
}

KyCXString bothNames(const Id& id) {
  return id.getCookedName(Id::eFormalName) + ":" +
         id.getCookedName(Id::eActualName);
}

// Arguments of one name.
struct Item {
  Item(Model& model, HX_Bytes& bytes)
      : isFormalActive(model.choices.flag()),
        label(bytes.text()),
        x(bytes.text()) {
    HX_Bytes& choices = model.choices;
    const HxCSrcRef* sources[] = {model.gain.getSrcRef(), nullptr,
                                  model.event.getStateflowSrcRef(),
                                  model.mode.getSrcRef(), &model.dd};
    source = sources[choices.below(5)];
    dd = choices.flag() ? &model.dd : nullptr;
    ivBlock = choices.flag() ? &model.ivBlock : nullptr;
    const int kind = choices.below(7);
    type = kind == 0 ? nullptr : &model.types[kind - 1];
    if (choices.flag()) return;
    for (unsigned int* bits : {&retained, &provisional})
      for (int shift = 0; shift < 24; shift += 8)
        *bits |= static_cast<unsigned>(choices.number()) << shift;
  }

  Id begin(const KyCXString& form) const {
    Id id(form);
    id.setSourceRef(source);
    id.setDdSourceRef(dd);
    id.setSourceIVBlock(ivBlock);
    id.setSignalLabel(label);
    id.setDollarXValue(x);
    if (!isFormalActive) id.activateActualName();
    return id;
  }
  bool expand(HxCNames& names, Id& id) const {
    return names.createNameFromForm(id, type, retained, provisional, false);
  }

  bool isFormalActive;
  KyCXString label, x;
  const HxCSrcRef* source;
  const HxCSrcRef* dd;
  HX_BdBlock* ivBlock;
  HX_DataType* type;
  unsigned int retained = 0;
  unsigned int provisional = 0;
};

void substitute(Model& model, HX_Bytes& bytes, const Item& item, Id& id) {
  HxCNames names;
  if (model.choices.flag()) {
    HxCSymbol symbol(item.label, 1 + model.choices.below(3), item.type);
    symbol.setDollarX(item.x.cstring());
    names.handleSymbolNameMacro(id, &symbol);
  }
  if (!model.choices.flag()) return;
  const double period = std::fabs(std::strtod(bytes.line().c_str(), nullptr));
  const double offset = std::strtod(bytes.line().c_str(), nullptr);
  names.replaceMultirateTimeName(id, period, offset, model.choices.flag());
  names.replaceMultirateTaskISRName(id, item.label, id, false);
  names.replaceMultirateMsgVarName(id, item.x);
}

// Expands and makes a C name of at most the length allowed.
void checkRoad(Model& model, const Item& item, Id& id) {
  HxCNames names;
  const bool isFile = model.choices.below(8) == 7;
  const auto expand = [&] {
    return isFile ? names.handleFileNameMacro(id, item.isFormalActive)
                  : item.expand(names, id);
  };
  expand();
  const KyCXString once = bothNames(id);
  const std::size_t messages = messageCount();
  HX_Require(expand(), "a name expanded in full is complete");
  HX_Require(bothNames(id) == once, "a name expanded in full is left alone");
  HX_Require(messageCount() == messages, "no message about a name left alone");
  id.makeCIdentifier();
  id.adaptSize();
  const bool mayBeLong = !id.getIdentifierChangeable(Id::eActiveName) ||
                         !model.options.getLimitVariableNameLength();
  for (const auto type : {Id::eFormalName, Id::eActualName}) {
    const KyCXString& name = id.getCookedName(type);
    HX_Require(name.isEmpty() || name.isValidCIdentifier(), "an identifier");
    HX_Require(mayBeLong || name.length() <= HxCSymbol::sm_MaxNameLength,
               "not too long");
  }
  Id again = id;
  again.makeCIdentifier();
  again.adaptSize();
  HX_Require(bothNames(again) == bothNames(id), "a C name is left alone");
}

// Derives a variant of a name: no word of C, and not given before.
void checkVariant(HX_LimitedNameSpace& taken, std::set<std::string>& given,
                  const KyCXString& wanted, bool isLimited) {
  HxCNames names;
  KyCXString variant = wanted;
  const auto isFree = [&names](const KyCXString& text) {
    const bool isValid =
        HxCNames::checkCVariableName(text) == HxCNames::eVariableNameValid;
    HX_Require(names.isStringValidCVariableName(text) == isValid,
               "the report and the silent answer agree");
    return isValid;
  };
  for (int i = 0; !isFree(variant); ++i) {
    variant = wanted;
    names.appendSuffix(variant, i);
  }
  taken.addUnique(variant);
  HX_Require(given.insert(variant.cstring()).second, "given once");
  if (variant == wanted) return;
  HX_Require(variant.isValidCIdentifier(), "derived: an identifier");
  HX_Require(!isLimited || variant.length() <= HxCSymbol::sm_MaxNameLength,
             "derived: not too long");
}

}  // namespace

// The plain form reads all bytes as choices. For the road of a name the first
// line chooses, and the texts of the model and of all names follow.
void HX_CheckNames(HX_Bytes& bytes) {
  const std::string choices = HX_Bytes(bytes).rest();
  const std::string difference = plain::differenceOfNames(choices, nullptr) +
                                 plain::differenceOfSrcRefs(choices, nullptr);
  HX_Require(difference.empty(), difference);
  constexpr int kNames = 40;
  Model model(bytes);
  HX_LimitedNameSpace taken;
  std::set<std::string> given;
  for (int i = 0; i == 0 || (i < kNames && !bytes.isEmpty()); ++i) {
    const KyCXString text = bytes.text();
    const Item item(model, bytes);
    Id id = item.begin(text);
    substitute(model, bytes, item, id);
    checkRoad(model, item, id);
    checkVariant(taken, given, id.getCookedName(Id::eActualName),
                 model.options.getLimitVariableNameLength());
  }
}
