// Times of the phases of a run, and reports about the times.
//
//   HX_Profile profile("profile");   // "" measures without writing
//   {
//     HX_Profile::Phase phase(profile, "Form names");
//     ...
//   }
//   profile.finish();

#ifndef HOST_PROGRAM_HX_PROFILE_H
#define HOST_PROGRAM_HX_PROFILE_H

#include <cstdint>
#include <filesystem>
#include <list>
#include <optional>
#include <string>
#include <vector>

#include "Diagnostics/HX_StopWatch.h"
#include "Diagnostics/HX_TimingListener.h"
#include "Diagnostics/HxCDebugServer.h"
#include "host/base/HX_Output.h"
#include "host/write/HX_TimedRun.h"

/// One per process. The servers of the library write into the working
/// directory: a folder inside \p folder becomes the working directory until
/// finish(), which puts all files in their places. Without finish() nothing is
/// written. Files: HX_StopWatch.html, HX_DebugLog.txt, HX_DebugProtocol.txt and
/// HX_Transformations.txt. HX_Trace.json has complete events of the trace-event
/// format, HX_Stacks.folded has one line per stack of phases with the self
/// time; both in microseconds.
class HX_Profile : private HX_TimingListener {
 public:
  /// Throws HX_OutputError for a folder that cannot be made or entered.
  explicit HX_Profile(const std::string& folder);
  HX_Profile(const HX_Profile&) = delete;
  HX_Profile& operator=(const HX_Profile&) = delete;
  ~HX_Profile() override;

  /// The working directory at the start; paths of the user count from here.
  const std::filesystem::path start = std::filesystem::current_path();

  void setModel(const std::string& name);
  /// Phases that have ended, inner phases before outer phases.
  const std::vector<HX_TimedRun>& runs() const { return m_Runs; }
  /// A line of the protocol.
  void note(const std::string& text);
  /// Writes the reports of the servers and the trace; further calls do
  /// nothing. Throws HX_OutputError.
  void finish();

  /// Measures the time of its life.
  class Phase {
   public:
    Phase(HX_Profile& profile, const char* name);
    Phase(const Phase&) = delete;
    Phase& operator=(const Phase&) = delete;
    ~Phase();

   private:
    HX_Profile& m_Profile;
    HX_StopWatch& m_Watch;
  };

 private:
  void runEnded(const char* name, std::int64_t begin,
                std::int64_t duration) override;

  void leaveFolder();

  bool m_IsOn;
  std::optional<HX_Output> m_Output;
  HxCDebugServer m_Server;
  std::list<HX_StopWatch> m_Watches;  // stay registered until the report
  std::vector<HX_TimedRun> m_Runs;
};

#endif  // HOST_PROGRAM_HX_PROFILE_H
