// The program beside public generators; every measurement is a process.
//
// An item is a declaration: a variable of ours, a field of the peers'
// languages, 50 to a structure. Time is processor time of the process, user and
// system, because a loaded machine must not decide. Memory is the largest
// resident set, told as time: a millisecond stands for a megabyte.

#include <benchmark/benchmark.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace fs = std::filesystem;

namespace {

constexpr int kFieldsPerStructure = 50;

struct Usage {
  bool isDone = false;
  double seconds = 0;
  double megabytes = 0;
};

double secondsOf(const timeval& time) {
  return static_cast<double>(time.tv_sec) +
         static_cast<double>(time.tv_usec) * 1e-6;
}

// Runs a program and drops the output.
Usage run(const std::vector<std::string>& command) {
  const pid_t child = fork();
  if (child == 0) {
    std::vector<char*> words;
    for (const std::string& word : command)
      words.push_back(const_cast<char*>(word.c_str()));
    words.push_back(nullptr);
    if (std::freopen("/dev/null", "w", stdout) == nullptr) _exit(127);
    execvp(words[0], words.data());
    _exit(127);
  }
  int status = 0;
  rusage used = {};
  Usage usage;
  usage.isDone = wait4(child, &status, 0, &used) == child && status == 0;
  usage.seconds = secondsOf(used.ru_utime) + secondsOf(used.ru_stime);
  usage.megabytes = static_cast<double>(used.ru_maxrss) / 1024;
  return usage;
}

/// A public generator and the form of structures in the language.
struct Peer {
  const char* package;
  const char* file;
  const char* head;
  const char* structure;             // before the name
  const char* field;                 // printf: structure, field, number from 1
  std::vector<std::string> command;  // before file and folder
};

std::string descriptionOf(const Peer& peer, int count) {
  std::string text = peer.head;
  for (int i = 0; i < count / kFieldsPerStructure; ++i) {
    text += peer.structure + std::to_string(i) + " {\n";
    for (int k = 1; k <= kFieldsPerStructure; ++k) {
      char line[128];
      std::snprintf(line, sizeof line, peer.field, i, k, k);
      text += line;
    }
    text += "}\n";
  }
  return text;
}

fs::path folderOf(const std::string& name) {
  const fs::path folder = fs::temp_directory_path() / ("hx_bench_" + name);
  fs::remove_all(folder);
  fs::create_directories(folder);
  return folder;
}

template <class Command>
void measure(benchmark::State& state, Command command,
             double (*figure)(const Usage&), const char* package) {
  for (auto _ : state) {
    const Usage usage = run(command);
    if (!usage.isDone) {
      state.SkipWithError(
          (std::string("peer not installed: ") + package).c_str());
      break;
    }
    state.SetIterationTime(figure(usage));
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

double time(const Usage& usage) { return usage.seconds; }
double memory(const Usage& usage) { return usage.megabytes / 1000; }

void ours(benchmark::State& state, double (*figure)(const Usage&)) {
  const fs::path folder = folderOf("ours");
  const fs::path model = folder / "model.json";
  const std::string blocks = std::to_string(state.range(0));
  const std::string make = std::string(HX_CODEGEN) + " synthesize --blocks " +
                           blocks + " >" + model.string();
  if (std::system(make.c_str()) != 0) state.SkipWithError("no document");
  const std::vector<std::string> command = {HX_CODEGEN, "generate", model,
                                            "--out", folder / "code"};
  for (auto _ : state) {
    fs::remove_all(folder / "code");
    const Usage usage = run(command);
    if (!usage.isDone) state.SkipWithError("hx_codegen failed");
    state.SetIterationTime(figure(usage));
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
  fs::remove_all(folder);
}

void peer(benchmark::State& state, const Peer& peer,
          double (*figure)(const Usage&)) {
  const fs::path folder = folderOf(peer.package);
  std::ofstream(folder / peer.file)
      << descriptionOf(peer, static_cast<int>(state.range(0)));
  std::vector<std::string> command = peer.command;
  for (std::string& word : command) {
    if (word == "FOLDER") word = folder;
    if (word == "--proto_path=FOLDER") word = "--proto_path=" + folder.string();
    if (word == "--cpp_out=FOLDER") word = "--cpp_out=" + folder.string();
  }
  command.push_back(folder / peer.file);
  measure(state, command, figure, peer.package);
  fs::remove_all(folder);
}

const Peer kFlatc = {"flatbuffers-compiler",
                     "model.fbs",
                     "namespace m;\n",
                     "table T",
                     "  sa%d_speed_gain_%d:int = %d;\n",
                     {"flatc", "--cpp", "-o", "FOLDER"}};
const Peer kThrift = {"thrift-compiler",
                      "model.thrift",
                      "namespace cpp m\n",
                      "struct T",
                      "  %3$d: i32 sa%1$d_speed_gain_%2$d = %3$d\n",
                      {"thrift", "--gen", "cpp", "-out", "FOLDER"}};
const Peer kProtoc = {"protobuf-compiler",
                      "model.proto",
                      "syntax = \"proto3\";\npackage m;\n",
                      "message T",
                      "  int32 sa%d_speed_gain_%d = %d;\n",
                      {"protoc", "--proto_path=FOLDER", "--cpp_out=FOLDER"}};

void BM_Codegen_Time(benchmark::State& state) { ours(state, time); }
void BM_Codegen_Memory(benchmark::State& state) { ours(state, memory); }
void BM_Flatc_Time(benchmark::State& state) { peer(state, kFlatc, time); }
void BM_Flatc_Memory(benchmark::State& state) { peer(state, kFlatc, memory); }
void BM_Thrift_Time(benchmark::State& state) { peer(state, kThrift, time); }
void BM_Protoc_Time(benchmark::State& state) { peer(state, kProtoc, time); }

// The bound of memory, 120 megabytes for 100,000 blocks.
void BM_Bound_Memory(benchmark::State& state) {
  for (auto _ : state) state.SetIterationTime(0.120);
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK(BM_Codegen_Time)->Arg(100000)->Arg(1000000)->UseManualTime();
BENCHMARK(BM_Codegen_Memory)->Arg(100000)->Arg(1000000)->UseManualTime();
BENCHMARK(BM_Flatc_Time)->Arg(100000)->UseManualTime();
BENCHMARK(BM_Flatc_Memory)->Arg(100000)->UseManualTime();
BENCHMARK(BM_Thrift_Time)->Arg(100000)->UseManualTime();
BENCHMARK(BM_Protoc_Time)->Arg(100000)->UseManualTime();
BENCHMARK(BM_Bound_Memory)->Arg(100000)->UseManualTime();

}  // namespace
