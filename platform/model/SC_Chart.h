// A chart.

#ifndef PLATFORM_MODEL_SC_CHART_H
#define PLATFORM_MODEL_SC_CHART_H

#include "platform/strings/KyCXString.h"

/// Known by the place where it is generated; states point to it.
class SC_Chart {
 public:
  /// \param subsystemId  see getSubsystemId()
  explicit SC_Chart(const KyCXString& subsystemId)
      : m_SubsystemId(subsystemId) {}

  /// The identifier of the subsystem that the chart is generated in.
  const KyCXString& getSubsystemId() const { return m_SubsystemId; }

 private:
  KyCXString m_SubsystemId;
};

#endif  // PLATFORM_MODEL_SC_CHART_H
