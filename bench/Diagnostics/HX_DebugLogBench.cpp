// Cost of a line in the files of the debug server. One item is one line; the
// file is complete after each line. Runs in a temporary directory.

#include <benchmark/benchmark.h>

#include <cstdio>
#include <filesystem>

#include "Diagnostics/HxCDebugServer.h"

namespace {

class Directory {
 public:
  Directory() {
    char name[] = "/tmp/hx_bench_XXXXXX";
    std::filesystem::current_path(mkdtemp(name));
  }
  Directory(const Directory&) = delete;
  Directory& operator=(const Directory&) = delete;
  ~Directory() {
    const auto here = std::filesystem::current_path();
    std::filesystem::current_path(m_Previous);
    std::filesystem::remove_all(here);
  }

 private:
  std::filesystem::path m_Previous = std::filesystem::current_path();
};

// The peer: the same line through a stream of the C run-time.
void BM_Std_StreamLine(benchmark::State& state) {
  const Directory directory;
  long long index = 0;
  for (auto _ : state) {
    std::FILE* file = std::fopen("peer.txt", "a+");
    std::fprintf(file, "%09lld %s\n", ++index, "block Gain converted");
    std::fclose(file);
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_Std_StreamLine);

void BM_DebugServer_ProtocolLine(benchmark::State& state) {
  const Directory directory;
  HxCDebugServer server;
  server.boot();
  char format[] = "%s";
  for (auto _ : state) server.protocolEntry(format, "block Gain converted");
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_DebugServer_ProtocolLine);

}  // namespace
