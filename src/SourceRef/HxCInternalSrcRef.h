// A place in the code of the generator.
//
//   HxCInternalSrcRef here("reader.cpp", 12, "bad index");
//   // "Internal: Module: 'reader.cpp', Line: 12 Reason: bad index"

#ifndef SOURCEREF_HXCINTERNALSRCREF_H
#define SOURCEREF_HXCINTERNALSRCREF_H

#include "SourceRef/HxCSrcRef.h"
#include "platform/strings/KyCXString.h"

/// Copies keep the number and the place. Class without a clone() of its own:
/// cloning gives a plain HxCSrcRef with the same number and without the place.
/// If memory runs out, constructors leave file and cause empty; assignment and
/// setters change nothing.
class HX_UTILS_API HxCInternalSrcRef : public HxCSrcRef {
 public:
  /// File "file unknown!", line -1, cause "cause unknown!".
  HxCInternalSrcRef();
  /// Cause "cause unknown!".
  HxCInternalSrcRef(const KyCXString& file, int line);
  HxCInternalSrcRef(const KyCXString& file, int line, const KyCXString& cause);
  HxCInternalSrcRef(const HxCInternalSrcRef& other);
  HxCInternalSrcRef& operator=(const HxCInternalSrcRef& other);
  ~HxCInternalSrcRef() override;

  const HxCInternalSrcRef* isInternal() const override;
  /// Replaces \p text by file, line and cause, as in the example above.
  void toString(KyCXString& text) const override;

  /// File, line and cause.
  const KyCXString& getFile() const { return m_File; }
  void setFile(const KyCXString& file);
  int getLine() const { return m_Line; }
  void setLine(int line) { m_Line = line; }
  void setLocation(const KyCXString& file, int line);
  const KyCXString& getCause() const { return m_Cause; }
  void setCause(const KyCXString& cause);

 private:
  KyCXString m_File;
  int m_Line;
  KyCXString m_Cause;
};

#endif  // SOURCEREF_HXCINTERNALSRCREF_H
