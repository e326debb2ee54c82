// The data types of a model.
#include <cfloat>
#include <cmath>
#include <set>

#include "host/base/HX_Text.h"
#include "host/model/HX_ModelReaders.h"

namespace {

// Ranges of the arithmetic types on two's complement machines.
const std::map<HX_CType, HX_NumericalType> kCTypeRanges = {
    {HX_CType::eSignedChar, {-128, 127, 8, true}},
    {HX_CType::eUnsignedChar, {0, 255, 8, false}},
    {HX_CType::eShort, {-32768, 32767, 16, true}},
    {HX_CType::eUnsignedShort, {0, 65535, 16, false}},
    {HX_CType::eInt, {-2147483648.0, 2147483647, 32, true}},
    {HX_CType::eUnsignedInt, {0, 4294967295.0, 32, false}},
    {HX_CType::eFloat, {-FLT_MAX, FLT_MAX, 32, true}},
    {HX_CType::eDouble, {-DBL_MAX, DBL_MAX, 64, true}},
};

// Tells the library the properties that follow from the kind.
void completeKind(const HX_Json& node, HX_TypeItem& item) {
  HX_DataType& type = item.type;
  HX_DataType* of = item.of != nullptr ? &item.of->type : nullptr;
  switch (item.kind) {
    case HX_TypeKind::eBase:
      type.setBase();
      item.numerical = kCTypeRanges.at(*item.cType);
      break;
    case HX_TypeKind::eDerived:
      type.setDerivedFrom(of);
      break;
    case HX_TypeKind::eNumerical:
      type.setOrigin(of).setUnderlyingType(of);
      break;
    case HX_TypeKind::eArray:
      type.setElement(of);
      break;
    case HX_TypeKind::eStruct:
      type.setUnnamed(HX_DataType::eUnnamedStruct, !item.isNameless);
      break;
    case HX_TypeKind::eEnum:
      type.setUnnamed(HX_DataType::eUnnamedEnum, !item.isNameless);
      break;
    case HX_TypeKind::eBitField:
      type.setBitfield();
      item.numerical.emplace(0, std::ldexp(1, item.bits) - 1, item.bits, false);
      break;
    case HX_TypeKind::eInteger64:
      type.set64BitInteger();
      if (node.value("signed", true))
        item.numerical.emplace(-0x1p63, 0x1p63, 64, true);
      else
        item.numerical.emplace(0, 0x1p64, 64, false);
      break;
  }
}

class TypeReader {
 public:
  TypeReader(HX_Model& model, HX_TypeIds& ids) : m_Model(model), m_Ids(ids) {}

  void begin(const HX_Json& node) {
    HX_TypeItem& item = m_Model.types.emplace_back(HX_FromUtf8(node["name"]));
    item.id = node["id"];
    item.name = node["name"];
    item.kind =
        HX_ValueOf(kHxTypeKinds, node["kind"].get_ref<const std::string&>());
    if (node.contains("c"))
      item.cType =
          HX_ValueOf(kHxCTypes, node["c"].get_ref<const std::string&>());
    item.bits = node.value("bits", 0);
    item.length = node.value("length", 0);
    item.isNameless = node.value("nameless", false);
    if (node.contains("cut")) item.type.setCut(HX_FromUtf8(node["cut"]));
    m_Ids.enter(node, &item);
    if (!item.isNameless) takeCodeName(node["name"]);
  }

  // A type may stand on a later one.
  void complete(const HX_Json& node, HX_TypeItem& item) {
    if (node.contains("of")) item.of = HX_FindDeclarableType(m_Ids, node["of"]);
    if (item.kind == HX_TypeKind::eDerived &&
        item.of->type.getBaseTypeProperties() == nullptr)
      m_Ids.document.fail(node["of"], "the id of a type with a cut");
    completeKind(node, item);
    for (const HX_Json& field : HX_FieldOrEmpty(node, "fields")) {
      HX_TypeItem* type = m_Ids.find(field["type"]);
      if (type->kind != HX_TypeKind::eBitField)
        type = HX_FindDeclarableType(m_Ids, field["type"]);
      item.fields.push_back({field["name"], type});
    }
    for (const HX_Json& value : HX_FieldOrEmpty(node, "values")) {
      takeCodeName(value["name"]);
      item.values.push_back({value["name"], value["value"]});
    }
  }

 private:
  // Types and enumeration constants share the names of the file.
  void takeCodeName(const HX_Json& name) {
    if (!m_CodeNames.insert(name).second)
      m_Ids.document.fail(name,
                          "a name that is not taken yet, found " + name.dump());
  }

  HX_Model& m_Model;
  HX_TypeIds& m_Ids;
  std::set<std::string> m_CodeNames;
};

}  // namespace

const HX_TypeItem* HX_TypeItem::scalar() const {
  const HX_TypeItem* item = this;
  const HX_TypeItem* slow = this;  // one step for two steps of item
  for (bool isSlowDue = false; item->of != nullptr; isSlowDue = !isSlowDue) {
    item = item->of;
    if (isSlowDue) slow = slow->of;
    if (item == slow) return nullptr;
  }
  return item;
}

HX_TypeItem* HX_FindDeclarableType(const HX_TypeIds& ids, const HX_Json& id) {
  HX_TypeItem* type = ids.find(id);
  if (type->isNameless || type->kind == HX_TypeKind::eBitField)
    ids.document.fail(id, "the id of a type with a name, no bit field");
  return type;
}

void HX_ReadTypes(const HX_Json& types, HX_Model& model, HX_TypeIds& ids) {
  TypeReader reader(model, ids);
  for (const HX_Json& node : types) reader.begin(node);
  std::size_t index = 0;
  for (const HX_Json& node : types) reader.complete(node, model.types[index++]);

  HX_TypeItem* bitFieldBase = nullptr;  // least id
  for (HX_TypeItem& item : model.types) {
    const bool isBase = item.cType == HX_CType::eUnsignedInt;
    if (isBase && (bitFieldBase == nullptr || item.id < bitFieldBase->id))
      bitFieldBase = &item;
    const HX_TypeItem* scalar = item.scalar();
    if (scalar == nullptr || !scalar->numerical ||
        item.kind == HX_TypeKind::eArray)
      continue;
    item.type.setNumerical(const_cast<HX_NumericalType*>(&*scalar->numerical));
  }
  if (bitFieldBase != nullptr)
    model.typeServer.getBaseServer()->setBitfieldBaseType(&bitFieldBase->type);
}
