// Walk over the elements of a collection.
//
//   std::unique_ptr<HX_Iterator<const HxCSrcRef*>> it(set.createIterator());
//   if (it == nullptr) return;   // no memory
//   for (; !it->isDone(); it->next()) use(it->currentItem());

#ifndef SOURCEREF_HX_ITERATOR_H
#define SOURCEREF_HX_ITERATOR_H

#include "Control/HX_Allocated.h"

/// An iterator starts at the first element and is valid while the
/// collection is neither changed nor destroyed.
template <class T>
class HX_Iterator : public HX_Allocated {
 public:
  HX_Iterator() = default;
  HX_Iterator(const HX_Iterator&) = delete;
  HX_Iterator& operator=(const HX_Iterator&) = delete;
  virtual ~HX_Iterator() = default;

  /// Goes back to the first element.
  virtual void first() = 0;
  /// Goes to the next element; does nothing behind the last element.
  virtual void next() = 0;
  /// True behind the last element.
  virtual bool isDone() const = 0;
  /// RETURNS: the current element.
  /// REQUIRES: isDone() is false. Behind the last element the operation throws
  /// the int -1, the only exception of the library.
  virtual T currentItem() const = 0;
};

#endif  // SOURCEREF_HX_ITERATOR_H
