// What a scope stores for a name that stands for a symbol.

#ifndef NAMESPACE_HXCSMBSCOPEDATA_H
#define NAMESPACE_HXCSMBSCOPEDATA_H

#include "Control/HX_Allocated.h"

class HxCSymbol;

/// A value type. The symbol is not owned; the collision count belongs to
/// whoever makes names unique, starts at 0 and has no bounds.
class HxCSmbScopeData : public HX_Allocated {
 public:
  /// An entry for \p symbol, which may be null; no collisions.
  explicit HxCSmbScopeData(HxCSymbol* symbol) : m_pSymbol(symbol) {}

  /// The symbol; null if it has none.
  HxCSymbol* getSymbol() const { return m_pSymbol; }
  void setSymbol(HxCSymbol* symbol) { m_pSymbol = symbol; }

  /// How many names have collided with this one, as its user counts.
  int getCollisionCount() const { return m_CollisionCount; }
  void setCollisionCount(int count) { m_CollisionCount = count; }
  void incrCollisionCount() { ++m_CollisionCount; }
  void decrCollisionCount() { --m_CollisionCount; }

 private:
  int m_CollisionCount = 0;
  HxCSymbol* m_pSymbol;
};

#endif  // NAMESPACE_HXCSMBSCOPEDATA_H
