// A flat set of names that derives a free variant of a taken name.
//
// A taken name gets "_a", "_b", ... "_z", "_aa", "_ba", ... appended until the
// result is free (HxCNames::appendSuffix). Each name has a counter, the index
// of the suffix that its last derivation stopped at, so the hundredth variant
// of one name does not retry the first 99.
//
//   HX_LimitedNameSpace names;
//   KyCXString s("gain");
//   names.addUnique(s);               // s == "gain"
//   s = "gain"; names.addUnique(s);   // s == "gain_a"

#ifndef NAMESPACE_HX_LIMITEDNAMESPACE_H
#define NAMESPACE_HX_LIMITEDNAMESPACE_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "NameSpace/HX_KeyTable.h"
#include "Naming/HxCNames.h"
#include "platform/strings/KyCXString.h"

/// Copying copies the names and their counters. No operation reports; a name
/// for which there is no memory is not entered. The forms that take a pointer
/// do what the others do with the text pointed to; it must not be null.
///
/// Cost of a derivation: few lookups. With the length limit on, long names lose
/// their ends to the suffix and many then compete for the variants of one head,
/// each counting from 0; the variants found taken are kept as runs per head, so
/// that a search does not look at each again.
class HX_UTILS_API HX_LimitedNameSpace : public HX_Allocated {
 public:
  HX_LimitedNameSpace() = default;
  HX_LimitedNameSpace(const HX_LimitedNameSpace& other);
  HX_LimitedNameSpace& operator=(const HX_LimitedNameSpace& other);
  ~HX_LimitedNameSpace();

  /// Enters a name with counter 0; one already present keeps its counter.
  void add(KyCXString& s);
  void add(KyCXString* s) { add(*s); }

  /// True if exactly this name is in the set; case matters.
  bool isDefined(KyCXString& s) { return findDefined(s) != nullptr; }
  bool isDefined(KyCXString* s) { return isDefined(*s); }

  /// Takes a name out, with its counter; nothing happens if it is not there.
  /// The counter of the name it was derived from stays, so that its suffix is
  /// not used again for that name.
  void remove(const KyCXString& s);

  /// Enters the name or, if it is taken, its first free variant from its
  /// counter on.
  /// \param[in,out] s  the wanted name in, the entered name out
  void addUnique(KyCXString& s);
  void addUnique(KyCXString* s) { addUnique(*s); }

  /// What addUnique() would give, without entering it: again the same name
  /// until the set changes.
  /// \param[out] derived  whether \p s was taken and had to change
  void deriveUniqueString(KyCXString& s);
  void deriveUniqueString(KyCXString* s) { deriveUniqueString(*s); }
  void deriveUniqueString(KyCXString& s, bool& derived);
  void deriveUniqueString(KyCXString* s, bool& derived) {
    deriveUniqueString(*s, derived);
  }

  /// The same for a name that must not be longer than
  /// HxCSymbol::sm_MaxNameLength, whether or not the option limits names: a
  /// longer name, and each longer variant, loses its middle to "__". The first
  /// variant is one of the shortened name, the others of the name itself; so a
  /// repeated call may give another name, which is free as well.
  /// \param[out] derived  false also if \p s was only shortened
  void deriveUniqueStringAdaptLength(KyCXString& s);
  void deriveUniqueStringAdaptLength(KyCXString& s, bool& derived);

 private:
  struct Name;

  bool deriveUniqueString(const KyCXString& in, KyCXString& out, bool& derived,
                          bool addResult, bool adaptLength);
  int searchVariant(const Name& base, const KyCXString& in, KyCXString& out,
                    bool adaptLength);
  int noteTaken(const KyCXString& name, int index);
  void adaptStringLength(KyCXString& s);

  Name* find(const KyCXString& text) const;
  Name* findDefined(const KyCXString& text) const;
  Name* findOrMake(const KyCXString& text);
  bool enter(const KyCXString& text);
  void dropIfUnused(Name* name);
  void clear();

  // The names of the set and heads of variants, by the hash of the text; owned.
  HX_KeyTable<Name*> m_Names;
  HxCNames m_Naming;  // only for appendSuffix
};

#endif  // NAMESPACE_HX_LIMITEDNAMESPACE_H
