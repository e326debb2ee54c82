// A place in the generator's own code.
//
//   HxCInternalSrcRef here("reader.cpp", 12, "bad index");
//   // "Internal: Module: 'reader.cpp', Line: 12 Reason: bad index"

#ifndef SOURCEREF_HXCINTERNALSRCREF_H
#define SOURCEREF_HXCINTERNALSRCREF_H

#include "SourceRef/HxCSrcRef.h"
#include "platform/strings/KyCXString.h"

/// Copies keep the number and the place. There is no clone() of its own:
/// cloning gives a plain HxCSrcRef with the same number, which no longer knows
/// the place.
class HX_UTILS_API HxCInternalSrcRef : public HxCSrcRef {
 public:
  /// File "file unknown!", line -1, cause "cause unknown!".
  HxCInternalSrcRef();
  /// Cause "cause unknown!".
  HxCInternalSrcRef(const KyCXString& file, int line);
  HxCInternalSrcRef(const KyCXString& file, int line, const KyCXString& cause);
  HxCInternalSrcRef(const HxCInternalSrcRef&) = default;
  HxCInternalSrcRef& operator=(const HxCInternalSrcRef&) = default;
  ~HxCInternalSrcRef() override;

  const HxCInternalSrcRef* isInternal() const override;
  void toString(KyCXString& text) const override;

  /// The place and its cause, as they were given.
  const KyCXString& getFile() const { return m_File; }
  void setFile(const KyCXString& file) { m_File = file; }
  int getLine() const { return m_Line; }
  void setLine(int line) { m_Line = line; }
  void setLocation(const KyCXString& file, int line);
  const KyCXString& getCause() const { return m_Cause; }
  void setCause(const KyCXString& cause) { m_Cause = cause; }

 private:
  KyCXString m_File;
  int m_Line;
  KyCXString m_Cause;
};

#endif  // SOURCEREF_HXCINTERNALSRCREF_H
