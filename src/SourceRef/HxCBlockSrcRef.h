// A block of the model.

#ifndef SOURCEREF_HXCBLOCKSRCREF_H
#define SOURCEREF_HXCBLOCKSRCREF_H

#include "SourceRef/HxCSrcRef.h"

class HX_Block;

/// Created and owned by the block model alone; the block is not owned and may
/// be null.
class HX_UTILS_API HxCBlockSrcRef : public HxCSrcRef {
 public:
  ~HxCBlockSrcRef() override;
  /// Takes over the number and the block.
  HxCBlockSrcRef& operator=(const HxCBlockSrcRef&) = default;

  const HxCBlockSrcRef* isBlock() const override;
  /// The block's full path with blanks for white space; empty without a block.
  void toString(KyCXString& text) const override;

  /// The block; null if there is none.
  HX_Block* getBlock() const { return m_pBlock; }
  void setBlock(HX_Block* block) { m_pBlock = block; }

  /// The handle of the block in the model; HX_SimulinkInterface's invalid
  /// handle without a block.
  double getBlockHandle() const;

 private:
  friend class HX_Block;

  explicit HxCBlockSrcRef(HX_Block* block);
  /// A reference to the same block with a number of its own.
  HxCBlockSrcRef(const HxCBlockSrcRef& other);
  /// The same; a plain reference if there is no block.
  HxCSrcRef* clone() const override;

  HX_Block* m_pBlock;
};

#endif  // SOURCEREF_HXCBLOCKSRCREF_H
