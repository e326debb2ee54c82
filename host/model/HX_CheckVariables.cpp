// Wishes of variables that C cannot fulfil: initial values, sections,
// alignment, static.
#include <algorithm>
#include <array>

#include "host/model/HX_ModelReading.h"

namespace {

/// Walks the scalars of a type in the order of a C initialiser, as long as
/// there are values.
class ValueCheck {
 public:
  ValueCheck(HX_ModelReading& reading, HX_TokenEnd place,
             const std::vector<double>& values)
      : m_Reading(reading), m_Place(place), m_Values(values) {}

  // RETURNS: false behind the first fault.
  bool walk(const HX_TypeItem& type) {
    if (m_At == m_Values.size()) return true;
    if (type.kind == HX_TypeKind::eArray) {
      for (int i = 0; i < type.length && m_At < m_Values.size(); ++i)
        if (!walk(*type.of)) return false;
      return true;
    }
    if (type.kind == HX_TypeKind::eStruct)
      return std::all_of(type.fields.begin(), type.fields.end(),
                         [this](const auto& each) { return walk(*each.type); });
    if (type.of != nullptr) return walk(*type.of);
    return takeValue(type, m_Values[m_At++]);
  }

 private:
  bool takeValue(const HX_TypeItem& type, double value) {
    if (type.kind != HX_TypeKind::eEnum) return true;
    if (std::any_of(type.values.begin(), type.values.end(),
                    [&](const auto& each) { return each.value == value; }))
      return true;
    m_Reading.faults.add(m_Place,
                         "a value that no constant of " + type.name + " has",
                         "the numbers of constants");
    return false;
  }

  HX_ModelReading& m_Reading;
  const HX_TokenEnd m_Place;
  const std::vector<double>& m_Values;
  std::size_t m_At = 0;
};

// Sections that compilers and linkers use on their own. The wish of a user for
// a part of a section, ".data.fast", has to fit the kind of the section.
struct SectionRow {
  const char* name;
  bool (*fits)(const HX_WantedName& name);  // null: no variable fits
  const char* expected;
};

bool isWritable(const HX_WantedName& name) {
  return !name.rare().placement.isConst;
}

constexpr char kNoOwn[] = "a section that no compiler uses on its own";
constexpr SectionRow kSections[] = {
    {"data", isWritable, "no const variable in a section for data"},
    {"bss",
     [](const HX_WantedName& name) {
       return isWritable(name) && name.initial.empty();
     },
     "no const variable and no initial value in a section without content"},
    {"rodata",
     [](const HX_WantedName& name) {
       return name.rare().placement.isConst &&
              !name.rare().placement.isVolatile;
     },
     "a const variable, not volatile, in a section for constants"},
    {"text", nullptr, kNoOwn},
    {"tdata", nullptr, kNoOwn},
    {"tbss", nullptr, kNoOwn},
    {"init", nullptr, kNoOwn},
    {"fini", nullptr, kNoOwn},
    {"ctors", nullptr, kNoOwn},
    {"dtors", nullptr, kNoOwn},
    {"init_array", nullptr, kNoOwn},
    {"fini_array", nullptr, kNoOwn},
    {"preinit_array", nullptr, kNoOwn},
    {"comment", nullptr, kNoOwn},
    {"note", nullptr, kNoOwn},
    {"symtab", nullptr, kNoOwn},
    {"strtab", nullptr, kNoOwn},
    {"shstrtab", nullptr, kNoOwn},
    {"eh_frame", nullptr, kNoOwn},
    {"gnu", nullptr, kNoOwn},
    {"sdata", nullptr, kNoOwn},
    {"sbss", nullptr, kNoOwn},
    {"rel", nullptr, kNoOwn},
    {"rela", nullptr, kNoOwn},
};

const SectionRow* ownSection(const std::string& section) {
  if (section[0] != '.') return nullptr;
  const std::string head = section.substr(1, section.find('.', 1) - 1);
  if (head.empty() || head.starts_with("debug")) return &kSections[3];
  const auto row =
      std::find_if(std::begin(kSections), std::end(kSections),
                   [&](const SectionRow& each) { return head == each.name; });
  return row == std::end(kSections) ? nullptr : row;
}

class PlacementCheck {
 public:
  explicit PlacementCheck(HX_ModelReading& reading) : m_Reading(reading) {
    m_HasFunction = std::any_of(
        reading.model.names.begin(), reading.model.names.end(),
        [](const HX_WantedName& name) { return name.isFunction(); });
  }

  void check(const HX_WantedName& name, const HX_PlacementPlaces& places) {
    const HX_Placement& wish = name.rare().placement;
    if (name.kind != HX_NameKind::eVariable)
      return add(places.any, "a qualifier or a place in memory",
                 "these fields in variables only");
    const bool isLocal = name.scope != m_Reading.model.fileScope;
    if (wish.isStatic && !isLocal && !m_HasFunction)
      add(places.isStatic, "true",
          "a function in the document, or no static variable: nothing could "
          "use the variable");
    if ((wish.alignment & (wish.alignment - 1)) != 0)
      add(places.alignment, std::to_string(wish.alignment), "a power of 2");
    if (!wish.section.empty()) checkSection(name, places.section, isLocal);
  }

 private:
  void checkSection(const HX_WantedName& name, HX_TokenEnd place,
                    bool isLocal) {
    const HX_Placement& wish = name.rare().placement;
    if (isLocal && !wish.isStatic)
      add(place, HX_Quoted(wish.section),
          "no section for a variable on the stack; a static variable may have "
          "a section");
    const SectionRow* own = ownSection(wish.section);
    if (own != nullptr && (own->fits == nullptr || !own->fits(name)))
      add(place, HX_Quoted(wish.section), own->expected);
    const std::array<bool, 2> qualifiers{wish.isConst, wish.isVolatile};
    const auto first = m_Sections.try_emplace(wish.section, qualifiers).first;
    if (first->second != qualifiers)
      add(place, HX_Quoted(wish.section),
          "a section for variables of the same qualifiers (const, volatile)");
  }

  void add(HX_TokenEnd place, const std::string& found,
           const std::string& expected) {
    m_Reading.faults.add(place, found, expected);
  }

  HX_ModelReading& m_Reading;
  bool m_HasFunction;
  std::map<std::string, std::array<bool, 2>> m_Sections;  // qualifiers by name
};

}  // namespace

void HX_CheckInitial(HX_ModelReading& reading, HX_TokenEnd place,
                     const HX_WantedName& name) {
  if (place == 0) return;
  if (name.initial.size() > name.type->elements)
    return reading.faults.add(
        place, std::to_string(name.initial.size()) + " values",
        "1 to " + std::to_string(name.type->elements) + " values");
  ValueCheck(reading, place, name.initial).walk(*name.type);
}

void HX_CheckPlacements(HX_ModelReading& reading) {
  PlacementCheck check(reading);
  for (const auto& [index, uses] : reading.rareUses)
    if (uses.placement.any != 0 && !reading.names[index].isFaulty)
      check.check(reading.model.names[index], uses.placement);
}
