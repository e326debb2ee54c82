// Variants of a taken name: head, '_' and a letter code.

#ifndef SAFENAMES_IMPLSAFENAMES_HX_VARIANTCOUNTS_H
#define SAFENAMES_IMPLSAFENAMES_HX_VARIANTCOUNTS_H

#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_LetterCode.h"
#include "platform/strings/KyCXString.h"

namespace hx_detail {

/// '_' and the letter code of \p index, as HxCNames::appendSuffix() has it.
inline KyCXString suffixOf(int index) {
  KyCXString suffix("_");
  suffix += HX_LetterCode(index).text();
  return suffix;
}

/// First suffix index not known to be taken, per head and length of the code.
/// With a limit many names are cut to a common head; without these counts
/// every name would try all variants of the head again.
class HX_VariantCounts {
 public:
  /// The first index >= \p index to try for the head with key \p head.
  int firstFree(int head, int codeLength, int index) const {
    const auto* slot = find(head, codeLength);
    return slot != nullptr && slot->value.next > index ? slot->value.next
                                                       : index;
  }
  /// Notes that no index below \p next is free.
  /// RETURNS: false without memory.
  bool note(int head, int codeLength, int next) {
    if (auto* slot = find(head, codeLength)) {
      slot->value.next = next;
      return true;
    }
    return m_Next.add(head, Count{codeLength, next}) != nullptr;
  }

 private:
  struct Count {
    int codeLength;
    int next;
  };

  HX_HashTable<int, Count>::Slot* find(int head, int codeLength) const {
    return m_Next.find(
        head, [&](const Count& c) { return c.codeLength == codeLength; });
  }

  HX_HashTable<int, Count> m_Next;
};

/// The first free variant of \p base with at most \p limit characters, 0 for
/// no limit.
/// \param keyOf   key of a head, an int
/// \param isFree  whether a variant may be used
/// \param joins   whether an '_' at the end of the head is left out; a head of
///                nothing else becomes "n"
/// RETURNS: false, with \p base unchanged, if every variant is taken or nothing
/// of the base is left.
template <class KeyOf, class IsFree>
bool deriveVariant(KyCXString& base, int limit, bool joins,
                   HX_VariantCounts& counts, KeyOf keyOf, IsFree isFree) {
  constexpr int kLast = 1 << 24;  // more names than a program can have
  KyCXString head;
  int headKey = 0;
  int headCode = 0;  // length of the code that head and headKey are for
  for (int index = 0; index < kLast; ++index) {
    KyCXString suffix = suffixOf(index);
    if (suffix.length() != headCode) {
      headCode = suffix.length();
      head = limit > 0 ? base.head(limit - headCode) : base;
      while (joins && head[head.length() - 1] == '_')
        head =
            head.length() > 1 ? head.head(head.length() - 1) : KyCXString("n");
      if (head.isEmpty()) return false;
      headKey = keyOf(head);
    }
    const int next = counts.firstFree(headKey, headCode, index);
    if (next != index) {
      index = next;
      suffix = suffixOf(index);
      if (suffix.length() != headCode) {
        --index;  // the codes of this length are used up
        continue;
      }
    }
    const KyCXString candidate = head + suffix;
    const bool isFound = isFree(candidate);
    counts.note(headKey, headCode, index + 1);
    if (!isFound) continue;
    base = candidate;
    return true;
  }
  return false;
}

/// The part of \p name that has to differ: the first \p count characters (0 for
/// all), in lower case if \p foldsCase.
inline KyCXString significantPart(const KyCXString& name, int count,
                                  bool foldsCase) {
  KyCXString part = count > 0 ? name.head(count) : name;
  if (foldsCase) part.toLower();
  return part;
}

}  // namespace hx_detail

#endif  // SAFENAMES_IMPLSAFENAMES_HX_VARIANTCOUNTS_H
