// Where a generated item stems from: the base of all source references.
//
// A message carries a source reference, a C identifier carries two, and the
// naming engine asks them for the block, the Stateflow object or the data
// dictionary object that a name is for. Callers ask for the kind with isBlock()
// and its siblings, never with run-time type information:
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

/// Owned by its creator; everyone else passes it as const HxCSrcRef* and never
/// deletes it. References are numbered from 0 in the order of creation.
class HX_UTILS_API HxCSrcRef : public HX_Dumpable, public HX_Allocated {
 public:
  /// Takes the next number.
  HxCSrcRef();
  /// Copies keep the number of their source.
  HxCSrcRef(const HxCSrcRef&) = default;
  HxCSrcRef& operator=(const HxCSrcRef&) = default;
  ~HxCSrcRef() override;

  using HX_Dumpable::dump;
  /// Writes one section headed "HxCSrcRef" with the entry "Source:", the text
  /// of this reference. The flag is not used. \return \p dumper
  virtual HX_Dump* dump(HX_Dump* dumper, bool recursive);

  /// This reference; never null.
  virtual const HxCSrcRef* isSrcRef() const;
  /// Each of these is this reference in the one class it names, else null.
  virtual const HxCBlockSrcRef* isBlock() const;
  virtual const HxCStateflowSrcRef* isStateflow() const;
  virtual const HxCModuleSrcRef* isModule() const;
  virtual const HxCDdSrcRef* isDd() const;
  virtual const HxCInternalSrcRef* isInternal() const;
  virtual const HxCInputBlockSrcRef* isInputBlock() const;

  /// Appends "Unknown source"; the subclasses replace \p text.
  virtual void toString(KyCXString& text) const;

  /// A new reference to the same source, owned by the caller. Here it keeps
  /// its number.
  virtual HxCSrcRef* clone() const;

  /// The number, from 0 in the order of creation; copies share it.
  int getSrcRefId() const { return m_Id; }

 private:
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
