// An object of the data dictionary.

#ifndef SOURCEREF_HXCDDSRCREF_H
#define SOURCEREF_HXCDDSRCREF_H

#include "SourceRef/HxCSrcRef.h"

/// Copies and clones keep the number.
class HX_UTILS_API HxCDdSrcRef : public HxCSrcRef {
 public:
  /// Handle 0, which names no object.
  HxCDdSrcRef() = default;
  explicit HxCDdSrcRef(unsigned long handle);
  HxCDdSrcRef(const HxCDdSrcRef&) = default;
  HxCDdSrcRef& operator=(const HxCDdSrcRef&) = default;
  ~HxCDdSrcRef() override;

  const HxCDdSrcRef* isDd() const override;
  /// The object's path, in a readable form if a user script made the object
  /// (see HX_StringParser::processDDPath).
  void toString(KyCXString& text) const override;
  HxCSrcRef* clone() const override;

  /// The handle as it was given, whether or not there is such an object.
  unsigned long getDdHandle() const { return m_Handle; }

  /// \param[out] path  the object's full path; "Handle: 4711" for a handle
  ///   that the data dictionary does not know
  void getDdPath(KyCXString& path) const;

 private:
  unsigned long m_Handle = 0;
};

#endif  // SOURCEREF_HXCDDSRCREF_H
