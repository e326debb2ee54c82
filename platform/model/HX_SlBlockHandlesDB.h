// The handles of the blocks in the simulation tool, by block.

#ifndef PLATFORM_MODEL_HX_SLBLOCKHANDLESDB_H
#define PLATFORM_MODEL_HX_SLBLOCKHANDLESDB_H

#include "platform/model/HX_ModelStandIn.h"

class HX_Block;

/// Blocks are known by address.
class HX_SlBlockHandlesDB : public HX_HandlesStandIn<const HX_Block*> {
 public:
  /// RETURNS: the invalid handle for a block that was never entered.
  double getSlBlockHandle(const HX_Block* block) const { return find(block); }
};

#endif  // PLATFORM_MODEL_HX_SLBLOCKHANDLESDB_H
