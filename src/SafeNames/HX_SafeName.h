// A name given by HX_SafeNames, with the steps from the template to the name.
//
//   for (int i = 0; i < name.stepCount(); ++i) show(name.step(i).text);

#ifndef SAFENAMES_HX_SAFENAME_H
#define SAFENAMES_HX_SAFENAME_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "Naming/HxCNames.h"
#include "platform/strings/KyCXString.h"

class HxCSymbol;

/// A name that HX_SafeNames gave, with the steps on the way. Reused from call
/// to call, an object asks for no memory of its own.
class HX_UTILS_API HX_SafeName : public HX_Allocated {
 public:
  /// Change of the text, or reason of a change.
  enum HxEStepTag : int {
    // Changes of the text.
    eExpanded = 0,    ///< macros of the template got their values
    eIdentifier = 1,  ///< made a C identifier
    eShortened = 2,   ///< cut to the longest length
    eLocked = 3,      ///< took the name of the lock
    eRewritten = 4,   ///< changed so that no chosen pattern matches
    eDerived = 5,     ///< a variant of the name
    // Conflicts: reasons of the next change or of the failure.
    eEmpty = 6,     ///< the name is empty
    eKeyword = 7,   ///< a word of the keyword dictionary; see wordKind
    eReserved = 8,  ///< a word of a profile; reason is the profile
    ePattern = 9,   ///< matches a pattern; reason is its name
    eTaken = 10,    ///< another name of the scope, around or inside it
    eIndistinct =
        11,         ///< agrees with another name in its significant characters
    eHeld = 12,     ///< the lock keeps the name for another item
    eRetired = 13,  ///< the lock keeps the name of an item that went
    eIncomplete = 14,  ///< macros are retained: nothing is defined yet
    eTooLong = 15,     ///< longer than the limit, and may not change
    eNoVariant = 16,   ///< every variant is taken
    eNoMemory = 17
  };

  /// Step on the road.
  struct Step {
    HxEStepTag kind = eExpanded;  ///< change or conflict
    KyCXString text;  ///< the name after the step, or the name in conflict
    const char* reason = nullptr;       ///< profile or pattern
    const HxCSymbol* symbol = nullptr;  ///< the other name's symbol, if any
    const char* other = nullptr;        ///< the other name or the lock's item
    /// Kind of the word, for eKeyword.
    HxCNames::tagHxEDictEntryType wordKind = HxCNames::eDictCKeyword;
  };

  /// The name; empty if nothing was defined.
  const KyCXString& text() const { return m_Text; }
  /// The name before the search for a free one; a lock compares wanted names.
  const KyCXString& wanted() const { return m_Wanted; }
  /// Whether all macros were expanded.
  bool isComplete() const { return m_IsComplete; }
  /// Whether the name was defined.
  bool isDefined() const { return m_IsDefined; }
  /// The steps, in their order. OWNERSHIP: the texts behind the pointers
  /// belong to HX_SafeNames, the profiles and the lock.
  int stepCount() const { return m_StepCount; }
  const Step& step(int index) const { return m_Steps[index]; }

 private:
  friend class HX_SafeNames;

  static constexpr int kMaxSteps = 10;

  void clear();
  Step& add(HxEStepTag kind, const KyCXString& text);

  KyCXString m_Text;
  KyCXString m_Wanted;
  bool m_IsComplete = true;
  bool m_IsDefined = false;
  int m_StepCount = 0;
  Step m_Steps[kMaxSteps];
};

#endif  // SAFENAMES_HX_SAFENAME_H
