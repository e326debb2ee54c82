// Walks the elements of a collection, one at a time.
//
//   HX_Iterator<const HxCSrcRef*>* it = set.createIterator();
//   for (; !it->isDone(); it->next()) use(it->currentItem());
//   delete it;

#ifndef SOURCEREF_HX_ITERATOR_H
#define SOURCEREF_HX_ITERATOR_H

#include "Control/HX_Allocated.h"

/// Stands at the first element from its creation. It looks into the collection
/// and is valid only while that is neither changed nor destroyed.
template <class T>
class HX_Iterator : public HX_Allocated {
 public:
  HX_Iterator() = default;
  HX_Iterator(const HX_Iterator&) = delete;
  HX_Iterator& operator=(const HX_Iterator&) = delete;
  virtual ~HX_Iterator() = default;

  /// Goes back to the first element.
  virtual void first() = 0;
  /// Does nothing behind the last element.
  virtual void next() = 0;
  /// True behind the last element.
  virtual bool isDone() const = 0;
  /// The current element. Behind the last one it throws the int -1, the only
  /// exception of the library: ask isDone() first.
  virtual T currentItem() const = 0;
};

#endif  // SOURCEREF_HX_ITERATOR_H
