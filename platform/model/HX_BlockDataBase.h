// The handles of the blocks that the model reader has read, by block number.

#ifndef PLATFORM_MODEL_HX_BLOCKDATABASE_H
#define PLATFORM_MODEL_HX_BLOCKDATABASE_H

#include "platform/model/HX_ModelStandIn.h"

/// Handles are those of the simulation tool.
class HX_BlockDataBase : public HX_HandlesStandIn<int> {
 public:
  /// RETURNS: the invalid handle for a block that was never entered.
  double getSlBlockHandle(int blockId) const { return find(blockId); }
};

#endif  // PLATFORM_MODEL_HX_BLOCKDATABASE_H
