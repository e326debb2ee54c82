// From a name template to a defined C name in a call.
//
//   HX_SafeNames names;
//   names.setReserved(&reserved);                    // words and patterns
//   HX_SafeNames::Scope* file = names.addScope("file", nullptr);
//   HX_SafeNames::Request request;
//   request.scope = file;
//   HX_SafeName name;                                // reused for many names
//   if (names.create(id, type, request, name))
//     emit(name.text());                             // "speed_a"
//   for (int i = 0; i < name.stepCount(); ++i) ...   // changes and reasons
//
// The steps, in this order:
//
//   1. expand the template (create() only)
//   2. make the name a C identifier
//   3. shorten it to HxCSymbol::sm_MaxNameLength, if the option limits names
//      and the name may change
//   4. take the name of the lock, if the wanted name did not change
//   5. rewrite a changeable name that matches a chosen pattern
//   6. check reserved words, patterns and taken names
//   7. derive the first free variant, if the name may change
//   8. define the name, note the name in the lock
//
// The same calls in the same order give the same names on every machine.

#ifndef SAFENAMES_HX_SAFENAMES_H
#define SAFENAMES_HX_SAFENAMES_H

#include <string_view>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "Naming/HxCNames.h"
#include "SafeNames/HX_SafeName.h"
#include "platform/strings/KyCXString.h"

class HxCCIdentifier;
class HX_DataType;
class HX_NameLock;
class HX_ReservedNames;
class HxCSymbol;

/// Not copied. Scopes, reserved names and the lock are used, not copied: the
/// host keeps all alive. Only the expansion reports messages, as
/// HxCNames::createNameFromForm() does.
///
/// COST of a name: the expansion and some lookups, whatever the number of names
/// and of variants.
class HX_UTILS_API HX_SafeNames : public HX_Allocated {
 public:
  class Scope;

  /// Wishes of the caller.
  struct Request {
    Scope* scope = nullptr;   ///< never null
    bool isExternal = false;  ///< whether the name has external linkage
    /// Kept with the name, returned by conflicts with the name; may be null.
    HxCSymbol* symbol = nullptr;
    /// The item's id for the lock, UTF-8; empty for a name without an item.
    std::string_view item;
    unsigned int retainedMacros = 0;     ///< see createNameFromForm()
    unsigned int provisionalMacros = 0;  ///< see createNameFromForm()
    bool suppressMessages = false;       ///< see createNameFromForm()
  };

  HX_SafeNames();
  HX_SafeNames(const HX_SafeNames&) = delete;
  HX_SafeNames& operator=(const HX_SafeNames&) = delete;
  ~HX_SafeNames();

  /// Words and patterns to keep free of; null for none.
  void setReserved(const HX_ReservedNames* reserved);

  /// The number of characters in which names must differ; 0 for all.
  /// \param internal   of names that must not be equal
  /// \param external   of external names of all scopes
  /// \param foldsCase  whether capitals count as small letters
  /// REQUIRES: nothing is defined yet.
  void setSignificance(int internal, int external, bool foldsCase);

  /// A scope named \p name inside \p parent, null for a scope of its own. A
  /// name is taken in a scope if the scope, an outer or an inner scope holds
  /// the name.
  /// OWNERSHIP: the scope belongs to this object.
  /// RETURNS: null without memory.
  Scope* addScope(std::string_view name, Scope* parent);

  /// Keeps the names of \p lock: held for the items from now on, and
  /// notes all given names. Begins a run of the lock.
  /// REQUIRES: all scopes exist, nothing is defined yet.
  /// RETURNS: false without memory; the names then have no lock.
  bool useLock(HX_NameLock* lock);

  /// Takes a given name, for example of a constant.
  /// RETURNS: false if the name is taken or there is no memory.
  bool reserveName(const KyCXString& name, Scope* scope, HxCSymbol* symbol);

  /// Expands the template of \p id and defines the actual name. \p id gets the
  /// defined name as its cooked actual name and has the actual name active.
  /// RETURNS: whether the name was defined. A name with retained macros is not
  /// defined.
  bool create(HxCCIdentifier& id, HX_DataType* type, const Request& request,
              HX_SafeName& result);

  /// The same from step 2 on, for an expanded \p id.
  bool define(HxCCIdentifier& id, const Request& request, HX_SafeName& result);

 private:
  struct Content;

  Content* m_pContent;  // owned; null without memory
};

#endif  // SAFENAMES_HX_SAFENAMES_H
