// Runs of stop watches, written in two forms for viewers of profiles.
//
//   HX_WriteTraceEvents(out, {{"Form names", 0, 1200}});
//   HX_WriteFoldedStacks(out, {{"expand", 10, 90}, {"Form names", 0, 1200}});
//   // Form names 1110
//   // Form names;expand 90

#ifndef HOST_WRITE_HX_TIMEDRUN_H
#define HOST_WRITE_HX_TIMEDRUN_H

#include <cstdint>
#include <iosfwd>
#include <string>
#include <vector>

/// One run of a stop watch.
struct HX_TimedRun {
  std::string name;
  std::int64_t begin;     ///< microseconds since an arbitrary origin
  std::int64_t duration;  ///< microseconds
};

/// Runs by begin; of equal begins the longer run first, so that a run inside
/// another run comes after the outer run.
std::vector<const HX_TimedRun*> HX_RunsByBegin(
    const std::vector<HX_TimedRun>& runs);

/// One complete event of the trace-event format per run.
void HX_WriteTraceEvents(std::ostream& out,
                         const std::vector<HX_TimedRun>& runs);

/// One line per stack: names from the outermost run, joined by ';', a space and
/// the self time in microseconds. Lines stand in the order of the texts. A ';'
/// inside a name becomes ','.
void HX_WriteFoldedStacks(std::ostream& out,
                          const std::vector<HX_TimedRun>& runs);

#endif  // HOST_WRITE_HX_TIMEDRUN_H
