// Data of a name with a symbol in a scope.

#ifndef NAMESPACE_HXCSMBSCOPEDATA_H
#define NAMESPACE_HXCSMBSCOPEDATA_H

#include "Control/HX_Allocated.h"

class HxCSymbol;

/// Value type. The symbol is not owned. The collision count serves the caller
/// who makes names unique, starts at 0 and has no bounds.
class HxCSmbScopeData : public HX_Allocated {
 public:
  /// An entry for \p symbol, which may be null; no collisions.
  explicit HxCSmbScopeData(HxCSymbol* symbol) : m_pSymbol(symbol) {}

  /// The symbol; may be null.
  HxCSymbol* getSymbol() const { return m_pSymbol; }
  void setSymbol(HxCSymbol* symbol) { m_pSymbol = symbol; }

  /// Number of names that collided with this name, counted by the caller.
  int getCollisionCount() const { return m_CollisionCount; }
  void setCollisionCount(int count) { m_CollisionCount = count; }
  void incrCollisionCount() { ++m_CollisionCount; }
  void decrCollisionCount() { --m_CollisionCount; }

 private:
  int m_CollisionCount = 0;
  HxCSymbol* m_pSymbol;
};

#endif  // NAMESPACE_HXCSMBSCOPEDATA_H
