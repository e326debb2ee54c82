// Source references: where in the model a generated item stems from.
//
// A message carries a source reference, a C identifier carries two. The naming
// engine asks source references for blocks, Stateflow objects and data
// dictionary objects. Callers ask for the kind with isBlock() and the like,
// never with run-time type information:
//
//   if (const HxCBlockSrcRef* ref = srcRef->isBlock()) use(ref->getBlock());

#ifndef SOURCEREF_HXCSRCREF_H
#define SOURCEREF_HXCSRCREF_H

#include <iosfwd>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/dump/HX_Dumpable.h"

class HxCBlockSrcRef;
class HxCDdSrcRef;
class HxCInputBlockSrcRef;
class HxCInternalSrcRef;
class HxCModuleSrcRef;
class HxCStateflowSrcRef;

/// Base of all source references.
///
/// OWNERSHIP: the creator owns a reference. All others pass the reference as
/// const HxCSrcRef* and never delete it.
/// Numbers count from 0 in the order of creation. The header of each class says
/// where copies and clones keep the number and where they draw a new number.
/// If memory runs out, toString() leaves the text as before the call, clone()
/// returns null, and dump() writes an empty text or nothing.
class HX_UTILS_API HxCSrcRef : public HX_Dumpable, public HX_Allocated {
 public:
  /// Draws the next number.
  HxCSrcRef();
  /// Keeps the number of the source.
  HxCSrcRef(const HxCSrcRef&) = default;
  HxCSrcRef& operator=(const HxCSrcRef&) = default;
  ~HxCSrcRef() override;

  /// Writes one section headed "HxCSrcRef" with the entry "Source:", the text
  /// of this reference. The flag is not used. \return \p dumper
  /// A const reference cannot be dumped: the dump() of HX_Dumpable, for const
  /// objects, writes nothing and is private here.
  virtual HX_Dump* dump(HX_Dump* dumper, bool recursive);

  /// This reference; never null.
  virtual const HxCSrcRef* isSrcRef() const;
  /// Kind queries: this reference in the one class that the query names, else
  /// null. No class of the library is a module.
  virtual const HxCBlockSrcRef* isBlock() const;
  virtual const HxCStateflowSrcRef* isStateflow() const;
  virtual const HxCModuleSrcRef* isModule() const;
  virtual const HxCDdSrcRef* isDd() const;
  virtual const HxCInternalSrcRef* isInternal() const;
  virtual const HxCInputBlockSrcRef* isInputBlock() const;

  /// Describes the source. Here: appends "Unknown source" to \p text. A
  /// subclass replaces \p text, but an input block keeps \p text if the model
  /// cannot be read.
  virtual void toString(KyCXString& text) const;

  /// RETURNS: a new reference to the same source; null if memory runs out.
  /// Here the clone keeps the number.
  /// OWNERSHIP: the caller owns the clone.
  virtual HxCSrcRef* clone() const;

  /// The number, from 0 in the order of creation.
  int getSrcRefId() const { return m_Id; }

 private:
  using HX_Dumpable::dump;

  static int m_sSrcRefCounter;

  int m_Id;
};

/// Writes nothing.
HX_UTILS_API std::ostream& operator<<(std::ostream& stream, const HxCSrcRef*);
/// Reads nothing.
HX_UTILS_API std::istream& operator>>(std::istream& stream, const HxCSrcRef*);

namespace leda {

/// Orders references by address: -1, 0 or 1.
HX_UTILS_API int compare(const HxCSrcRef* const& a, const HxCSrcRef* const& b);

}  // namespace leda

#endif  // SOURCEREF_HXCSRCREF_H
