// Tells a person how far long work is: "names: 4000 of 10000" on the line of
// the cursor.
//
//   HX_Progress progress(HX_IsErrorOutputTerminal());
//   progress.begin("names", 10000);
//   for (...) progress.step();
//   progress.end();

#ifndef HOST_BASE_HX_PROGRESS_H
#define HOST_BASE_HX_PROGRESS_H

#include <cstddef>

class HX_Progress {
 public:
  explicit HX_Progress(bool isShown) : m_IsShown(isShown) {}

  /// Begins a phase of \p all steps; a step may be a byte. Phases of less than
  /// 5000 steps show nothing.
  void begin(const char* phase, std::size_t all);
  void step() { moveTo(m_Done + 1); }
  void moveTo(std::size_t done) {
    m_Done = done;
    if (m_Done >= m_Next) show();
  }
  /// A phase without steps that can be counted.
  void begin(const char* phase);
  /// Clears the line.
  void end();

 private:
  void show();

  const bool m_IsShown;
  const char* m_Phase = "";
  std::size_t m_All = 0;
  std::size_t m_Done = 0;
  std::size_t m_Next = static_cast<std::size_t>(-1);  // step to show
};

#endif  // HOST_BASE_HX_PROGRESS_H
