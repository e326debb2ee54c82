// The data types of a model.
#include <cfloat>
#include <cmath>
#include <set>

#include "host/base/HX_Text.h"
#include "host/model/HX_ModelParts.h"

namespace {

// The arithmetic types of C as two's complement machines have them.
const std::map<std::string, HX_NumericalType> kCTypes = {
    {"signed char", {-128, 127, 8, true}},
    {"unsigned char", {0, 255, 8, false}},
    {"short", {-32768, 32767, 16, true}},
    {"unsigned short", {0, 65535, 16, false}},
    {"int", {-2147483648.0, 2147483647, 32, true}},
    {"unsigned int", {0, 4294967295.0, 32, false}},
    {"float", {-FLT_MAX, FLT_MAX, 32, true}},
    {"double", {-DBL_MAX, DBL_MAX, 64, true}},
};

// What the library is told of a type depends on its kind.
void completeKind(const HX_Json& node, HX_TypeItem& item) {
  HX_DataType& type = item.type;
  HX_DataType* of = item.of != nullptr ? &item.of->type : nullptr;
  if (item.kind == "base") {
    type.setBase();
    item.numerical = kCTypes.at(item.cType);
  } else if (item.kind == "derived") {
    type.setDerivedFrom(of);
  } else if (item.kind == "numerical") {
    type.setOrigin(of).setUnderlyingType(of);
  } else if (item.kind == "array") {
    type.setElement(of);
  } else if (item.kind == "struct") {
    type.setUnnamed(HX_DataType::eUnnamedStruct, !item.isNameless);
  } else if (item.kind == "enum") {
    type.setUnnamed(HX_DataType::eUnnamedEnum, !item.isNameless);
  } else if (item.kind == "bitField") {
    type.setBitfield();
    item.numerical.emplace(0, std::ldexp(1, item.bits) - 1, item.bits, false);
  } else if (node.value("signed", true)) {
    type.set64BitInteger();
    item.numerical.emplace(-0x1p63, 0x1p63, 64, true);
  } else {
    type.set64BitInteger();
    item.numerical.emplace(0, 0x1p64, 64, false);
  }
}

class TypeReader {
 public:
  TypeReader(HX_Model& model, HX_TypeIds& ids) : m_Model(model), m_Ids(ids) {}

  void begin(const HX_Json& node) {
    HX_TypeItem& item = m_Model.types.emplace_back(HX_FromUtf8(node["name"]));
    item.id = node["id"];
    item.name = node["name"];
    item.kind = node["kind"];
    item.cType = node.value("c", "");
    item.bits = node.value("bits", 0);
    item.length = node.value("length", 0);
    item.isNameless = node.value("nameless", false);
    if (node.contains("cut")) item.type.setCut(HX_FromUtf8(node["cut"]));
    m_Ids.enter(node, &item);
    if (!item.isNameless) takeCodeName(node["name"]);
  }

  // A type may stand on a later one.
  void complete(const HX_Json& node, HX_TypeItem& item) {
    if (node.contains("of")) item.of = HX_FindNamedType(m_Ids, node["of"]);
    if (item.kind == "derived" &&
        item.of->type.getBaseTypeProperties() == nullptr)
      m_Ids.document.fail(node["of"], "the id of a type with a cut");
    completeKind(node, item);
    for (const HX_Json& field : HX_FieldOf(node, "fields")) {
      HX_TypeItem* type = m_Ids.find(field["type"]);
      if (type->kind != "bitField")
        type = HX_FindNamedType(m_Ids, field["type"]);
      item.fields.emplace_back(field["name"], type);
    }
    for (const HX_Json& value : HX_FieldOf(node, "values")) {
      takeCodeName(value["name"]);
      item.values.emplace_back(value["name"], value["value"].get<int>());
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
  const HX_TypeItem* late = this;  // walks at half the speed
  for (bool isLateDue = false; item->of != nullptr; isLateDue = !isLateDue) {
    item = item->of;
    if (isLateDue) late = late->of;
    if (item == late) return nullptr;
  }
  return item;
}

HX_TypeItem* HX_FindNamedType(const HX_TypeIds& ids, const HX_Json& id) {
  HX_TypeItem* type = ids.find(id);
  if (type->isNameless || type->kind == "bitField")
    ids.document.fail(id, "the id of a type with a name, no bit field");
  return type;
}

void HX_ReadTypes(const HX_Json& types, HX_Model& model, HX_TypeIds& ids) {
  TypeReader reader(model, ids);
  for (const HX_Json& node : types) reader.begin(node);
  std::size_t index = 0;
  for (const HX_Json& node : types) reader.complete(node, model.types[index++]);

  HX_TypeItem* bitFieldBase = nullptr;  // that with the least id
  for (HX_TypeItem& item : model.types) {
    const bool isBase = item.cType == "unsigned int";
    if (isBase && (bitFieldBase == nullptr || item.id < bitFieldBase->id))
      bitFieldBase = &item;
    const HX_TypeItem* scalar = item.scalar();
    if (scalar == nullptr || !scalar->numerical || item.kind == "array")
      continue;
    item.type.setNumerical(const_cast<HX_NumericalType*>(&*scalar->numerical));
  }
  if (bitFieldBase != nullptr)
    model.typeServer.getBaseServer()->setBitfieldBaseType(&bitFieldBase->type);
}
