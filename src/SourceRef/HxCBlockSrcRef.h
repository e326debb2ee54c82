// A block of the model.

#ifndef SOURCEREF_HXCBLOCKSRCREF_H
#define SOURCEREF_HXCBLOCKSRCREF_H

#include "SourceRef/HxCSrcRef.h"

class HX_Block;

/// OWNERSHIP: the block model alone creates and owns block references. The
/// block may be null; a reference never owns the block.
/// The copy constructor and clone() draw a new number; assignment takes over
/// the number.
class HX_UTILS_API HxCBlockSrcRef : public HxCSrcRef {
 public:
  ~HxCBlockSrcRef() override;
  /// Takes over the number and the block.
  HxCBlockSrcRef& operator=(const HxCBlockSrcRef&) = default;

  const HxCBlockSrcRef* isBlock() const override;
  /// Replaces \p text by the full path of the block, with blanks for white
  /// space; by the empty text without a block.
  void toString(KyCXString& text) const override;

  /// The block; null if the reference has no block.
  HX_Block* getBlock() const { return m_pBlock; }
  void setBlock(HX_Block* block) { m_pBlock = block; }

  /// The handle of the block in the model. Without a block: the invalid handle
  /// of HX_SimulinkInterface.
  double getBlockHandle() const;

 private:
  friend class HX_Block;

  HxCBlockSrcRef(HX_Block* block);
  /// A reference to the same block with a new number.
  HxCBlockSrcRef(const HxCBlockSrcRef& other);
  /// As the copy constructor; without a block a plain HxCSrcRef.
  HxCSrcRef* clone() const override;

  HX_Block* m_pBlock;
};

#endif  // SOURCEREF_HXCBLOCKSRCREF_H
