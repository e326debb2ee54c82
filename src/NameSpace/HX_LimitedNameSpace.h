// Flat set of C names that derives a free variant of a taken name.
//
// A taken name gets "_a", "_b", ... "_z", "_aa", "_ba", ... appended until the
// result is free (HxCNames::appendSuffix). Every name has a counter: the index
// of the last suffix derived from the name. The hundredth variant of a name
// does not retry the first 99 suffixes.
//
//   HX_LimitedNameSpace names;
//   KyCXString s("gain");
//   names.addUnique(s);               // s == "gain"
//   s = "gain"; names.addUnique(s);   // s == "gain_a"

#ifndef NAMESPACE_HX_LIMITEDNAMESPACE_H
#define NAMESPACE_HX_LIMITEDNAMESPACE_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "Naming/HxCNames.h"
#include "implContainers/HX_HashTable.h"
#include "platform/strings/KyCXString.h"

/// Copying copies names and counters. No operation reports. A form with a
/// pointer does the same as the form with a reference; null is not allowed.
///
/// Without memory an operation changes neither the set nor the argument,
/// \p derived is false, an assignment keeps the old names, a copy is empty.
/// isDefined() and remove() need no memory.
///
/// COST: a derivation takes few lookups, also where long names compete for the
/// variants of one head (see the source).
class HX_UTILS_API HX_LimitedNameSpace : public HX_Allocated {
 public:
  HX_LimitedNameSpace() = default;
  HX_LimitedNameSpace(const HX_LimitedNameSpace& other);
  HX_LimitedNameSpace& operator=(const HX_LimitedNameSpace& other);
  ~HX_LimitedNameSpace();

  /// Enters \p s with counter 0; a present name keeps its counter.
  void add(KyCXString& s);
  void add(KyCXString* s) { add(*s); }

  /// True if exactly \p s is in the set; case matters.
  bool isDefined(KyCXString& s) { return findDefined(s) != nullptr; }
  bool isDefined(KyCXString* s) { return isDefined(*s); }

  /// Removes \p s with its counter; nothing happens for an absent name. The
  /// counter of the name from which \p s was derived stays, so the suffix of
  /// \p s is not used again.
  void remove(const KyCXString& s);

  /// Enters \p s or, if \p s is taken, the first free variant from the counter
  /// of \p s on.
  /// \param[in,out] s  the wanted name in, the entered name out
  void addUnique(KyCXString& s);
  void addUnique(KyCXString* s) { addUnique(*s); }

  /// Derives the name that addUnique() would enter, without entering the name.
  /// Repeated calls give the same name until the set changes.
  /// \param[out] derived  whether \p s was taken and changed
  void deriveUniqueString(KyCXString& s);
  void deriveUniqueString(KyCXString* s) { deriveUniqueString(*s); }
  void deriveUniqueString(KyCXString& s, bool& derived);
  void deriveUniqueString(KyCXString* s, bool& derived) {
    deriveUniqueString(*s, derived);
  }

  /// Derives a name of at most HxCSymbol::sm_MaxNameLength characters, whether
  /// or not the option limits names; a longer name or variant loses its middle
  /// to "__". The first variant is built from the shortened name, every later
  /// variant from \p s itself. A repeated call may give another free name.
  /// \param[out] derived  false also if \p s was only shortened
  void deriveUniqueStringAdaptLength(KyCXString& s);
  void deriveUniqueStringAdaptLength(KyCXString& s, bool& derived);

 private:
  struct Name;

  void derive(KyCXString& s, bool& derived, bool addResult, bool adaptLength);
  bool deriveUniqueString(const KyCXString& in, KyCXString& out, bool& derived,
                          bool addResult, bool adaptLength);
  int searchVariant(const Name& base, const KyCXString& in, KyCXString& out,
                    bool adaptLength);
  int noteTaken(const KyCXString& variant, int index);
  void forgetTaken(const KyCXString& variant);
  void adaptStringLength(KyCXString& s);

  Name* find(const KyCXString& text) const;
  Name* find(const KyCXString& text, int hash) const;
  Name* findDefined(const KyCXString& text) const;
  Name* findOrMake(const KyCXString& text);
  void copyNames(const HX_LimitedNameSpace& other);
  void dropIfUnused(Name* name);

  // Names of the set and heads of variants by the hash of the text; owned.
  HX_HashTable<int, Name*> m_Names;
  HxCNames m_Naming;  // only for appendSuffix
};

#endif  // NAMESPACE_HX_LIMITEDNAMESPACE_H
