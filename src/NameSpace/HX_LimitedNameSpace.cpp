// Problem: find the first free name among name + "_" + letter code of c, c + 1,
// ... With the length limit on, appendSuffix() cuts a long name to make room,
// so thousands of long names share one head and compete for the variants of
// that head, although the counter of every name starts at 0.
//
// Plain form: try every index. n names with one head take n^2 / 2 lookups, 200
// million for 20000 names.
//
// Idea: remember per head the indices found taken, as intervals (m_Names holds
// heads beside names), and jump over an interval at once.
//
// Example, limit of 8 characters, names abcdefg1, abcdefg2, abcdefg3 in the
// set, each derived once by addUnique():
//   abcdefg1 -> abcdef_a               head abcdef: {}     -> {0}
//   abcdefg2 -> abcdef_a is taken; note 0, jump to 1
//               abcdef_b               head abcdef: {0}    -> {0, 1}
//   abcdefg3 -> abcdef_a is taken; note 0, jump to 2
//               abcdef_c               head abcdef: {0, 1} -> {0, 1, 2}
//
// Invariants:
// 1. Every index in head.taken belongs to a name of the set: head + "_" + code.
//    The reverse need not hold, because notes only save time. A note may fail
//    for want of memory.
// 2. A jump stays among codes of one length, because a longer code cuts the
//    name to another head.
// 3. A name too short to be cut by any suffix is the head of its own variants.
// 4. An entry is in the set or has notes, unless memory ran out.
//
// Test: LimitedNameSpaceTest.AgreesWithTryingEachSuffix.

#include "NameSpace/HX_LimitedNameSpace.h"

#include <algorithm>
#include <cstring>
#include <iterator>
#include <new>
#include <optional>
#include <utility>

#include "Control/HX_Memory.h"
#include "implContainers/HX_IntervalSet.h"
#include "implContainers/HX_LetterCode.h"
#include "implContainers/HX_TextHash.h"
#include "platform/model/HxCSymbol.h"

namespace {

// A name read as head, '_' and letter code.
struct Variant {
  int headLength;
  int index;              // of the letter code
  int firstOfNextLength;  // smallest index with a longer code
};

// Nothing if the name does not end in '_' and a letter code.
std::optional<Variant> readVariant(const KyCXString& name) {
  char letters[HX_LetterCode::kLongest];
  char* const end = std::end(letters);
  char* code = end;
  int from = name.length() - 1;
  for (; from >= 0 && code != letters && name[from] >= 'a' && name[from] <= 'z';
       --from)
    *--code = static_cast<char>(name[from]);
  const int length = static_cast<int>(end - code);
  if (from < 0 || length == 0 || name[from] != '_') return std::nullopt;
  const int index = HX_LetterCode::indexOf(code, length);
  if (index < 0) return std::nullopt;
  return Variant{from, index, HX_LetterCode::firstOfLength(length + 1)};
}

bool isVariant(const KyCXString& name, int index) {
  const auto variant = readVariant(name);
  return variant && variant->index == index;
}

// Over the 8-bit form, whose length may differ from that of the text.
int hashOf(const KyCXString& text) {
  const char* const bytes = text.cstring();
  return HX_TextHash(bytes, std::strlen(bytes));
}

// True if no suffix makes the name so long that the name would be cut.
bool isNeverCut(const KyCXString& name) {
  return name.length() + 1 + HX_LetterCode::kLongest <=
         HxCSymbol::sm_MaxNameLength;
}

}  // namespace

struct HX_LimitedNameSpace::Name : HX_Allocated {
  explicit Name(const KyCXString& name) : text(name) {}

  bool isDefined = false;  // in the set; false for a mere head of variants
  int counter = 0;
  KyCXString text;
  HX_IntervalSet taken;  // indices of variants of this text in the set
};

HX_LimitedNameSpace::HX_LimitedNameSpace(const HX_LimitedNameSpace& other)
    : HX_Allocated(other) {
  *this = other;
}

HX_LimitedNameSpace& HX_LimitedNameSpace::operator=(
    const HX_LimitedNameSpace& other) {
  HX_WithinMemory([&] {
    HX_LimitedNameSpace copy;
    copy.copyNames(other);
    m_Naming = other.m_Naming;
    m_Names.swap(copy.m_Names);
  });
  return *this;
}

HX_LimitedNameSpace::~HX_LimitedNameSpace() {
  m_Names.forEach([](const auto& slot) { delete slot.value; });
}

void HX_LimitedNameSpace::add(KyCXString& s) {
  HX_WithinMemory([&] { findOrMake(s)->isDefined = true; });
}

void HX_LimitedNameSpace::remove(const KyCXString& s) {
  Name* const name = findDefined(s);
  if (name == nullptr) return;
  if (!HX_WithinMemory([&] { forgetTaken(s); }))
    m_Names.forEach([](const auto& slot) { slot.value->taken.clear(); });
  name->isDefined = false;
  name->counter = 0;
  dropIfUnused(name);
}

void HX_LimitedNameSpace::addUnique(KyCXString& s) {
  bool derived = false;
  derive(s, derived, true, false);
}

void HX_LimitedNameSpace::deriveUniqueString(KyCXString& s) {
  bool derived = false;
  deriveUniqueString(s, derived);
}

void HX_LimitedNameSpace::deriveUniqueString(KyCXString& s, bool& derived) {
  derive(s, derived, false, false);
}

void HX_LimitedNameSpace::deriveUniqueStringAdaptLength(KyCXString& s) {
  bool derived = false;
  deriveUniqueStringAdaptLength(s, derived);
}

void HX_LimitedNameSpace::deriveUniqueStringAdaptLength(KyCXString& s,
                                                        bool& derived) {
  derive(s, derived, false, true);
}

void HX_LimitedNameSpace::derive(KyCXString& s, bool& derived, bool addResult,
                                 bool adaptLength) {
  derived = false;
  HX_WithinMemory([&] {
    KyCXString out;
    bool isDerived = false;
    deriveUniqueString(s, out, isDerived, addResult, adaptLength);
    s = std::move(out);
    derived = isDerived;
  });
}

bool HX_LimitedNameSpace::deriveUniqueString(const KyCXString& in,
                                             KyCXString& out, bool& derived,
                                             bool addResult, bool adaptLength) {
  out = in;
  if (adaptLength) adaptStringLength(out);
  Name* const base = findDefined(out);
  derived = base != nullptr;
  const int index = derived ? searchVariant(*base, in, out, adaptLength) : 0;
  Name* const result = addResult ? findOrMake(out) : nullptr;
  // From here on nothing fails but notes.
  if (derived) base->counter = index;
  if (result == nullptr) return true;
  result->isDefined = true;
  if (!derived) return true;
  if (isNeverCut(in))
    HX_WithinMemory([&] { base->taken.add(index); });
  else
    noteTaken(out, index);
  return true;
}

// \p out holds the text of \p base and becomes its first free variant.
// RETURNS: the index of the suffix.
int HX_LimitedNameSpace::searchVariant(const Name& base, const KyCXString& in,
                                       KyCXString& out, bool adaptLength) {
  int index = base.counter;
  if (isNeverCut(in)) index = base.taken.firstMissing(index);
  // Variants of a shortened name tell nothing about variants of the name.
  bool isOfInput = out.length() == in.length();
  for (;;) {
    m_Naming.appendSuffix(out, index);
    if (adaptLength) adaptStringLength(out);
    const Name* const taken = findDefined(out);
    if (taken == nullptr) return index;
    // The suffix is missing, so appendSuffix() ran out of memory.
    if (taken == &base && !isVariant(out, index)) throw std::bad_alloc();
    index = isOfInput ? noteTaken(out, index) : index + 1;
    isOfInput = true;
    out = in;
  }
}

// Notes that \p variant, which has the suffix \p index, is in the set.
// RETURNS: the next index to try (invariant 2).
int HX_LimitedNameSpace::noteTaken(const KyCXString& variant, int index) {
  const auto read = readVariant(variant);
  if (!read || read->index != index) return index + 1;
  return HX_WithinMemory(index + 1, [&] {
    Name* const head = findOrMake(variant.head(read->headLength));
    head->taken.add(index);
    return std::min(head->taken.firstMissing(index), read->firstOfNextLength);
  });
}

// Throws std::bad_alloc, with nothing changed.
void HX_LimitedNameSpace::forgetTaken(const KyCXString& variant) {
  const auto read = readVariant(variant);
  if (!read) return;
  Name* const head = find(variant.head(read->headLength));
  if (head == nullptr) return;
  head->taken.remove(read->index);
  dropIfUnused(head);
}

void HX_LimitedNameSpace::adaptStringLength(KyCXString& s) {
  s.shortenString(HxCSymbol::sm_MaxNameLength, 2, '_',
                  static_cast<KyCXString::ScEPosition>(1));
}

HX_LimitedNameSpace::Name* HX_LimitedNameSpace::find(
    const KyCXString& text) const {
  return find(text, hashOf(text));
}

HX_LimitedNameSpace::Name* HX_LimitedNameSpace::find(const KyCXString& text,
                                                     int hash) const {
  const auto* slot =
      m_Names.find(hash, [&](const Name* name) { return name->text == text; });
  return slot == nullptr ? nullptr : slot->value;
}

HX_LimitedNameSpace::Name* HX_LimitedNameSpace::findDefined(
    const KyCXString& text) const {
  Name* const name = find(text);
  return name != nullptr && name->isDefined ? name : nullptr;
}

// Throws std::bad_alloc, with nothing changed.
HX_LimitedNameSpace::Name* HX_LimitedNameSpace::findOrMake(
    const KyCXString& text) {
  const int hash = hashOf(text);
  Name* name = find(text, hash);
  if (name != nullptr) return name;
  name = new Name(text);
  if (name == nullptr) throw std::bad_alloc();
  if (m_Names.add(hash, name) != nullptr) return name;
  delete name;
  throw std::bad_alloc();
}

// Throws std::bad_alloc. Copies start without notes.
void HX_LimitedNameSpace::copyNames(const HX_LimitedNameSpace& other) {
  other.m_Names.forEach([this](const auto& slot) {
    if (!slot.value->isDefined) return;
    Name* const name = findOrMake(slot.value->text);
    name->isDefined = true;
    name->counter = slot.value->counter;
  });
}

void HX_LimitedNameSpace::dropIfUnused(Name* name) {
  if (name->isDefined || !name->taken.empty()) return;
  m_Names.erase(m_Names.find(hashOf(name->text),
                             [=](const Name* other) { return other == name; }));
  delete name;
}
