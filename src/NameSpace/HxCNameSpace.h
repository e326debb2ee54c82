// Names taken in nested scopes of the generated code, with a symbol per name.
//
//   HxCNameSpace file(&ids), body(&ids);
//   auto* root = file.newEnv();
//   body.newScope(root);
//   body.defineString("i", symbol);
//   file.stringInEnv("i");     // true: taken in an inner scope
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

/// Handle to one scope, the current scope. Copies refer to the same scope.
///
/// OWNERSHIP: a handle owns neither scopes nor server. The user deletes the
/// root of a tree once no handle refers to a scope of the tree (see
/// HxCObjectEnvironment).
///
/// A key is the id of a name in the server. Every operation with a string adds
/// the string to the server.
///
/// FAILURE: without a current scope all operations below getDebugIndex(), but
/// not createIdn(), raise an internal assertion and return false. So do
/// operations with a string while the server is null or down. Without memory
/// an operation returns false, or null, and raises no assertion.
class HX_UTILS_API HxCNameSpace : public HX_Allocated {
 public:
  /// A scope owns the data of its entries.
  using Scope = HxCObjectEnvironment<HxCSmbScopeData*>;

  /// Number of handles constructed from a server; copies do not count.
  static int sm_ObjectCount;

  /// A handle without a current scope.
  explicit HxCNameSpace(HxCXStringIdServer* idServer);

  /// Makes a new root the current scope. A handle with a current scope keeps
  /// its scope, after an internal assertion.
  /// RETURNS: the current scope; null without memory.
  Scope* newEnv();

  /// Makes a new scope the current scope: the last child of \p parent or, for
  /// null, a root. A handle with a current scope keeps its scope and makes no
  /// new scope.
  /// RETURNS: the current scope; null without memory.
  Scope* newScope(Scope* parent);

  /// The current scope; null for an empty handle.
  Scope* getScope() const { return m_pScope; }
  /// Null empties the handle.
  void setScope(Scope* scope) { m_pScope = scope; }

  /// sm_ObjectCount at the construction of this handle or, for a copy, of its
  /// original.
  int getDebugIndex() const { return m_DebugIndex; }

  /// \param[out] key  the id of \p s; written unless the server fails
  void createIdn(const KyCXString& s, int& key);

  /// Define a name in the current scope; a name without a symbol has no scope
  /// data. Names of scopes around and inside do not stand in the way.
  /// RETURNS: false, with nothing changed, if the current scope holds the name
  /// already, or without memory.
  bool defineIdn(int key);
  bool defineIdn(int key, HxCSymbol* symbol);
  bool defineString(const KyCXString& s);
  bool defineString(const KyCXString& s, HxCSymbol* symbol);

  /// True if the current scope itself holds the name.
  bool keyInScope(int key);
  bool stringInScope(const KyCXString& s);
  /// \param[out] symbol  written if the result is true
  /// RETURNS: false also for a name defined without a symbol.
  bool stringInScope(const KyCXString& s, HxCSymbol*& symbol);

  /// True if the name is taken in the current scope, in a scope around or in a
  /// scope inside.
  bool keyInEnv(int key);
  bool stringInEnv(const KyCXString& s);
  /// \param[out] data  result of HxCObjectEnvironment::lookupInEnv(), owned by
  ///                   its scope; null if the result is false
  bool keyInEnv(int key, HxCSmbScopeData*& data);
  bool stringInEnv(const KyCXString& s, HxCSmbScopeData*& data);
  /// \param[out] symbol  symbol of the data; written if the result is true
  bool keyInEnv(int key, HxCSymbol*& symbol);
  bool stringInEnv(const KyCXString& s, HxCSymbol*& symbol);

  /// Removes a name from the current scope and deletes its scope data; the
  /// symbol stays.
  /// RETURNS: false, with nothing changed, if the current scope itself does not
  /// hold the name.
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
