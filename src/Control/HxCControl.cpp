#include "Control/HxCControl.h"

#include <cmath>
#include <utility>

#include "Control/HX_Memory.h"
#include "platform/messages/ERR_MessageHandler.h"

namespace {

// Start time, in milliseconds, of a stop without a start.
constexpr double kNoStart = -1.0;

bool isOn(double value) { return value != 0.0 && !std::isnan(value); }

}  // namespace

bool HxCControl::s_ProfilingOn = false;
bool HxCControl::s_TraceFallThrough = false;

HxCControl::HxCControl(const HxCControl& other) : HX_Allocated() {
  *this = other;
}

HxCControl& HxCControl::operator=(const HxCControl& other) {
  HX_WithinMemory([&] {
    leda::stack<double> timers(other.m_Timers);
    m_Timers = std::move(timers);
  });
  return *this;
}

HxCControl::~HxCControl() = default;

void HxCControl::startTimer() {
  if (!s_ProfilingOn) return;
  const double start = m_TimeStamp.getTimeStamp();
  HX_WithinMemory([&] { m_Timers.push(start); });
}

void HxCControl::stopTimeAndEmitMessage(KyCXString& label) {
  if (!s_ProfilingOn) return;
  const double start = m_Timers.empty() ? kNoStart : m_Timers.pop();
  m_TimeStamp.emitElapsedTime(start, label);
}

bool HxCControl::checkErrorLevel() { return ERR_get_errstatus() < 2; }

void HxCControl::setProfiling(double value) { s_ProfilingOn = isOn(value); }

void HxCControl::setFallThrough(double value) {
  s_TraceFallThrough = isOn(value);
}

void HxCControl::setDevelopBehaviour() {
  reinit();
  s_ProfilingOn = true;
  s_TraceFallThrough = true;
}

void HxCControl::setProductionCodeBehaviour() { reinit(); }

void HxCControl::reinit() {
  s_ProfilingOn = false;
  s_TraceFallThrough = false;
}
