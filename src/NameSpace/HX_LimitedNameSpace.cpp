#include "NameSpace/HX_LimitedNameSpace.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <optional>

#include "NameSpace/implNameSpace/HX_IndexRuns.h"
#include "NameSpace/implNameSpace/HX_TextHash.h"
#include "platform/model/HxCSymbol.h"

namespace {

constexpr int kLetters = 26;
// Enough for the code of every int.
constexpr int kLongestCode = 7;

// A name read as "<head>_<letter code>".
struct Variant {
  int headLength;
  int index;              // of the letter code
  int firstOfNextLength;  // the first index with a longer code
};

// Nothing if the name does not read so. A letter code is a bijective numeral of
// base 26, lowest letter first.
std::optional<Variant> readVariant(const KyCXString& name) {
  const int last = name.length() - 1;
  int from = last;
  while (from >= 0 && last - from < kLongestCode && name[from] >= 'a' &&
         name[from] <= 'z')
    --from;
  if (from < 0 || from == last || name[from] != '_') return std::nullopt;
  std::int64_t value = 0;
  std::int64_t smallestLonger = 1;
  for (int at = last; at > from; --at) {
    value = value * kLetters + (name[at] - 'a' + 1);
    smallestLonger = smallestLonger * kLetters + 1;
  }
  constexpr std::int64_t kMaximum = std::numeric_limits<int>::max();
  if (value > kMaximum) return std::nullopt;
  return Variant{from, static_cast<int>(value - 1),
                 static_cast<int>(std::min(smallestLonger - 1, kMaximum))};
}

int hashOf(const KyCXString& text) {
  return HX_TextHash(text.cstring(), static_cast<std::size_t>(text.length()));
}

// Whether no suffix makes a name so long that it would be cut or shortened.
bool isNeverCut(const KyCXString& name) {
  return name.length() + 1 + kLongestCode <= HxCSymbol::sm_MaxNameLength;
}

}  // namespace

struct HX_LimitedNameSpace::Name : HX_Allocated {
  explicit Name(const KyCXString& name) : text(name) {}

  bool isDefined = false;  // in the set; else only the head of variants
  int counter = 0;
  KyCXString text;
  // Suffix indices whose variants of this text are known to be in the set.
  HX_IndexRuns taken;
};

HX_LimitedNameSpace::HX_LimitedNameSpace(const HX_LimitedNameSpace& other)
    : HX_Allocated(other) {
  *this = other;
}

HX_LimitedNameSpace& HX_LimitedNameSpace::operator=(
    const HX_LimitedNameSpace& other) {
  if (this == &other) return *this;
  clear();
  m_Naming = other.m_Naming;
  other.m_Names.forEach([this](const auto& slot) {
    if (!slot.value->isDefined) return;
    Name* const name = findOrMake(slot.value->text);
    if (name == nullptr) return;
    name->isDefined = true;
    name->counter = slot.value->counter;
  });
  return *this;
}

HX_LimitedNameSpace::~HX_LimitedNameSpace() { clear(); }

void HX_LimitedNameSpace::add(KyCXString& s) { enter(s); }

void HX_LimitedNameSpace::remove(const KyCXString& s) {
  Name* const name = findDefined(s);
  if (name == nullptr) return;
  name->isDefined = false;
  name->counter = 0;
  if (const auto variant = readVariant(s)) {
    Name* const head = find(s.head(variant->headLength));
    if (head != nullptr) {
      head->taken.remove(variant->index);
      dropIfUnused(head);
    }
  }
  dropIfUnused(name);
}

void HX_LimitedNameSpace::addUnique(KyCXString& s) {
  KyCXString out;
  bool derived = false;
  deriveUniqueString(s, out, derived, true, false);
  s = out;
}

void HX_LimitedNameSpace::deriveUniqueString(KyCXString& s) {
  bool derived = false;
  deriveUniqueString(s, derived);
}

void HX_LimitedNameSpace::deriveUniqueString(KyCXString& s, bool& derived) {
  KyCXString out;
  deriveUniqueString(s, out, derived, false, false);
  s = out;
}

void HX_LimitedNameSpace::deriveUniqueStringAdaptLength(KyCXString& s) {
  bool derived = false;
  deriveUniqueStringAdaptLength(s, derived);
}

void HX_LimitedNameSpace::deriveUniqueStringAdaptLength(KyCXString& s,
                                                        bool& derived) {
  KyCXString out;
  deriveUniqueString(s, out, derived, false, true);
  s = out;
}

bool HX_LimitedNameSpace::deriveUniqueString(const KyCXString& in,
                                             KyCXString& out, bool& derived,
                                             bool addResult, bool adaptLength) {
  out = in;
  if (adaptLength) adaptStringLength(out);
  Name* const base = findDefined(out);
  derived = base != nullptr;
  if (derived) base->counter = searchVariant(*base, in, out, adaptLength);
  if (!addResult || !enter(out) || !derived) return true;
  if (isNeverCut(in))
    base->taken.add(base->counter);
  else
    noteTaken(out, base->counter);
  return true;
}

// \p out holds the text of \p base and becomes its first free variant.
// \return the index of the variant's suffix
int HX_LimitedNameSpace::searchVariant(const Name& base, const KyCXString& in,
                                       KyCXString& out, bool adaptLength) {
  int index = base.counter;
  if (isNeverCut(in)) index = base.taken.firstMissing(index);
  // The variants of a shortened name tell nothing about those of the name.
  bool isOfInput = out.length() == in.length();
  for (;;) {
    m_Naming.appendSuffix(out, index);
    if (adaptLength) adaptStringLength(out);
    if (findDefined(out) == nullptr) return index;
    index = isOfInput ? noteTaken(out, index) : index + 1;
    isOfInput = true;
    out = in;
  }
}

// Notes that a variant with the suffix \p index is in the set.
// \return the next index to try for the name it was derived from: as long as
//         the letter codes have one length, its variants have one head, and
//         those known to be taken are passed over
int HX_LimitedNameSpace::noteTaken(const KyCXString& name, int index) {
  const auto variant = readVariant(name);
  if (!variant || variant->index != index) return index + 1;
  Name* const head = findOrMake(name.head(variant->headLength));
  if (head == nullptr) return index + 1;
  head->taken.add(index);
  return std::min(head->taken.firstMissing(index), variant->firstOfNextLength);
}

void HX_LimitedNameSpace::adaptStringLength(KyCXString& s) {
  s.shortenString(HxCSymbol::sm_MaxNameLength, 2, '_',
                  KyCXString::ePositionMiddle);
}

HX_LimitedNameSpace::Name* HX_LimitedNameSpace::find(
    const KyCXString& text) const {
  const auto* slot = m_Names.find(
      hashOf(text), [&](const Name* name) { return name->text == text; });
  return slot == nullptr ? nullptr : slot->value;
}

HX_LimitedNameSpace::Name* HX_LimitedNameSpace::findDefined(
    const KyCXString& text) const {
  Name* const name = find(text);
  return name != nullptr && name->isDefined ? name : nullptr;
}

// Null if there is no memory.
HX_LimitedNameSpace::Name* HX_LimitedNameSpace::findOrMake(
    const KyCXString& text) {
  Name* name = find(text);
  if (name != nullptr) return name;
  name = new Name(text);
  if (name == nullptr) return nullptr;
  if (m_Names.add(hashOf(text), name) != nullptr) return name;
  delete name;
  return nullptr;
}

// False if there is no memory.
bool HX_LimitedNameSpace::enter(const KyCXString& text) {
  Name* const name = findOrMake(text);
  if (name != nullptr) name->isDefined = true;
  return name != nullptr;
}

void HX_LimitedNameSpace::dropIfUnused(Name* name) {
  if (name->isDefined || !name->taken.empty()) return;
  m_Names.erase(m_Names.find(hashOf(name->text),
                             [=](const Name* other) { return other == name; }));
  delete name;
}

void HX_LimitedNameSpace::clear() {
  m_Names.forEach([](const auto& slot) { delete slot.value; });
  m_Names.clear();
}
