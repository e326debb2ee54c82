// The references to everything that one generated item stems from.
//
//   HxCSrcRefSet sources(block->getSrcRef());
//   sources.addSrcRef(variable.getDdSrcRef());
//   sources.forEach([](const HxCSrcRef* ref) { print(ref); });
//
// Nearly every item stems from one object. A set is a single pointer until a
// second, different reference arrives, and takes memory only then.

#ifndef SOURCEREF_HXCSRCREFSET_H
#define SOURCEREF_HXCSRCREFSET_H

#include <vector>

#include "Control/HX_Allocated.h"
#include "Control/HX_Memory.h"
#include "HX_Export.h"
#include "SourceRef/HX_Iterator.h"
#include "SourceRef/HxCSrcRef.h"

/// Set of references in the order of insertion. Two references are equal if
/// both are the same object. Null is never an element.
///
/// OWNERSHIP: a set neither copies nor owns references; copying a set copies
/// pointers.
/// If memory runs out, the set keeps the references from before the call; a
/// copy constructor leaves the empty set.
class HX_UTILS_API HxCSrcRefSet : public HX_Allocated {
 public:
  HxCSrcRefSet() = default;
  /// The set of \p srcRef; the empty set for null.
  HxCSrcRefSet(const HxCSrcRef* srcRef) : m_Content{srcRef} {}
  HxCSrcRefSet(const HxCSrcRefSet& other) : HX_Allocated() { *this = other; }
  virtual ~HxCSrcRefSet() { clear(); }

  /// A copy of a set with at most one reference takes no memory.
  HxCSrcRefSet& operator=(const HxCSrcRefSet& other);

  /// Adds \p srcRef unless \p srcRef is null or in the set.
  /// COST: linear in the size of the set.
  void addSrcRef(const HxCSrcRef* srcRef) {
    if (m_IsSingle && m_Content.one == nullptr)
      m_Content.one = srcRef;
    else
      addToNonEmpty(srcRef);
  }
  /// Adds the references of \p other that are new, in the order of \p other:
  /// all of them, or none if memory runs out. \p other may be this set.
  void addSrcRef(const HxCSrcRefSet& other);

  /// Removes all references and returns the memory.
  void clear() {
    if (!m_IsSingle) delete m_Content.list;
    m_IsSingle = true;
    m_Content.one = nullptr;
  }

  /// The number of references.
  int getSrcRefCnt() const;

  /// The first reference; null if the set is empty.
  const HxCSrcRef* getASrcRef() const;

  /// RETURNS: a new iterator over this set; null if memory runs out.
  /// OWNERSHIP: the caller owns the iterator. \see HX_Iterator
  HX_Iterator<const HxCSrcRef*>* createIterator() const;

  /// Calls \p visit with each reference, in the order of insertion.
  /// REQUIRES: \p visit does not change the set.
  /// COST: no memory.
  template <class Visit>
  void forEach(Visit visit) const {
    if (!m_IsSingle) {
      for (const HxCSrcRef* srcRef : m_Content.list->refs) visit(srcRef);
    } else if (m_Content.one != nullptr) {
      visit(m_Content.one);
    }
  }

 private:
  friend class HxCSrcRefServer;
  // Consecutive in memory, because a search through linked items takes five
  // times as long for 64 references. Never empty.
  struct List : HX_Allocated {
    std::vector<const HxCSrcRef*, HX_ControllerAllocator<const HxCSrcRef*>>
        refs;
  };

  // Both return false, with the set unchanged, if memory runs out.
  bool addToNonEmpty(const HxCSrcRef* srcRef);
  // REQUIRES: srcRef is not null and not in the set.
  bool appendNew(const HxCSrcRef* srcRef);
  bool contains(const HxCSrcRef* srcRef) const;
  void keepFirst(int count);

  bool m_IsSingle = true;
  union {
    const HxCSrcRef* one;  // single: null in the empty set
    List* list;            // otherwise: owned
  } m_Content{nullptr};
};

#endif  // SOURCEREF_HXCSRCREFSET_H
