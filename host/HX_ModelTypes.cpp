// The data types of a model.
#include <cfloat>

#include "host/HX_Model.h"
#include "host/HX_ModelIds.h"
#include "host/HX_Text.h"

namespace {

// The arithmetic types of C as two's complement machines have them.
struct CTypeRow {
  const char* name;
  double minimum;
  double maximum;
  int bits;
  bool isSigned;
};

constexpr CTypeRow kCTypes[] = {
    {"signed char", -128, 127, 8, true},
    {"unsigned char", 0, 255, 8, false},
    {"short", -32768, 32767, 16, true},
    {"unsigned short", 0, 65535, 16, false},
    {"int", -2147483648.0, 2147483647, 32, true},
    {"unsigned int", 0, 4294967295.0, 32, false},
    {"float", -FLT_MAX, FLT_MAX, 32, true},
    {"double", -DBL_MAX, DBL_MAX, 64, true},
};

void completeDerived(const HX_DocumentNode& node, HX_TypeItem& item) {
  if (item.of->type.getBaseTypeProperties() == nullptr)
    node.at("of").fail("the id of a type with a cut");
  item.type.setDerivedFrom(&item.of->type);
}

void completeInteger64(const HX_DocumentNode& node, HX_TypeItem& item) {
  const double size = 18446744073709551616.0;  // 2^64
  if (node.flag("signed", true))
    item.numerical.emplace(-size / 2, size / 2, 64, true);
  else
    item.numerical.emplace(0, size, 64, false);
  item.type.set64BitInteger();
}

void completeBitField(const HX_DocumentNode& node, HX_TypeItem& item) {
  item.bits = node.integer("bits", 1);
  item.numerical.emplace(0, static_cast<double>((1LL << item.bits) - 1),
                         item.bits, false);
  item.type.setBitfield();
}

struct KindRow {
  const char* kind;
  void (*complete)(const HX_DocumentNode& node, HX_TypeItem& item);
};

constexpr KindRow kKinds[] = {
    {"base",
     [](const HX_DocumentNode&, HX_TypeItem& item) { item.type.setBase(); }},
    {"derived", completeDerived},
    {"numerical",
     [](const HX_DocumentNode&, HX_TypeItem& item) {
       item.type.setOrigin(&item.of->type).setUnderlyingType(&item.of->type);
     }},
    {"integer64", completeInteger64},
    {"array", [](const HX_DocumentNode&,
                 HX_TypeItem& item) { item.type.setElement(&item.of->type); }},
    {"bitField", completeBitField},
    {"struct",
     [](const HX_DocumentNode&, HX_TypeItem& item) {
       item.type.setUnnamed(HX_DataType::eUnnamedStruct, !item.isNameless);
     }},
    {"enum",
     [](const HX_DocumentNode&, HX_TypeItem& item) {
       item.type.setUnnamed(HX_DataType::eUnnamedEnum, !item.isNameless);
     }},
};

}  // namespace

const HX_TypeItem* HX_TypeItem::scalar() const {
  const HX_TypeItem* item = this;
  const HX_TypeItem* late = this;  // walks at half the speed
  bool isLateDue = false;
  while (item->of != nullptr) {
    item = item->of;
    if (isLateDue) late = late->of;
    isLateDue = !isLateDue;
    if (item == late) return nullptr;
  }
  return item;
}

std::size_t HX_TypeItem::elementCount() const {
  std::size_t count = 1;
  if (scalar() == nullptr) return count;
  for (const HX_TypeItem* item = this; item != nullptr; item = item->of) {
    if (item->kind == "array") count *= static_cast<std::size_t>(item->length);
  }
  return count;
}

void HX_Model::readTypes(const HX_DocumentNode& root) {
  root.forEach("types", [&](const HX_DocumentNode& node) {
    m_Types.push_back(
        std::make_unique<HX_TypeItem>(HX_FromUtf8(node.text("name"))));
    HX_TypeItem& item = *m_Types.back();
    item.id = node.text("id");
    item.name = node.text("name");
    item.kind = node.text("kind");
    item.cType = node.text("c");
    item.length = node.integer("length", 0);
    item.isNameless = node.flag("nameless", false);
    if (node.has("cut")) item.type.setCut(HX_FromUtf8(node.text("cut")));
    for (const CTypeRow& row : kCTypes) {
      if (item.cType == row.name)
        item.numerical.emplace(row.minimum, row.maximum, row.bits,
                               row.isSigned);
    }
    enter(node, m_TypesById, &item);
    if (!item.isNameless) takeCodeName(node.at("name"));
  });

  // A later type may stand on an earlier one and the other way round.
  std::size_t index = 0;
  root.forEach("types", [&](const HX_DocumentNode& node) {
    completeType(node, *m_Types[index++]);
  });
  for (const auto& [id, item] : m_TypesById) {
    const bool isBitfieldBase =
        item->cType == "unsigned int" &&
        m_TypeServer.getBaseServer()->getBitfieldBaseType() == nullptr;
    if (isBitfieldBase)
      m_TypeServer.getBaseServer()->setBitfieldBaseType(&item->type);
    const HX_TypeItem* scalar = item->scalar();
    if (scalar == nullptr || !scalar->numerical || item->kind == "array")
      continue;
    item->type.setNumerical(const_cast<HX_NumericalType*>(&*scalar->numerical));
  }
}

void HX_Model::completeType(const HX_DocumentNode& node, HX_TypeItem& item) {
  if (node.has("of")) item.of = findNamedType(node.at("of"));
  for (const KindRow& row : kKinds) {
    if (item.kind == row.kind) row.complete(node, item);
  }
  node.forEach("fields", [&](const HX_DocumentNode& field) {
    HX_TypeItem* type = find(field.at("type"), m_TypesById, "a type");
    if (type->kind != "bitField") type = findNamedType(field.at("type"));
    item.fields.emplace_back(field.text("name"), type);
  });
  node.forEach("values", [&](const HX_DocumentNode& value) {
    takeCodeName(value.at("name"));
    item.values.emplace_back(value.text("name"), value.integer("value", 0));
  });
}

// A type that the code can declare something with.
HX_TypeItem* HX_Model::findNamedType(const HX_DocumentNode& id) const {
  HX_TypeItem* type = find(id, m_TypesById, "a type");
  if (type->isNameless || type->kind == "bitField")
    id.fail("the id of a type with a name, no bit field");
  return type;
}

// Types and enumeration constants share the names of the file.
void HX_Model::takeCodeName(const HX_DocumentNode& name) {
  if (!m_CodeNames.insert(name.value().get<std::string>()).second)
    name.fail("a name that is not taken yet, found " + name.value().dump());
}
