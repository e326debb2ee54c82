#include "host/program/HX_Profile.h"

#include "Trace/HxCTransformationTracer.h"
#include "host/base/HX_Output.h"
#include "host/program/HX_Version.h"
#include "platform/matlab/HX_MatlabSession.h"

namespace fs = std::filesystem;

namespace {

constexpr char kTransformations[] = "HX_Transformations.txt";

}  // namespace

HX_Profile::HX_Profile(const std::string& folder) : m_IsOn(!folder.empty()) {
  HX_TimingListener::install(this);
  if (!m_IsOn) return;
  std::error_code error;
  fs::current_path(m_Output.emplace(start / folder).place(), error);
  if (error)
    throw HX_OutputError(folder + ": cannot be entered: " + error.message());
  HX_SetCommandWindow([](const char*) {});
  HxCTransformationTracer::boot(kTransformations);
  m_Server.boot();
}

HX_Profile::~HX_Profile() {
  HX_TimingListener::install(nullptr);
  leaveFolder();
}

void HX_Profile::leaveFolder() {
  HxCTransformationTracer::shutdown();
  m_Server.shutdown();
  std::error_code error;
  if (m_Output) fs::current_path(start, error);
}

void HX_Profile::setModel(const std::string& name) {
  if (!m_IsOn) return;
  HX_BuildNumber build = HX_BuildOfProgram();
  std::string text = name;  // the server takes a text that it could change
  m_Server.setModelInfo(&build, text.data());
  m_Server.logModelInfo();
}

void HX_Profile::note(const std::string& text) {
  char format[] = "%s";
  if (m_IsOn) m_Server.protocolEntry(format, text.c_str());
}

void HX_Profile::finish() {
  if (!m_IsOn) return;
  m_IsOn = false;
  m_Server.printCurrentResults("Results");
  HX_StopWatch::endStopWatches();
  leaveFolder();
  HX_WriteTraceEvents(m_Output->open("HX_Trace.json"), m_Runs);
  HX_WriteFoldedStacks(m_Output->open("HX_Stacks.folded"), m_Runs);
  m_Output->finish();
  m_Output->commit();
  m_Output.reset();
}

void HX_Profile::runEnded(const char* name, std::int64_t begin,
                          std::int64_t duration) {
  // A phase is both a run time and, around the run time, a stop watch.
  if (!m_Runs.empty() && m_Runs.back().name == name) m_Runs.pop_back();
  m_Runs.push_back({name, begin, duration});
}

HX_Profile::Phase::Phase(HX_Profile& profile, const char* name)
    : m_Profile(profile), m_Watch(profile.m_Watches.emplace_back(name)) {
  m_Watch.start();
  if (m_Profile.m_IsOn) m_Profile.m_Server.runTimeStart(name);
}

HX_Profile::Phase::~Phase() {
  if (m_Profile.m_IsOn) m_Profile.m_Server.runTimeEnd(m_Watch.getName());
  m_Watch.stop();
}
