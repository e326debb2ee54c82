// A state of a chart.

#ifndef PLATFORM_MODEL_SC_STATE_H
#define PLATFORM_MODEL_SC_STATE_H

#include "platform/model/SC_Model.h"

class SC_Chart;

/// The chart is not owned and never null.
class SC_State : public SC_Model {
 public:
  /// REQUIRES: \p chart is not null.
  SC_State(int id, int number, const KyCXString& name, SC_Chart* chart)
      : SC_Model(id, number, name), m_pChart(chart) {}

  /// The chart around the state; never null.
  SC_Chart* getChart() const { return m_pChart; }

 private:
  SC_Chart* m_pChart;
};

#endif  // PLATFORM_MODEL_SC_STATE_H
