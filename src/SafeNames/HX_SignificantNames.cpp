#include "SafeNames/HX_SignificantNames.h"

#include <string_view>
#include <utility>

#include "Control/HX_Memory.h"
#include "NameSpace/HxCXStringIdServer.h"
#include "SafeNames/implSafeNames/HX_TextLines.h"
#include "SafeNames/implSafeNames/HX_VariantCounts.h"
#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_PlainArray.h"
#include "implContainers/HX_TextArena.h"
#include "platform/strings/KyCXString.h"

namespace {

std::string_view viewOf(const KyCXString& text) {
  return {text.cstring(), static_cast<std::size_t>(text.length())};
}

}  // namespace

struct HX_SignificantNames::Names : HX_Allocated {
  struct Name {
    const char* text;
    const char* part;  // what has to differ
    const HxCSrcRef* place;
  };

  Names() = default;
  Names(const Names&) = delete;
  Names& operator=(const Names&) = delete;
  ~Names() { heads.shutdown(); }

  // Null if no name has the part.
  const Name* find(const KyCXString& part) const {
    const std::string_view wanted = viewOf(part);
    const auto* const slot =
        index.find(hx_detail::keyOf(wanted),
                   [&](unsigned int at) { return wanted == names[at].part; });
    return slot == nullptr ? nullptr : &names[slot->value];
  }

  // False, with nothing changed but the memory of the texts, without memory. A
  // part that is the name itself is kept once.
  bool enter(const KyCXString& name, const KyCXString& part,
             const HxCSrcRef* place) {
    const char* const text = texts.add(name.cstring(), viewOf(name).size());
    if (text == nullptr) return false;
    const char* const kept =
        part == name ? text : texts.add(part.cstring(), viewOf(part).size());
    if (kept == nullptr || !names.append(Name{text, kept, place})) return false;
    if (index.add(hx_detail::keyOf(viewOf(part)), names.size() - 1))
      return true;
    names.dropLast();
    return false;
  }

  HX_PlainArray<Name> names;
  HX_HashTable<int, unsigned int> index;  // positions, by the hash of the part
  HX_TextArena texts;
  HxCXStringIdServer heads;  // of variants; up when first needed
  hx_detail::HX_VariantCounts counts;
};

HX_SignificantNames::HX_SignificantNames(int count, bool foldsCase)
    : m_Count(count), m_FoldsCase(foldsCase), m_pNames(new Names) {}

HX_SignificantNames::~HX_SignificantNames() { delete m_pNames; }

int HX_SignificantNames::size() const {
  return m_pNames == nullptr ? 0 : static_cast<int>(m_pNames->names.size());
}

HX_SignificantNames::HxEOutcomeTag HX_SignificantNames::add(
    const KyCXString& name, const HxCSrcRef* place, Clash& clash) {
  if (m_pNames == nullptr) return eNoMemory;
  return HX_WithinMemory(eNoMemory, [&] {
    const KyCXString part =
        hx_detail::significantPart(name, m_Count, m_FoldsCase);
    if (const Names::Name* earlier = m_pNames->find(part)) {
      clash = {earlier->text, name.cstring(), earlier->place, place};
      return eClash;
    }
    return m_pNames->enter(name, part, place) ? eAdded : eNoMemory;
  });
}

HX_SignificantNames::HxEOutcomeTag HX_SignificantNames::addUnique(
    KyCXString& name, const HxCSrcRef* place, Clash& clash) {
  if (m_pNames == nullptr) return eNoMemory;
  return HX_WithinMemory(eNoMemory, [&] {
    KyCXString part = hx_detail::significantPart(name, m_Count, m_FoldsCase);
    const Names::Name* const earlier = m_pNames->find(part);
    if (earlier == nullptr)
      return m_pNames->enter(name, part, place) ? eAdded : eNoMemory;
    const Clash found{earlier->text, nullptr, earlier->place, place};
    m_pNames->heads.boot();
    if (!m_pNames->heads.isUp()) return eNoMemory;

    KyCXString variant = name;
    const bool isFound = hx_detail::deriveVariant(
        variant, m_Count, false, m_pNames->counts,
        [&](const KyCXString& head) { return m_pNames->heads.getId(head); },
        [&](const KyCXString& candidate) {
          part = hx_detail::significantPart(candidate, m_Count, m_FoldsCase);
          return m_pNames->find(part) == nullptr;
        });
    if (!isFound) return eNoVariant;
    if (!m_pNames->enter(variant, part, place)) return eNoMemory;
    clash = found;
    name = std::move(variant);
    return eAdded;
  });
}
