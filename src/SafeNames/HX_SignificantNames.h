// Names that have to differ in their first characters.
//
// A compiler or linker may look at the first N characters of a name only, and
// may take capitals for small letters: 6 characters without case for external
// names in C90, 31 in C99, 31 for internal names in C90, 63 in C99.
//
//   HX_SignificantNames external(6, true);
//   HX_SignificantNames::Clash clash;
//   external.add("engine_speed", speedRef, clash);   // eAdded
//   external.add("Engine_load", loadRef, clash);     // eClash
//   // clash.first is "engine_speed" at speedRef

#ifndef SAFENAMES_HX_SIGNIFICANTNAMES_H
#define SAFENAMES_HX_SIGNIFICANTNAMES_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class HxCSrcRef;
class KyCXString;

/// Not copied. Reports no message. Places are not owned and may be null.
/// COST: one lookup per name, whatever the number of names.
class HX_UTILS_API HX_SignificantNames : public HX_Allocated {
 public:
  /// Fate of a name.
  enum HxEOutcomeTag : int {
    eAdded = 0,     ///< entered
    eClash = 1,     ///< not entered: an earlier name agrees
    eNoMemory = 2,  ///< not entered
    eNoVariant = 3  ///< not entered: no variant is left
  };

  /// Two names that agree in their significant characters. OWNERSHIP: the
  /// first name belongs to the set, and the second to the caller of add().
  struct Clash {
    const char* first = nullptr;   ///< the name that was there
    const char* second = nullptr;  ///< the name that was to be added
    /// Places given with the names.
    const HxCSrcRef* firstPlace = nullptr;
    const HxCSrcRef* secondPlace = nullptr;
  };

  /// \param count      number of characters that count; 0 for all
  /// \param foldsCase  whether capitals count as small letters (ASCII)
  HX_SignificantNames(int count, bool foldsCase);
  HX_SignificantNames(const HX_SignificantNames&) = delete;
  HX_SignificantNames& operator=(const HX_SignificantNames&) = delete;
  ~HX_SignificantNames();

  /// Enters a name. An equal name agrees, too.
  /// \param[out] clash  written for eClash
  /// RETURNS: eAdded, eClash or eNoMemory.
  HxEOutcomeTag add(const KyCXString& name, const HxCSrcRef* place,
                    Clash& clash);

  /// Enters a name or, if an earlier name agrees, the first variant that
  /// differs early: a head of the name with "_a", "_b", ..., in \p count
  /// characters altogether.
  /// \param[in,out] name  the wanted name in, the entered name out
  /// \param[out] clash    written if the name had to change; the second name
  ///                      is null
  /// RETURNS: eAdded, eNoMemory or eNoVariant.
  HxEOutcomeTag addUnique(KyCXString& name, const HxCSrcRef* place,
                          Clash& clash);

  /// The number of names.
  int size() const;

 private:
  struct Names;

  int m_Count;
  bool m_FoldsCase;
  Names* m_pNames;  // owned; null without memory
};

#endif  // SAFENAMES_HX_SIGNIFICANTNAMES_H
