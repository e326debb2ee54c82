// Source references in the plain form: a struct with a kind in place of
// classes, a list in place of a set.

#ifndef PLAIN_HX_PLAINSRCREF_H
#define PLAIN_HX_PLAINSRCREF_H

#include <algorithm>

#include "plain/HX_PlainModel.h"

namespace plain {

/// The text of a reference; \p before is the text of the caller.
Text toString(const Model& model, const Ref& ref, const Text& before);

/// Handle of a block reference or an input block reference.
double blockHandle(const Model& model, const Ref& ref);

/// Creates references and gives numbers.
struct RefMaker {
  int next = 0;

  Ref made(Ref ref) {
    ref.id = next++;
    return ref;
  }
  Ref internal() {
    Ref ref;
    ref.kind = Ref::eInternal;
    ref.file = u"file unknown!";
    ref.line = -1;
    ref.cause = u"cause unknown!";
    return made(ref);
  }
  Ref copy(const Ref& ref) { return ref.kind == Ref::eBlock ? made(ref) : ref; }
  Ref clone(const Ref& ref) {
    Ref other;
    other.id = ref.id;
    switch (ref.kind) {
      case Ref::eOther:
      case Ref::eInternal:
        return other;  // no clone of its own: the number alone
      case Ref::eBlock:
        return made(ref.target == kNone ? Ref() : ref);
      case Ref::eDd:
        return ref;
      default:
        return made(ref);
    }
  }
};

/// Indices of references, in the order of insertion.
using RefSet = std::vector<int>;

inline void add(RefSet& set, int ref) {
  if (ref == kNone || std::count(set.begin(), set.end(), ref) > 0) return;
  set.push_back(ref);
}

/// Blocks, data dictionary and others; the last of every kind counts.
struct Specific {
  int block = kNone, dd = kNone, other = kNone;
};
inline Specific specific(const std::vector<Ref>& refs, const RefSet& set) {
  Specific found;
  for (const int ref : set) {
    const Ref::Kind kind = Model::at(refs, ref).kind;
    if (kind == Ref::eBlock || kind == Ref::eInput)
      found.block = ref;
    else if (kind == Ref::eDd)
      found.dd = ref;
    else
      found.other = ref;
  }
  return found;
}

/// Answers of HxCSrcRefCompare; null is no reference.
struct Comparison {
  bool bothFromDD = false, bothFromDDButDifferent = false;
  bool onlyOneFromDD = false;
  int which = 7;  // the value of the caller
  bool bothFromUserScript = false, differentNotFromUserScript = false;
};
Comparison compared(const Model& model, const Ref* a, const Ref* b);

}  // namespace plain

#endif  // PLAIN_HX_PLAINSRCREF_H
