// The name of one generated C object on its way from template to C text.
//
// An identifier holds two names, formal and actual, each as the template the
// caller gave (raw) and as the text expanded so far (cooked). A template
// "formal:actual" gives them separately; without ':' both are the same, and the
// actual one may be changed (it gets the macro $R).
//
//   HxCCIdentifier id("$S_$B");
//   id.setSourceRef(block.getSrcRef());
//   HxCNames names;
//   names.createNameFromForm(id, nullptr, 0, 0, false);
//   id.getCookedName(HxCCIdentifier::eActualName);   // "Sa1_Speed_Gain"

#ifndef NAMING_HXCCIDENTIFIER_H
#define NAMING_HXCCIDENTIFIER_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/strings/KyCXString.h"

class HX_BdBlock;
class HxCSrcRef;

/// A value type. The pointers it holds are borrowed: their owners keep them
/// alive for as long as the identifier is used. Nothing here reports a message.
class HX_UTILS_API HxCCIdentifier : public HX_Allocated {
 public:
  /// Selects one of the two names. Any other value addresses the actual name.
  enum HxENameTypeTag : int {
    eActiveName = 0,  ///< the formal name while it is active, else the actual
    eActualName = 1,
    eFormalName = 2
  };

  /// How far the identifier has been expanded.
  enum HxECookLevelTag : int {
    eCookLevelRaw = 0,      ///< nothing expanded
    eCookLevelDollarE = 1,  ///< $E substituted
    eCookLevelFull = 2,     ///< both templates expanded
    eCookLevelSymbol = 3    ///< the symbol macros substituted as well
  };

  /// Empty names, the formal one active, all flags false, level raw, no
  /// references.
  HxCCIdentifier() = default;
  /// The same, then setName().
  HxCCIdentifier(const KyCXString& name);
  HxCCIdentifier(const char* name);
  HxCCIdentifier(const HxCCIdentifier&) = default;
  HxCCIdentifier& operator=(const HxCCIdentifier&) = default;
  /// Like setName().
  HxCCIdentifier& operator=(const KyCXString& name);
  HxCCIdentifier& operator=(const char* name);
  virtual ~HxCCIdentifier();

  /// Starts anew with the template \p name: everything else gets its initial
  /// value. \p name may be one of this identifier's own names.
  /// \return false if \p name has more than two parts; the first two count.
  bool setName(const KyCXString& name);

  /// That part of the template; a template of one part is both, and the actual
  /// one then ends in "$R".
  const KyCXString& getRawName(HxENameTypeTag type) const {
    return name(type).raw;
  }
  /// The name as far as it is expanded; the raw name at first.
  const KyCXString& getCookedName(HxENameTypeTag type) const {
    return name(type).cooked;
  }
  /// The raw name stays.
  void setCookedName(const KyCXString& name, HxENameTypeTag type);
  void setCookedName(KyCXString&& name, HxENameTypeTag type);

  /// Puts the text before, or after, all four names.
  void addPrefix(const KyCXString& prefix);
  void addPostfix(const KyCXString& postfix);

  /// Makes both cooked names C identifiers.
  void makeCIdentifier();

  /// Shortens both cooked names to HxCSymbol::sm_MaxNameLength with
  /// "__" for their middle, if the active name may be changed and the option
  /// that limits the length of names is on.
  void adaptSize();

  /// Which of the two names stands for the identifier where no type is given.
  bool isFormalNameActive() const { return m_FormalNameActive; }
  void activateFormalName() { m_FormalNameActive = true; }
  void activateActualName() { m_FormalNameActive = false; }

  /// How far the names are expanded; set by whoever expands them.
  HxECookLevelTag getCookLevel() const { return m_CookLevel; }
  void setCookLevel(HxECookLevelTag level) { m_CookLevel = level; }

  /// Whether the expanded name may still be changed, to shorten it or to make
  /// it unique.
  void setIdentifierChangeable(bool value, HxENameTypeTag type) {
    name(type).changeable = value;
  }
  bool getIdentifierChangeable(HxENameTypeTag type) const {
    return name(type).changeable;
  }

  /// Whether the name uses the macro. The stored answer counts once the
  /// identifier is expanded far enough (level 2 for $L and $N, 1 for $E);
  /// before that, whether the cooked name contains the macro.
  void setDollarLUsed(bool value, HxENameTypeTag type) {
    name(type).dollarLUsed = value;
  }
  bool getDollarLUsed(HxENameTypeTag type) const;
  void setDollarEUsed(bool value, HxENameTypeTag type) {
    name(type).dollarEUsed = value;
  }
  bool getDollarEUsed(HxENameTypeTag type) const;
  void setDollarNUsed(bool value, HxENameTypeTag type) {
    name(type).dollarNUsed = value;
  }
  bool getDollarNUsed(HxENameTypeTag type) const;

  /// The label of the signal that the name is for, the value of $L; empty if it
  /// has none.
  const KyCXString& getSignalLabel() const { return m_SignalLabel; }
  void setSignalLabel(const KyCXString& label) { m_SignalLabel = label; }

  /// The model object that the name is for.
  const HxCSrcRef* getSourceRef() const { return m_pSourceRef; }
  void setSourceRef(const HxCSrcRef* srcRef) { m_pSourceRef = srcRef; }
  /// The data dictionary object that the name is for.
  const HxCSrcRef* getDdSourceRef() const { return m_pDdSourceRef; }
  void setDdSourceRef(const HxCSrcRef* srcRef) { m_pDdSourceRef = srcRef; }
  /// The block of the intermediate view that the object stems from.
  HX_BdBlock* getSourceIVBlock() const { return m_pSourceIVBlock; }
  void setSourceIVBlock(HX_BdBlock* block) { m_pSourceIVBlock = block; }

  /// The text that the macro $X stands for.
  void getDollarXValue(KyCXString& value) const { value = m_DollarXValue; }
  void setDollarXValue(const KyCXString& value) { m_DollarXValue = value; }

 private:
  struct Name {
    KyCXString raw;
    KyCXString cooked;
    bool changeable = false;
    bool dollarLUsed = false;
    bool dollarEUsed = false;
    bool dollarNUsed = false;
  };

  HxENameTypeTag getActiveNameType(HxENameTypeTag type) const {
    if (type != eActiveName) return type;
    return m_FormalNameActive ? eFormalName : eActualName;
  }
  const Name& name(HxENameTypeTag type) const {
    return getActiveNameType(type) == eFormalName ? m_Formal : m_Actual;
  }
  Name& name(HxENameTypeTag type) {
    return getActiveNameType(type) == eFormalName ? m_Formal : m_Actual;
  }
  friend HX_UTILS_API HxCCIdentifier& operator+=(HxCCIdentifier& id,
                                                 const KyCXString& text);

  Name m_Actual;
  Name m_Formal;
  bool m_FormalNameActive = true;
  HxECookLevelTag m_CookLevel = eCookLevelRaw;
  KyCXString m_SignalLabel;
  const HxCSrcRef* m_pSourceRef = nullptr;
  const HxCSrcRef* m_pDdSourceRef = nullptr;
  HX_BdBlock* m_pSourceIVBlock = nullptr;
  KyCXString m_DollarXValue;
};

/// True if the raw active names are equal; nothing else counts.
HX_UTILS_API bool operator==(const HxCCIdentifier& a, const HxCCIdentifier& b);
/// Appends \p text to all four names. \return \p id
HX_UTILS_API HxCCIdentifier& operator+=(HxCCIdentifier& id,
                                        const KyCXString& text);
HX_UTILS_API HxCCIdentifier& operator+=(HxCCIdentifier& id, const char* text);

#endif  // NAMING_HXCCIDENTIFIER_H
