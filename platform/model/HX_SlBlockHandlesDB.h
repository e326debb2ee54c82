// The handles of the blocks in the simulation tool.

#ifndef PLATFORM_MODEL_HX_SLBLOCKHANDLESDB_H
#define PLATFORM_MODEL_HX_SLBLOCKHANDLESDB_H

#include <map>

#include "platform/matlab/HX_SimulinkInterface.h"

class HX_Block;

/// Blocks are known by their address; they are not owned.
class HX_SlBlockHandlesDB {
 public:
  /// Enters a block, or gives it another handle.
  void setSlBlockHandle(const HX_Block* block, double handle) {
    m_Handles[block] = handle;
  }
  /// The invalid handle for a block that was never entered.
  double getSlBlockHandle(const HX_Block* block) const {
    const auto found = m_Handles.find(block);
    return found == m_Handles.end() ? HX_SimulinkInterface::s_invalidHandle
                                    : found->second;
  }

 private:
  std::map<const HX_Block*, double> m_Handles;
};

#endif  // PLATFORM_MODEL_HX_SLBLOCKHANDLESDB_H
