// A name as the document asks for the name. Names that were formed stand in
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
#include "host/model/HX_Kinds.h"
#include "host/model/HX_Types.h"
#include "platform/model/HxCSymbol.h"

struct HX_ScopeItem {
  std::string id;
  HX_ScopeKind kind = HX_ScopeKind::eFile;
  const HX_ScopeItem* parent = nullptr;
  std::map<std::string, const HX_ScopeItem*> blocks;  // inner blocks by id
};

struct HX_Substitution {
  KyCXString macro;
  KyCXString value;
  HxCNames::tagMacroKindEnum kind;
};

/// Fields without a comment mean what the schema says. Never changed after
/// reading.
struct HX_WantedName {
  /// Texts for the macros of the operating system, null for a missing text.
  struct OsTexts {
    std::optional<KyCXString> event;
    std::optional<KyCXString> counter;
    std::optional<KyCXString> message;
    std::optional<KyCXString> messageVariable;
    std::optional<KyCXString> osObject;
  };

  std::string id;
  KyCXString nameTemplate;
  HX_NameKind kind = HX_NameKind::eObject;
  const HxCSrcRef* source = nullptr;
  const HxCSrcRef* dd = nullptr;
  HxCSrcRefSet sources;  // source, dd and `alsoFrom`
  std::optional<KyCXString> ivBlock;
  KyCXString label;
  KyCXString x;
  HX_TypeItem* type = nullptr;
  const HX_ScopeItem* scope = nullptr;
  unsigned int retained = 0;     // macro bits
  unsigned int provisional = 0;  // macro bits
  bool modelContext = false;
  std::unique_ptr<HxCSymbol> symbol;  // null for none
  std::vector<HX_Substitution> substitutions;
  const HX_WantedName* task = nullptr;
  const HX_WantedName* isr = nullptr;
  OsTexts osTexts;
  double period = 0;
  double offset = 0;
  bool cyclic = true;
  std::vector<double> initial;
  double lsb = 1;
  double zero = 0;
  std::vector<const HX_WantedName*> dependsOn;

  const HX_ScopeItem* body = nullptr;  // of a function with a body

  bool isTask() const {
    return kind == HX_NameKind::eTask || kind == HX_NameKind::eIsr;
  }
  bool isFunction() const { return isTask() || kind == HX_NameKind::eFunction; }
  /// RETURNS: the task or isr whose times the macros take; null for none.
  const HX_WantedName* timed() const {
    if (isTask()) return this;
    return task != nullptr ? task : isr;
  }
};

#endif  // HOST_MODEL_HX_WANTEDNAME_H
