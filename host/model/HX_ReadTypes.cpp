// The data types of a model.
#include <algorithm>
#include <cfloat>
#include <cmath>

#include "host/model/HX_ModelReading.h"
#include "host/model/HX_TypeOrder.h"

namespace {

using Reading = HX_ModelReading;
using Value = HX_BoundValue;

// Ranges of the arithmetic types on two's complement machines.
HX_NumericalType rangeOf(HX_CType type) {
  static const std::map<HX_CType, HX_NumericalType> s_Ranges = {
      {HX_CType::eSignedChar, {-128, 127, 8, true}},
      {HX_CType::eUnsignedChar, {0, 255, 8, false}},
      {HX_CType::eShort, {-32768, 32767, 16, true}},
      {HX_CType::eUnsignedShort, {0, 65535, 16, false}},
      {HX_CType::eInt, {-2147483648.0, 2147483647, 32, true}},
      {HX_CType::eUnsignedInt, {0, 4294967295.0, 32, false}},
      {HX_CType::eFloat, {-FLT_MAX, FLT_MAX, 32, true}},
      {HX_CType::eDouble, {-DBL_MAX, DBL_MAX, 64, true}},
  };
  return s_Ranges.at(type);
}

// The types of <stdint.h> of C99: [u]int[_least|_fast]N_t, [u]intptr_t,
// [u]intmax_t.
bool isStdintName(std::string_view name) {
  if (name.starts_with('u')) name.remove_prefix(1);
  if (!name.starts_with("int") || !name.ends_with("_t")) return false;
  name = name.substr(3, name.size() - 5);
  if (name == "ptr" || name == "max") return true;
  for (const std::string_view kind : {"_least", "_fast"})
    if (name.starts_with(kind)) name.remove_prefix(kind.size());
  return name == "8" || name == "16" || name == "32" || name == "64";
}

HX_TypeRecord& type(Reading& r) { return r.types.back(); }

void endType(Reading& r, bool isFaulty) {
  type(r).isFaulty = isFaulty;
  if (!type(r).id.isGiven()) r.typeIds.isWhole = false;
}

constexpr HX_FieldBinding kBindings[] = {
    {"type", nullptr,
     [](Reading& r, HX_TokenEnd place) {
       r.types.emplace_back().place = place;
     },
     endType},
    {"type.id",
     [](Reading& r, const Value& v) { type(r).id = r.typeIds.use(v); }},
    {"type.name",
     [](Reading& r, const Value& v) {
       type(r).name = v.text;
       type(r).namePlace = v.place;
     }},
    {"type.kind",
     [](Reading& r, const Value& v) {
       type(r).kind = HX_ValueOf(kHxTypeKinds, v.text);
     }},
    {"type.c",
     [](Reading& r, const Value& v) {
       type(r).cType = HX_ValueOf(kHxCTypes, v.text);
     }},
    {"type.bits",
     [](Reading& r, const Value& v) { type(r).bits = v.integer(); }},
    {"type.signed",
     [](Reading& r, const Value& v) { type(r).isSigned = v.boolean; }},
    {"type.cut",
     [](Reading& r, const Value& v) { type(r).cut = v.nameText(); }},
    {"type.of",
     [](Reading& r, const Value& v) { type(r).of = r.typeIds.use(v); }},
    {"type.length",
     [](Reading& r, const Value& v) { type(r).length = v.integer(); }},
    {"type.nameless",
     [](Reading& r, const Value& v) { type(r).isNameless = v.boolean; }},
    {"type.fields", nullptr,
     [](Reading& r, HX_TokenEnd) { type(r).fields.emplace_back(); }},
    {"type.fields.name",
     [](Reading& r, const Value& v) {
       type(r).fields.back().name = v.text;
       type(r).fields.back().namePlace = v.place;
     }},
    {"type.fields.type",
     [](Reading& r, const Value& v) {
       type(r).fields.back().type = r.typeIds.use(v);
     }},
    {"type.values", nullptr,
     [](Reading& r, HX_TokenEnd) { type(r).values.emplace_back(); }},
    {"type.values.name",
     [](Reading& r, const Value& v) {
       type(r).values.back().name = v.text;
       type(r).values.back().namePlace = v.place;
     }},
    {"type.values.value",
     [](Reading& r, const Value& v) {
       type(r).values.back().value = v.integer();
     }},
};

// Tells the library the properties that follow from the kind.
void completeKind(const HX_TypeRecord& record, HX_TypeItem& item) {
  HX_DataType& type = item.type;
  HX_DataType* of = item.of != nullptr ? &item.of->type : nullptr;
  switch (item.kind) {
    case HX_TypeKind::eBase:
      type.setBase();
      item.numerical = rangeOf(*item.cType);
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
      if (record.isSigned)
        item.numerical.emplace(-0x1p63, 0x1p63, 64, true);
      else
        item.numerical.emplace(0, 0x1p64, 64, false);
      break;
  }
}

/// Makes the types of the model from the records.
class Maker {
 public:
  explicit Maker(Reading& reading)
      : m_Reading(reading), m_Types(reading.model.types) {}

  void make() {
    for (const HX_TypeRecord& record : m_Reading.types) begin(record);
    std::size_t index = 0;
    for (HX_TypeRecord& record : m_Reading.types)
      complete(record, m_Types[index++]);
    HX_CheckTypeOrder(m_Reading);
    if (m_Reading.areChainsShort) completeStorage();
  }

 private:
  void begin(const HX_TypeRecord& record) {
    m_Reading.define(m_Reading.typeIds, record.id, m_Types.size());
    HX_TypeItem& item = m_Types.emplace_back(HX_FromUtf8(record.name));
    if (record.id.isGiven()) item.id = m_Reading.typeIds.text(record.id.entry);
    item.name = record.name;
    item.kind = record.kind;
    item.cType = record.cType;
    item.bits = record.bits;
    item.length = record.length;
    item.isNameless = record.isNameless;
    item.place = record.namePlace;
    item.index = m_Types.size() - 1;
    if (record.cut) item.type.setCut(*record.cut);
    if (item.isNameless) return;
    takeCodeName(record.name, record.namePlace);
    checkStdint(record);
  }

  // <stdint.h> defines its types itself, those of the same plain type only.
  void checkStdint(const HX_TypeRecord& record) {
    if (!m_Reading.model.code.usesStdint) return;
    const auto row = std::find_if(
        std::begin(kHxStdintTypes), std::end(kHxStdintTypes),
        [&](const auto& each) { return each.word == record.name; });
    const bool isSame = row != std::end(kHxStdintTypes) &&
                        record.kind == HX_TypeKind::eBase &&
                        record.cType == row->value;
    if (!isSame && isStdintName(record.name))
      m_Reading.faults.add(record.namePlace, HX_Quoted(record.name),
                           "a name that <stdint.h> does not define");
  }

  // A type may stand on a later type.
  void complete(HX_TypeRecord& record, HX_TypeItem& item) {
    if (record.isFaulty) return;
    if (record.of.isGiven())
      item.of = HX_FindDeclarableType(m_Reading, record.of);
    if (item.kind == HX_TypeKind::eDerived && item.of != nullptr &&
        item.of->type.getBaseTypeProperties() == nullptr) {
      record.isFaulty = true;
      m_Reading.faults.add(record.of.place, HX_Quoted(item.of->id),
                           "the id of a type with a cut");
    }
    completeKind(record, item);
    completeFields(record, item);
    for (const HX_TypeRecord::Constant& constant : record.values) {
      takeCodeName(constant.name, constant.namePlace);
      if (m_Reading.model.code.usesStdint && isStdintName(constant.name))
        m_Reading.faults.add(constant.namePlace, HX_Quoted(constant.name),
                             "a name that <stdint.h> does not define");
      item.values.push_back(
          {constant.name, constant.value, constant.namePlace});
    }
  }

  void completeFields(const HX_TypeRecord& record, HX_TypeItem& item) {
    std::set<std::string_view> names;
    for (const HX_TypeRecord::Field& field : record.fields) {
      if (!names.insert(field.name).second)
        m_Reading.faults.add(field.namePlace, HX_Quoted(field.name) + " again",
                             "a name that no other field of the type has");
      const int index = m_Reading.typeIds.find(field.type);
      if (index < 0) continue;
      HX_TypeItem* fieldType = &m_Types[static_cast<std::size_t>(index)];
      if (fieldType->kind != HX_TypeKind::eBitField)
        fieldType = HX_FindDeclarableType(m_Reading, field.type);
      if (fieldType != nullptr)
        item.fields.push_back({field.name, fieldType, field.namePlace});
    }
    // In C++ a field hides the type of the same name inside the structure.
    std::set<std::string_view> types;
    for (const HX_TypeItem::Field& field : item.fields)
      if (field.type->kind != HX_TypeKind::eBitField)
        types.insert(field.type->name);
    for (const HX_TypeItem::Field& field : item.fields)
      if (types.count(field.name) != 0)
        m_Reading.faults.add(field.place, HX_Quoted(field.name),
                             "a name that no type of a field has");
  }

  // What the types at the ends of the chains give to the types above them.
  void completeStorage() {
    HX_TypeItem* bitFieldBase = nullptr;  // least id
    for (HX_TypeItem& item : m_Types) {
      const bool isBase = item.cType == HX_CType::eUnsignedInt;
      if (isBase && (bitFieldBase == nullptr || item.id < bitFieldBase->id))
        bitFieldBase = &item;
      const HX_TypeItem* scalar = item.scalar();
      if (scalar != nullptr && scalar->numerical &&
          item.kind != HX_TypeKind::eArray)
        item.type.setNumerical(
            const_cast<HX_NumericalType*>(&*scalar->numerical));
    }
    if (bitFieldBase != nullptr)
      m_Reading.model.typeServer.getBaseServer()->setBitfieldBaseType(
          &bitFieldBase->type);
  }

  // Types and enumeration constants share the names of the file.
  void takeCodeName(const std::string& name, HX_TokenEnd place) {
    if (!name.empty() && !m_CodeNames.insert(name).second)
      m_Reading.faults.add(place, HX_Quoted(name) + " again",
                           "a name that no other type or constant has");
  }

  Reading& m_Reading;
  std::deque<HX_TypeItem>& m_Types;
  std::set<std::string_view> m_CodeNames;
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

HX_TypeItem* HX_FindDeclarableType(HX_ModelReading& reading,
                                   const HX_Use& use) {
  const int index = reading.typeIds.find(use);
  if (index < 0) return nullptr;
  HX_TypeItem& type = reading.model.types[static_cast<std::size_t>(index)];
  if (!type.isNameless && type.kind != HX_TypeKind::eBitField) return &type;
  reading.faults.add(use.place, HX_Quoted(type.id),
                     "the id of a type with a name, no bit field");
  return nullptr;
}

HX_Bindings HX_TypeBindings() { return {kBindings, std::size(kBindings)}; }

void HX_ResolveTypes(HX_ModelReading& reading) { Maker(reading).make(); }
