// The references to everything that one generated item stems from.
//
//   HxCSrcRefSet sources(block->getSrcRef());
//   sources.addSrcRef(variable.getDdSrcRef());
//   sources.forEach([](const HxCSrcRef* ref) { print(ref); });
//
// Nearly every item stems from one object, so a set is a single pointer until a
// second, different reference arrives; only then it asks for memory.

#ifndef SOURCEREF_HXCSRCREFSET_H
#define SOURCEREF_HXCSRCREFSET_H

#include <vector>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "SourceRef/HX_Iterator.h"
#include "SourceRef/HxCSrcRef.h"

/// Each reference is in it once, in the order of insertion; two references are
/// the same if they are the same object. References are neither copied nor
/// owned, and null is never an element. Copying copies the pointers.
class HX_UTILS_API HxCSrcRefSet : public HX_Allocated {
 public:
  HxCSrcRefSet() = default;
  /// The set of \p srcRef; the empty set for null.
  HxCSrcRefSet(const HxCSrcRef* srcRef) : m_Content{srcRef} {}
  HxCSrcRefSet(const HxCSrcRefSet& other) { *this = other; }
  virtual ~HxCSrcRefSet() { clear(); }

  /// A copy of a set with one reference or none holds no memory.
  HxCSrcRefSet& operator=(const HxCSrcRefSet& other);

  /// Adds \p srcRef unless it is null or already there. Cost: linear in the
  /// size of the set.
  void addSrcRef(const HxCSrcRef* srcRef) {
    if (m_IsSingle && m_Content.one == nullptr)
      m_Content.one = srcRef;
    else
      addToNonEmpty(srcRef);
  }
  /// Adds what is new in \p other, in its order. Adding a set to itself
  /// changes nothing.
  void addSrcRef(const HxCSrcRefSet& other);

  /// Forgets all references and gives the memory back.
  void clear() {
    if (!m_IsSingle) delete m_Content.list;
    m_IsSingle = true;
    m_Content.one = nullptr;
  }

  /// The number of different references.
  int getSrcRefCnt() const;

  /// The first reference; null if there is none.
  const HxCSrcRef* getASrcRef() const;

  /// A new iterator over this set, owned by the caller. \see HX_Iterator
  HX_Iterator<const HxCSrcRef*>* createIterator() const;

  /// Calls \p visit with each reference, in the order of insertion. It needs no
  /// memory; \p visit must not change the set.
  template <class Visit>
  void forEach(Visit visit) const {
    if (!m_IsSingle) {
      for (const HxCSrcRef* srcRef : *m_Content.list) visit(srcRef);
    } else if (m_Content.one != nullptr) {
      visit(m_Content.one);
    }
  }

 private:
  friend class HxCSrcRefServer;
  // Consecutive in memory: a search through linked items takes five times as
  // long for 64 references.
  using List = std::vector<const HxCSrcRef*>;

  void addToNonEmpty(const HxCSrcRef* srcRef);
  /// Adds a reference that is not null and known not to be there.
  void appendNew(const HxCSrcRef* srcRef);
  bool contains(const HxCSrcRef* srcRef) const;
  void changeToList();

  bool m_IsSingle = true;
  union {
    const HxCSrcRef* one;  // single: null in the empty set
    List* list;            // otherwise: owned
  } m_Content{nullptr};
};

#endif  // SOURCEREF_HXCSRCREFSET_H
