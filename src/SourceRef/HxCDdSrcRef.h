// An object of the data dictionary.
//
//   HxCDdSrcRef ref = 4711UL;
//   KyCXString path;
//   ref.getDdPath(path);   // "//DD0/Pool/speed", or "Handle: 4711"

#ifndef SOURCEREF_HXCDDSRCREF_H
#define SOURCEREF_HXCDDSRCREF_H

#include "SourceRef/HxCSrcRef.h"

/// Copies and clones keep the number.
class HX_UTILS_API HxCDdSrcRef : public HxCSrcRef {
 public:
  /// Handle 0, the handle of no object.
  HxCDdSrcRef() = default;
  HxCDdSrcRef(unsigned long handle);
  HxCDdSrcRef(const HxCDdSrcRef&) = default;
  HxCDdSrcRef& operator=(const HxCDdSrcRef&) = default;
  ~HxCDdSrcRef() override;

  const HxCDdSrcRef* isDd() const override;
  /// Replaces \p text by the path of the object, in a readable form if a user
  /// script made the object (see HX_StringParser::processDDPath).
  void toString(KyCXString& text) const override;
  HxCSrcRef* clone() const override;

  /// The handle of the constructor, also if no object has this handle.
  unsigned long getDdHandle() const { return m_Handle; }

  /// \param[out] path  the full path of the object; "Handle: 4711" for a handle
  ///   that the data dictionary does not know; unchanged if memory runs out
  void getDdPath(KyCXString& path) const;

 private:
  unsigned long m_Handle = 0;
};

#endif  // SOURCEREF_HXCDDSRCREF_H
