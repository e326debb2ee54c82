// A block of the intermediate view: what the generator made of model blocks.

#ifndef PLATFORM_MODEL_HX_BDBLOCK_H
#define PLATFORM_MODEL_HX_BDBLOCK_H

#include "platform/strings/KyCXString.h"

class HxCSrcRef;

/// The source reference is not owned; null for a block without an origin.
class HX_BdBlock {
 public:
  /// Stores the arguments.
  explicit HX_BdBlock(const KyCXString& rawName,
                      const HxCSrcRef* srcRef = nullptr)
      : m_RawName(rawName), m_pSrcRef(srcRef) {}

  /// The name before the change to a C identifier.
  const KyCXString& getRawName() const { return m_RawName; }
  /// Null for a block without an origin.
  const HxCSrcRef* getSrcRef() const { return m_pSrcRef; }

 private:
  KyCXString m_RawName;
  const HxCSrcRef* m_pSrcRef;
};

#endif  // PLATFORM_MODEL_HX_BDBLOCK_H
