// Name of one generated C object on the way from template to C text.
//
// An identifier holds two names, formal and actual. Each name has a raw text,
// the template of the caller, and a cooked text, the template as far as
// expanded. A template "formal:actual" gives both names. A template without ':'
// serves for both names; the actual name then ends in the macro "$R".
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

/// A value type. No operation reports a message.
/// OWNERSHIP: pointers are borrowed; owners keep the objects alive while the
/// identifier is in use.
/// MEMORY: an operation that runs out of memory leaves the identifier as before
/// the call; a constructor makes an empty identifier.
class HX_UTILS_API HxCCIdentifier : public HX_Allocated {
 public:
  /// Selects a name. Any other value means the actual name.
  enum HxENameTypeTag : int {
    eActiveName = 0,  ///< formal while the formal name is active, else actual
    eActualName = 1,
    eFormalName = 2
  };

  /// Progress of the expansion.
  enum HxECookLevelTag : int {
    eCookLevelRaw = 0,      ///< nothing expanded
    eCookLevelDollarE = 1,  ///< $E substituted
    eCookLevelFull = 2,     ///< both templates expanded
    eCookLevelSymbol = 3    ///< symbol macros substituted
  };

  /// Empty names, formal name active, all flags false, level raw, no
  /// references.
  HxCCIdentifier();
  /// The same, then setName().
  HxCCIdentifier(const KyCXString& name);
  HxCCIdentifier(const char* name);
  HxCCIdentifier(const HxCCIdentifier& other);
  virtual ~HxCCIdentifier();

  /// Copies everything, the active name included.
  void operator=(const HxCCIdentifier& other);
  /// Like setName().
  void operator=(const KyCXString& name);
  void operator=(const char* name);

  /// Starts anew with the template \p name: all other fields get the initial
  /// value. \p name may be a name of this identifier.
  /// RETURNS: false if \p name has more than two parts (the first two parts
  /// count) or memory runs out.
  bool setName(const KyCXString& name);

  /// The template of name \p type. Without ':' both names share the template,
  /// and the actual name ends in "$R".
  const KyCXString& getRawName(HxENameTypeTag type) const;
  /// The text of name \p type as far as expanded; at first the raw name.
  const KyCXString& getCookedName(HxENameTypeTag type) const;
  /// Replaces the cooked name; the raw name stays.
  void setCookedName(const KyCXString& name, HxENameTypeTag type);

  /// Puts a text before or behind all four texts.
  void addPrefix(const KyCXString& prefix);
  void addPostfix(const KyCXString& postfix);

  /// Makes both cooked names C identifiers.
  void makeCIdentifier();

  /// Shortens both cooked names to HxCSymbol::sm_MaxNameLength, with "__" in
  /// the middle. REQUIRES for an effect: the active name may change, and the
  /// option that limits the length of names is on.
  void adaptSize();

  /// The active name stands for the identifier where no type is given.
  bool isFormalNameActive() const;
  void activateFormalName();
  void activateActualName();

  /// Progress of the expansion, set by the engine.
  HxECookLevelTag getCookLevel();
  void setCookLevel(HxECookLevelTag level);

  /// Permission to shorten the expanded name or to make the name unique.
  void setIdentifierChangeable(bool value, HxENameTypeTag type);
  bool getIdentifierChangeable(HxENameTypeTag type) const;

  /// Use of a macro by the name. From a level on (2 for $L and $N, 1 for $E)
  /// the stored flag answers; below, whether the cooked name contains the
  /// macro.
  void setDollarLUsed(bool value, HxENameTypeTag type);
  bool getDollarLUsed(HxENameTypeTag type) const;
  void setDollarEUsed(bool value, HxENameTypeTag type);
  bool getDollarEUsed(HxENameTypeTag type) const;
  void setDollarNUsed(bool value, HxENameTypeTag type);
  bool getDollarNUsed(HxENameTypeTag type) const;

  /// Label of the signal that the name is for, the value of $L; empty for a
  /// signal without a label.
  const KyCXString& getSignalLabel() const;
  void setSignalLabel(const KyCXString& label);

  /// Model object that the name is for.
  const HxCSrcRef* getSourceRef() const;
  void setSourceRef(const HxCSrcRef* srcRef);
  /// Data dictionary object that the name is for.
  const HxCSrcRef* getDdSourceRef() const;
  void setDdSourceRef(const HxCSrcRef* srcRef);
  /// Block of the intermediate view that the object stems from.
  HX_BdBlock* getSourceIVBlock();
  void setSourceIVBlock(HX_BdBlock* block);

  /// Value of the macro $X.
  void getDollarXValue(KyCXString& value) const;
  void setDollarXValue(const KyCXString& value);

 private:
  friend class HxCNames;

  struct Flags {
    bool changeable = false;
    bool dollarLUsed = false;
    bool dollarEUsed = false;
    bool dollarNUsed = false;
  };
  struct Name {
    KyCXString raw;
    KyCXString cooked;
    Flags flags;
  };

  void init();
  // copy(), setTemplate() and makeCNames() throw std::bad_alloc and then leave
  // the identifier as before.
  void copy(const HxCCIdentifier& other);
  bool setTemplate(const KyCXString& text);
  void makeCNames();
  // Sets all four texts to change(text), or none without memory.
  template <class Change>
  void changeTexts(Change change);

  HxENameTypeTag getActiveNameType(HxENameTypeTag type) const {
    if (type != eActiveName) return type;
    return m_FormalNameActive ? eFormalName : eActualName;
  }
  const Name& name(HxENameTypeTag type) const {
    return getActiveNameType(type) == eFormalName ? m_Formal : m_Actual;
  }
  Name& name(HxENameTypeTag type) {
    return const_cast<Name&>(
        static_cast<const HxCCIdentifier*>(this)->name(type));
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

/// Equality of the raw active names; all other fields may differ.
HX_UTILS_API bool operator==(const HxCCIdentifier& a, const HxCCIdentifier& b);
/// Appends \p text to all four texts. RETURNS: \p id.
HX_UTILS_API HxCCIdentifier& operator+=(HxCCIdentifier& id,
                                        const KyCXString& text);
HX_UTILS_API HxCCIdentifier& operator+=(HxCCIdentifier& id, const char* text);

#endif  // NAMING_HXCCIDENTIFIER_H
