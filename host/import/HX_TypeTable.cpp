#include "host/import/HX_TypeTable.h"

#include <algorithm>
#include <cmath>

#include "host/import/HX_Dictionary.h"
#include "host/import/HX_Literals.h"
#include "host/import/HX_Notes.h"
#include "host/import/HX_Rules.h"

namespace {

// Numbers of a document's enumeration, an int of 16 bits.
constexpr double kMinConstant = -32767;
constexpr double kMaxConstant = 32767;
constexpr int kMaxDepth = 64;  // of buses in buses and aliases of aliases

struct BaseRow {
  std::string_view name;
  const char* kind;
  const char* c;
  const char* cut;
  const char* of;
  int bits;  // of an integer
  bool isSigned;
};

constexpr BaseRow kBases[] = {
    {"double", "base", "double", "f64", "", 0, true},
    {"single", "base", "float", "f32", "", 0, true},
    {"int8", "base", "signed char", "i8", "", 8, true},
    {"uint8", "base", "unsigned char", "u8", "", 8, false},
    {"int16", "base", "short", "i16", "", 16, true},
    {"uint16", "base", "unsigned short", "u16", "", 16, false},
    {"int32", "base", "int", "i32", "", 32, true},
    {"uint32", "base", "unsigned int", "u32", "", 32, false},
    {"int64", "integer64", "", "", "", 64, true},
    {"uint64", "integer64", "", "", "", 64, false},
    {"boolean", "derived", "", "", "uint8", 0, false},
};

std::string cIdentifier(std::string_view text) {
  std::string name;
  for (const char c : text)
    name += HX_IsIdentifier(std::string_view(&c, 1)) || (c >= '0' && c <= '9')
                ? c
                : '_';
  if (!HX_IsIdentifier(name)) name.insert(name.begin(), '_');
  return name;
}

// The text behind "Bus:" and the like; empty for another text.
std::string_view behind(std::string_view prefix, std::string_view text) {
  return text.starts_with(prefix) ? HX_Trimmed(text.substr(prefix.size()))
                                  : std::string_view();
}

// The arguments of a call such as "fixdt(1, 16, 2^-8, 0)".
std::vector<std::string_view> argumentsOf(std::string_view call) {
  std::vector<std::string_view> arguments;
  const std::size_t open = call.find('(');
  if (open == std::string_view::npos || call.back() != ')') return arguments;
  call = call.substr(open + 1, call.size() - open - 2);
  for (;;) {
    const std::size_t comma = call.find(',');
    arguments.push_back(HX_Trimmed(call.substr(0, comma)));
    if (comma == std::string_view::npos) return arguments;
    call.remove_prefix(comma + 1);
  }
}

// A number, or a power: "2^-8".
std::optional<double> scalingOf(std::string_view text) {
  const std::size_t power = text.find('^');
  if (power == std::string_view::npos) return HX_ReadNumber(text);
  const auto base = HX_ReadNumber(text.substr(0, power));
  const auto exponent = HX_ReadNumber(text.substr(power + 1));
  if (!base || !exponent) return std::nullopt;
  return std::pow(*base, *exponent);
}

}  // namespace

HX_TypeUse HX_TypeTable::resolve(const HX_TypeRequest& request) {
  HX_TypeUse use;
  const std::string_view text = HX_Trimmed(request.text);
  bool isKnown = !text.empty() &&
                 resolveScalar({text, request.fallback, 1, request.place}, use);
  if (!isKnown && text.starts_with("Inherit"))
    m_Notes.add("note",
                "'" + std::string(text) + "' takes the type of the naming rule",
                request.place);
  else if (!isKnown && !text.empty())
    m_Notes.add("warning",
                "the type '" + std::string(text) +
                    "' is unknown: the type of the naming rule is taken",
                request.place);
  if (!isKnown)
    isKnown = resolveScalar({request.fallback, "", 1, request.place}, use);
  if (!isKnown) useBase("double", use);
  if (request.elements > 1) makeArray(request.elements, use);
  return use;
}

bool HX_TypeTable::resolveScalar(const HX_TypeRequest& request,
                                 HX_TypeUse& use) {
  const std::string_view text = request.text;
  if (text == "logical") return useBase("boolean", use);
  const std::string_view plain =
      text.ends_with("_t") ? text.substr(0, text.size() - 2) : text;
  if (useBase(plain, use)) return true;
  if (text.starts_with("fixdt(")) return resolveFixedPoint(text, use);
  if (const auto name = behind("Enum:", text); !name.empty())
    return useEnumeration(name, use);
  if (const auto name = behind("Bus:", text); !name.empty())
    return useBus(name, use);
  return useEnumeration(text, use) || useBus(text, use) ||
         useAlias(request, use);
}

bool HX_TypeTable::useAlias(const HX_TypeRequest& request, HX_TypeUse& use) {
  const HX_DictionaryEntry* alias =
      m_Dictionary.find(request.text, HX_DictionaryEntry::eAlias);
  if (alias == nullptr || m_Depth >= kMaxDepth) return false;
  ++m_Depth;
  const bool isKnown = resolveScalar({alias->type, "", 1, request.place}, use);
  --m_Depth;
  return isKnown;
}

bool HX_TypeTable::resolveFixedPoint(std::string_view text, HX_TypeUse& use) {
  const std::vector<std::string_view> arguments = argumentsOf(text);
  if (arguments.size() == 1 && arguments[0].size() > 2 &&
      arguments[0].front() == '\'')
    return useBase(arguments[0].substr(1, arguments[0].size() - 2), use);
  std::vector<double> numbers;
  for (const std::string_view argument : arguments) {
    const auto number = scalingOf(argument);
    if (!number || !std::isfinite(*number)) return false;
    numbers.push_back(*number);
  }
  if (numbers.size() < 2 || numbers.size() > 5) return false;
  if (numbers[1] < 1 || numbers[1] > 64) return false;
  if (!useInteger(static_cast<int>(numbers[1]), numbers[0] != 0, use))
    return false;
  if (numbers.size() == 3) use.lsb = std::exp2(-numbers[2]);
  if (numbers.size() == 4) use.lsb = numbers[2];
  if (numbers.size() == 5) use.lsb = numbers[2] * std::exp2(numbers[3]);
  if (numbers.size() > 3) use.zero = numbers.back();
  return use.lsb > 0 && std::isfinite(use.lsb);
}

// The smallest sufficient C type.
bool HX_TypeTable::useInteger(int bits, bool isSigned, HX_TypeUse& use) {
  for (const BaseRow& row : kBases) {
    if (row.bits >= bits && row.isSigned == isSigned)
      return useBase(row.name, use);
  }
  return false;
}

bool HX_TypeTable::useBase(std::string_view name, HX_TypeUse& use) {
  for (const BaseRow& row : kBases) {
    if (row.name != name) continue;
    use.id = row.name;
    use.isScalar = true;
    HX_TypeUse inner;
    if (*row.of != '\0') useBase(row.of, inner);
    if (HX_ImportedType* type = add(use.id, use.id, row.kind)) {
      type->c = row.c;
      type->cut = row.cut;
      type->of = row.of;
      type->isSigned = row.isSigned;
    }
    return true;
  }
  return false;
}

bool HX_TypeTable::useBus(std::string_view name, HX_TypeUse& use) {
  const HX_DictionaryEntry* entry =
      m_Dictionary.find(name, HX_DictionaryEntry::eBus);
  if (entry == nullptr || entry->members.empty()) return false;
  const std::string id = "Bus: " + entry->name;
  // A bus inside itself has no size.
  if (m_OpenBuses.find(id) != m_OpenBuses.end() || m_Depth >= kMaxDepth)
    return false;
  use.id = id;
  use.isScalar = false;
  if (HX_ImportedType* type = add(id, entry->name, "struct")) {
    m_OpenBuses.insert(id);
    ++m_Depth;
    addBus(*entry, *type);
    --m_Depth;
    m_OpenBuses.erase(id);
  }
  return true;
}

void HX_TypeTable::addBus(const HX_DictionaryEntry& entry,
                          HX_ImportedType& type) {
  Reserved fields;
  for (const HX_DictionaryMember& member : entry.members) {
    const HX_TypeUse use =
        resolve({member.type, "double", HX_ReadDimensions(member.dimensions),
                 type.id + "." + member.name});
    type.fields.emplace_back(freeName(member.name, fields), use.id);
  }
}

bool HX_TypeTable::useEnumeration(std::string_view name, HX_TypeUse& use) {
  const HX_DictionaryEntry* entry =
      m_Dictionary.find(name, HX_DictionaryEntry::eEnumeration);
  if (entry == nullptr || entry->members.empty()) return false;
  use.id = "Enum: " + entry->name;
  use.isScalar = false;
  if (HX_ImportedType* type = add(use.id, entry->name, "enum"))
    addConstants(*entry, *type);
  return true;
}

void HX_TypeTable::addConstants(const HX_DictionaryEntry& entry,
                                HX_ImportedType& type) {
  double next = 0;
  std::vector<double> numbers;
  for (const HX_DictionaryMember& member : entry.members) {
    numbers.push_back(HX_ReadNumber(member.value).value_or(next));
    next = numbers.back() + 1;
  }
  const auto [least, greatest] =
      std::minmax_element(numbers.begin(), numbers.end());
  if (*least < kMinConstant || *greatest > kMaxConstant) {
    m_Notes.add("warning",
                "the enumeration '" + entry.name +
                    "' has numbers beyond 16 bits: an integer type is used, "
                    "without the constants",
                "");
    HX_TypeUse use;
    useBase("int32", use);
    type.kind = "derived";
    type.of = use.id;
    return;
  }
  for (std::size_t i = 0; i < numbers.size(); ++i) {
    const std::string& name = entry.members[i].name;
    type.values.emplace_back(
        freeName(entry.isPrefixed ? entry.name + "_" + name : name, m_Taken),
        static_cast<int>(numbers[i]));
  }
}

void HX_TypeTable::makeArray(int elements, HX_TypeUse& use) {
  const std::string element = use.id;
  const std::string length = std::to_string(elements);
  use.id += "[" + length + "]";
  if (m_ById.find(use.id) != m_ById.end()) return;
  const std::string name = m_ById.find(element)->second->name + "_" + length;
  HX_ImportedType* type = add(use.id, name, "array");
  type->of = element;
  type->length = elements;
}

void HX_TypeTable::addDictionary() {
  for (const auto& [name, entry] : m_Dictionary.entries()) {
    HX_TypeUse use;
    if (entry.kind == HX_DictionaryEntry::eEnumeration)
      useEnumeration(name, use);
    if (entry.kind == HX_DictionaryEntry::eBus) useBus(name, use);
  }
}

// Null for a known type.
HX_ImportedType* HX_TypeTable::add(const std::string& id,
                                   const std::string& name, const char* kind) {
  const auto [known, isNew] = m_ById.try_emplace(id, nullptr);
  if (!isNew) return nullptr;
  HX_ImportedType& type = m_Types.emplace_back();
  known->second = &type;
  type.id = id;
  type.name = freeName(m_Rules.typeName(id, name), m_Taken);
  type.kind = kind;
  return &type;
}

std::string HX_TypeTable::freeName(const std::string& wanted,
                                   Reserved& taken) const {
  const std::string base = cIdentifier(wanted);
  std::string name = base;
  for (int i = 2;
       m_Reserved.find(name) != m_Reserved.end() || !taken.insert(name).second;
       ++i)
    name = base + "_" + std::to_string(i);
  return name;
}
