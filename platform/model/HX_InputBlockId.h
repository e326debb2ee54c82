// Names a block that the model reader has read.
//
//   HX_BlockDataBase blocks;
//   blocks.setSlBlockHandle(7, handle);
//   const HX_InputBlockId id(blocks, 7);

#ifndef PLATFORM_MODEL_HX_INPUTBLOCKID_H
#define PLATFORM_MODEL_HX_INPUTBLOCKID_H

class HX_BlockDataBase;

/// The data base is not owned and outlives the identifier.
class HX_InputBlockId {
 public:
  /// \p blockId need not be entered in \p blocks.
  HX_InputBlockId(HX_BlockDataBase& blocks, int blockId)
      : m_pBlocks(&blocks), m_BlockId(blockId) {}

  /// The number of the block, and the table with the handle of the block.
  int getBlockId() const { return m_BlockId; }
  HX_BlockDataBase& getBlockDataBase() const { return *m_pBlocks; }

 private:
  HX_BlockDataBase* m_pBlocks;
  int m_BlockId;
};

#endif  // PLATFORM_MODEL_HX_INPUTBLOCKID_H
