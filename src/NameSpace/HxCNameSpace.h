// Which names are taken in nested scopes of the generated code, and which
// symbol each stands for.
//
//   HxCNameSpace file(&ids), body(&ids);
//   auto* root = file.newEnv();
//   body.newScope(root);
//   body.defineString("i", symbol);
//   file.stringInEnv("i");     // true: an inner scope uses it
//   file.stringInScope("i");   // false
//   delete root;               // the scopes outlive the handles

#ifndef NAMESPACE_HXCNAMESPACE_H
#define NAMESPACE_HXCNAMESPACE_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "NameSpace/HxCObjectEnvironment.h"
#include "NameSpace/HxCSmbScopeData.h"

class HxCSymbol;
class HxCXStringIdServer;
class KyCXString;

/// A handle to one scope, its current scope. Copies refer to the same scope;
/// destruction leaves the scopes alone. Their user deletes the root of a tree
/// once no handle refers into it (see HxCObjectEnvironment).
///
/// A key is the id that the server gives to a name; each operation with a
/// string adds that string to the server. The server is not owned and must be
/// up.
///
/// Without a current scope, all but the first group of operations and
/// createIdn() raise an internal assertion and give false; so do operations
/// with a string while the server is null, down or out of memory (which raises
/// no assertion).
class HX_UTILS_API HxCNameSpace : public HX_Allocated {
 public:
  /// A scope as this class makes it; its values are owned by it.
  using Scope = HxCObjectEnvironment<HxCSmbScopeData*>;

  /// The handles constructed from a server so far; copies do not count.
  static int sm_ObjectCount;

  /// A handle without a current scope.
  explicit HxCNameSpace(HxCXStringIdServer* idServer);

  /// Makes a new root the current scope. A handle that has a current scope
  /// keeps it, after an internal assertion.
  /// \return the current scope; null if there was no memory
  Scope* newEnv();

  /// Makes a new scope the current one: the last child of \p parent or, for
  /// null, a root. A handle that has a current scope keeps it and makes none.
  /// \return the current scope; null if there was no memory
  Scope* newScope(Scope* parent);

  /// The current scope, null if the handle has none.
  Scope* getScope() const { return m_pScope; }
  /// Null empties the handle.
  void setScope(Scope* scope) { m_pScope = scope; }

  /// sm_ObjectCount at the construction of this handle or, for a copy, of its
  /// original.
  int getDebugIndex() const { return m_DebugIndex; }

  /// \param[out] key  the id of \p s; written unless the server fails
  void createIdn(const KyCXString& s, int& key);

  /// Define a name in the current scope; without a symbol it has no scope
  /// data. Names of scopes around and inside do not stand in the way.
  /// \return false, with nothing changed, if the current scope holds the name
  ///         already or there is no memory
  bool defineIdn(int key);
  bool defineIdn(int key, HxCSymbol* symbol);
  bool defineString(const KyCXString& s);
  bool defineString(const KyCXString& s, HxCSymbol* symbol);

  /// Whether the current scope itself holds a name.
  bool keyInScope(int key);
  bool stringInScope(const KyCXString& s);
  /// \param[out] symbol  written when the result is true
  /// \return false also for a name defined without a symbol
  bool stringInScope(const KyCXString& s, HxCSymbol*& symbol);

  /// Whether a name is taken in the environment of the current scope: there,
  /// around it or inside it.
  bool keyInEnv(int key);
  bool stringInEnv(const KyCXString& s);
  /// \param[out] data  what HxCObjectEnvironment::lookupInEnv() gives, owned by
  ///                   its scope; null when the result is false
  bool keyInEnv(int key, HxCSmbScopeData*& data);
  bool stringInEnv(const KyCXString& s, HxCSmbScopeData*& data);
  /// \param[out] symbol  the symbol of that data; written when the result is
  ///                     true
  bool keyInEnv(int key, HxCSymbol*& symbol);
  bool stringInEnv(const KyCXString& s, HxCSymbol*& symbol);

  /// Takes a name out of the current scope and destroys its scope data; the
  /// symbol stays.
  /// \return false, with nothing changed, if the current scope itself does not
  ///         hold the name
  bool remove(const KyCXString& s);

 private:
  static HxCSmbScopeData* createScopeData(HxCSymbol* symbol);
  bool hasScope() const;
  bool keyOf(const KyCXString& s, int& key) const;

  Scope* m_pScope = nullptr;
  HxCXStringIdServer* m_pIdServer;
  int m_DebugIndex;
};

#endif  // NAMESPACE_HXCNAMESPACE_H
