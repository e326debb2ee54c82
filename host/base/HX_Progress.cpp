#include "host/base/HX_Progress.h"

#include <algorithm>
#include <iostream>
#include <string>

namespace {

constexpr std::size_t kNever = static_cast<std::size_t>(-1);
constexpr std::size_t kFewest = 5000;
constexpr std::size_t kShownTimes = 50;

void clearLine() { std::cerr << '\r' << std::string(50, ' ') << '\r'; }

}  // namespace

void HX_Progress::begin(const char* phase, std::size_t all) {
  end();
  m_Phase = phase;
  m_All = all;
  m_Done = 0;
  if (m_IsShown && all >= kFewest) m_Next = 0;
  moveTo(0);
}

void HX_Progress::begin(const char* phase) {
  end();
  m_Phase = phase;
  if (m_IsShown) std::cerr << '\r' << phase << "..." << std::flush;
}

void HX_Progress::end() {
  if (m_IsShown && m_Phase[0] != '\0') clearLine();
  m_Phase = "";
  m_Next = kNever;
}

void HX_Progress::show() {
  std::cerr << '\r' << m_Phase << ": " << m_Done << " of " << m_All
            << std::flush;
  m_Next = m_Done + std::max<std::size_t>(m_All / kShownTimes, 1);
}
