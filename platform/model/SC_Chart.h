// A chart.

#ifndef PLATFORM_MODEL_SC_CHART_H
#define PLATFORM_MODEL_SC_CHART_H

#include "platform/strings/KyCXString.h"

class SC_Chart {
 public:
  explicit SC_Chart(const KyCXString& subsystemId)
      : m_SubsystemId(subsystemId) {}

  /// The identifier of the subsystem that the chart is generated in.
  const KyCXString& getSubsystemId() const { return m_SubsystemId; }

 private:
  KyCXString m_SubsystemId;
};

#endif  // PLATFORM_MODEL_SC_CHART_H
