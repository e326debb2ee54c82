// A block that holds a chart.

#ifndef PLATFORM_MODEL_HX_STATEFLOWBLOCK_H
#define PLATFORM_MODEL_HX_STATEFLOWBLOCK_H

#include "platform/model/HX_Block.h"

class SC_State;

/// The chart state is not owned.
class HX_StateflowBlock : public HX_Block {
 public:
  using HX_Block::HX_Block;

  HX_StateflowBlock* isStateflowBlock() override { return this; }

  /// The state that stands for the whole chart; may be null.
  SC_State* getChartState() const { return m_pChartState; }

  /// Not called by the library.
  void setChartState(SC_State* state) { m_pChartState = state; }

 private:
  SC_State* m_pChartState = nullptr;
};

#endif  // PLATFORM_MODEL_HX_STATEFLOWBLOCK_H
