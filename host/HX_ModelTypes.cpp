// The data types of a model.
#include <cfloat>

#include "host/HX_ModelReader.h"
#include "host/HX_Text.h"

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

void completeInteger64(const HX_Json& node, HX_TypeItem& item) {
  const double size = 18446744073709551616.0;  // 2^64
  if (node.value("signed", true))
    item.numerical.emplace(-size / 2, size / 2, 64, true);
  else
    item.numerical.emplace(0, size, 64, false);
  item.type.set64BitInteger();
}

void completeBitField(const HX_Json&, HX_TypeItem& item) {
  const auto largest = static_cast<double>((1LL << item.bits) - 1);
  item.numerical.emplace(0, largest, item.bits, false);
  item.type.setBitfield();
}

using Complete = void (*)(const HX_Json& node, HX_TypeItem& item);

const std::map<std::string, Complete> kKinds = {
    {"base",
     [](const HX_Json&, HX_TypeItem& item) {
       item.numerical = kCTypes.at(item.cType);
       item.type.setBase();
     }},
    {"derived",
     [](const HX_Json&, HX_TypeItem& item) {
       item.type.setDerivedFrom(&item.of->type);
     }},
    {"numerical",
     [](const HX_Json&, HX_TypeItem& item) {
       item.type.setOrigin(&item.of->type).setUnderlyingType(&item.of->type);
     }},
    {"integer64", completeInteger64},
    {"array", [](const HX_Json&,
                 HX_TypeItem& item) { item.type.setElement(&item.of->type); }},
    {"bitField", completeBitField},
    {"struct",
     [](const HX_Json&, HX_TypeItem& item) {
       item.type.setUnnamed(HX_DataType::eUnnamedStruct, !item.isNameless);
     }},
    {"enum",
     [](const HX_Json&, HX_TypeItem& item) {
       item.type.setUnnamed(HX_DataType::eUnnamedEnum, !item.isNameless);
     }},
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

void HX_ModelReader::readTypes(Json types) {
  for (Json node : types) {
    HX_TypeItem& item = m_Model.types.emplace_back(HX_FromUtf8(node["name"]));
    item.id = node["id"];
    item.name = node["name"];
    item.kind = node["kind"];
    item.cType = node.value("c", "");
    item.bits = node.value("bits", 0);
    item.length = node.value("length", 0);
    item.isNameless = node.value("nameless", false);
    if (node.contains("cut")) item.type.setCut(HX_FromUtf8(node["cut"]));
    m_Types.enter(node, &item);
    if (!item.isNameless) takeCodeName(node["name"]);
  }
  // A later type may stand on an earlier one and the other way round.
  std::size_t index = 0;
  for (Json node : types) completeType(node, m_Model.types[index++]);

  HX_TypeItem* bitFieldBase = nullptr;  // that with the least id
  for (HX_TypeItem& item : m_Model.types) {
    const bool isBase = item.cType == "unsigned int";
    if (isBase && (bitFieldBase == nullptr || item.id < bitFieldBase->id))
      bitFieldBase = &item;
    const HX_TypeItem* scalar = item.scalar();
    if (scalar == nullptr || !scalar->numerical || item.kind == "array")
      continue;
    item.type.setNumerical(const_cast<HX_NumericalType*>(&*scalar->numerical));
  }
  if (bitFieldBase != nullptr)
    m_Model.typeServer.getBaseServer()->setBitfieldBaseType(
        &bitFieldBase->type);
}

void HX_ModelReader::completeType(Json node, HX_TypeItem& item) {
  if (node.contains("of")) item.of = findNamedType(node["of"]);
  if (item.kind == "derived" &&
      item.of->type.getBaseTypeProperties() == nullptr)
    m_Document.fail(node["of"], "the id of a type with a cut");
  kKinds.at(item.kind)(node, item);
  for (Json field : HX_FieldOf(node, "fields")) {
    HX_TypeItem* type = m_Types.find(field["type"]);
    if (type->kind != "bitField") type = findNamedType(field["type"]);
    item.fields.emplace_back(field["name"], type);
  }
  for (Json value : HX_FieldOf(node, "values")) {
    takeCodeName(value["name"]);
    item.values.emplace_back(value["name"], value["value"].get<int>());
  }
}

// A type that the code can declare something with.
HX_TypeItem* HX_ModelReader::findNamedType(Json id) const {
  HX_TypeItem* type = m_Types.find(id);
  if (type->isNameless || type->kind == "bitField")
    m_Document.fail(id, "the id of a type with a name, no bit field");
  return type;
}

// Types and enumeration constants share the names of the file.
void HX_ModelReader::takeCodeName(Json name) {
  if (!m_CodeNames.insert(name).second)
    m_Document.fail(name, "a name that is not taken yet, found " + name.dump());
}
