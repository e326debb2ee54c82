// The blocks that the model reader has read, by their number.

#ifndef PLATFORM_MODEL_HX_BLOCKDATABASE_H
#define PLATFORM_MODEL_HX_BLOCKDATABASE_H

#include <map>

#include "platform/matlab/HX_SimulinkInterface.h"

/// Holds the handle that each block has in the simulation tool.
class HX_BlockDataBase {
 public:
  /// Enters a block, or gives it another handle.
  void setSlBlockHandle(int blockId, double handle) {
    m_Handles[blockId] = handle;
  }
  /// The invalid handle for a block that was never entered.
  double getSlBlockHandle(int blockId) const {
    const auto found = m_Handles.find(blockId);
    return found == m_Handles.end() ? HX_SimulinkInterface::s_invalidHandle
                                    : found->second;
  }

 private:
  std::map<int, double> m_Handles;
};

#endif  // PLATFORM_MODEL_HX_BLOCKDATABASE_H
