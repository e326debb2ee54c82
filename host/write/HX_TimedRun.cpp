#include "host/write/HX_TimedRun.h"

#include <rapidjson/ostreamwrapper.h>
#include <rapidjson/prettywriter.h>

#include <algorithm>
#include <map>
#include <ostream>

namespace {

std::int64_t endOf(const HX_TimedRun& run) { return run.begin + run.duration; }

}  // namespace

std::vector<const HX_TimedRun*> HX_RunsByBegin(
    const std::vector<HX_TimedRun>& runs) {
  std::vector<const HX_TimedRun*> sorted;
  sorted.reserve(runs.size());
  for (const HX_TimedRun& run : runs) sorted.push_back(&run);
  std::stable_sort(sorted.begin(), sorted.end(),
                   [](const HX_TimedRun* a, const HX_TimedRun* b) {
                     return a->begin != b->begin ? a->begin < b->begin
                                                 : a->duration > b->duration;
                   });
  return sorted;
}

void HX_WriteTraceEvents(std::ostream& out,
                         const std::vector<HX_TimedRun>& runs) {
  rapidjson::OStreamWrapper stream(out);
  rapidjson::PrettyWriter<rapidjson::OStreamWrapper> writer(stream);
  writer.SetIndent(' ', 1);
  writer.StartObject();
  writer.Key("traceEvents");
  writer.StartArray();
  for (const HX_TimedRun& run : runs) {
    writer.StartObject();
    writer.Key("name");
    writer.String(run.name.c_str());
    writer.Key("ph");
    writer.String("X");
    writer.Key("ts");
    writer.Int64(run.begin);
    writer.Key("dur");
    writer.Int64(run.duration);
    writer.Key("pid");
    writer.Int(1);
    writer.Key("tid");
    writer.Int(1);
    writer.EndObject();
  }
  writer.EndArray();
  writer.EndObject();
  out << '\n';
}

void HX_WriteFoldedStacks(std::ostream& out,
                          const std::vector<HX_TimedRun>& runs) {
  struct Open {
    std::string stack;
    std::int64_t end;
  };
  std::map<std::string, std::int64_t> selfTimes;
  std::vector<Open> open;
  for (const HX_TimedRun* run : HX_RunsByBegin(runs)) {
    while (!open.empty() && open.back().end <= run->begin) open.pop_back();
    std::string stack = run->name;
    std::replace(stack.begin(), stack.end(), ';', ',');
    if (!open.empty()) {
      selfTimes[open.back().stack] -= run->duration;
      stack = open.back().stack + ';' + stack;
    }
    selfTimes[stack] += run->duration;
    open.push_back({stack, endOf(*run)});
  }
  for (const auto& [stack, time] : selfTimes)
    out << stack << ' ' << time << '\n';
}
