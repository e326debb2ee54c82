// A name as the document asks for the name. Formed names stand in
// host/names/HX_FormedName.h.

#ifndef HOST_MODEL_HX_WANTEDNAME_H
#define HOST_MODEL_HX_WANTEDNAME_H

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Naming/HxCNames.h"
#include "SourceRef/HxCSrcRefSet.h"
#include "host/model/HX_CodeOptions.h"
#include "host/model/HX_Kinds.h"
#include "host/model/HX_Types.h"
#include "platform/model/HxCSymbol.h"

struct HX_WantedName;

struct HX_ScopeItem {
  std::string id;
  HX_ScopeKind kind = HX_ScopeKind::eFile;
  const HX_ScopeItem* parent = nullptr;
  std::map<std::string, const HX_ScopeItem*> blocks;  // inner blocks by id
};

/// A template, shared by all names with an equal template.
struct HX_Template {
  KyCXString text;                     // in ASCII, for the library
  const std::string* shown = nullptr;  // as in the document
};

struct HX_Substitution {
  KyCXString macro;
  KyCXString value;
  HxCNames::tagMacroKindEnum kind = HxCNames::eMacroKindExact;
};

/// Wishes of few names.
struct HX_RareWishes {
  std::optional<KyCXString> ivBlock;
  KyCXString x;
  std::vector<const HxCSrcRef*> alsoFrom;
  unsigned int retained = 0;     // macro bits
  unsigned int provisional = 0;  // macro bits
  bool modelContext = false;
  std::unique_ptr<HxCSymbol> symbol;  // null for none
  std::vector<HX_Substitution> substitutions;
  const HX_WantedName* task = nullptr;
  const HX_WantedName* isr = nullptr;
  std::optional<KyCXString> event;
  std::optional<KyCXString> counter;
  std::optional<KyCXString> message;
  std::optional<KyCXString> messageVariable;
  std::optional<KyCXString> osObject;
  HX_Placement placement;
  std::string unit;
  double period = 0;
  double offset = 0;
  bool cyclic = true;
};

/// Fields without a comment have the meaning of the schema. Never changed after
/// reading.
struct HX_WantedName {
  std::string id;
  std::size_t index = 0;                      // in the document
  const HX_Template* nameTemplate = nullptr;  // owned by the model
  const std::string* rule = nullptr;          // owned by the model, or null
  HX_NameKind kind = HX_NameKind::eObject;
  KyCXString label;
  const HxCSrcRef* source = nullptr;
  const HxCSrcRef* dd = nullptr;
  HX_TypeItem* type = nullptr;
  const HX_ScopeItem* scope = nullptr;
  const HX_ScopeItem* body = nullptr;  // of a function with a body
  std::vector<double> initial;
  double lsb = 1;
  double zero = 0;
  std::vector<const HX_WantedName*> dependsOn;
  std::unique_ptr<HX_RareWishes> rareWishes;  // null for none

  bool isTask() const {
    return kind == HX_NameKind::eTask || kind == HX_NameKind::eIsr;
  }
  bool isFunction() const { return isTask() || kind == HX_NameKind::eFunction; }
  const HX_RareWishes& rare() const {
    static const HX_RareWishes s_None;
    return rareWishes != nullptr ? *rareWishes : s_None;
  }
  HX_RareWishes& makeRare() {
    if (rareWishes == nullptr) rareWishes = std::make_unique<HX_RareWishes>();
    return *rareWishes;
  }
  /// RETURNS: source, dd and alsoFrom.
  HxCSrcRefSet sources() const {
    HxCSrcRefSet set(source);
    set.addSrcRef(dd);
    for (const HxCSrcRef* also : rare().alsoFrom) set.addSrcRef(also);
    return set;
  }
  /// RETURNS: the task or isr whose times the macros take; null for none.
  const HX_WantedName* timed() const {
    if (isTask()) return this;
    return rare().task != nullptr ? rare().task : rare().isr;
  }
};

#endif  // HOST_MODEL_HX_WANTEDNAME_H
