// Reading a model file beside Python's zipfile and xml.etree.
//
// One item is one model of the given number of blocks, 50 to a system, some 740
// bytes of XML to a block: 5,000 blocks are 3.7 MB. "Read" unpacks and parses
// the parts with blocks, the same work on both sides. "Whole" also builds the
// tree, the names and the document.

#include <benchmark/benchmark.h>
#include <zip.h>

#include <cstdio>
#include <filesystem>
#include <map>
#include <string>

#include "host/import/HX_Import.h"
#include "host/import/HX_ModelFile.h"

namespace fs = std::filesystem;

namespace {

constexpr int kBlocksPerSystem = 50;

std::string parameter(const char* name, const std::string& value) {
  return std::string("    <P Name=\"") + name + "\">" + value + "</P>\n";
}

std::string block(int number) {
  const std::string sid = std::to_string(number);
  return "  <Block BlockType=\"Gain\" Name=\"Proportional Gain " + sid +
         "\" SID=\"" + sid + "\">\n" + parameter("Ports", "[1, 1]") +
         parameter("Position", "[1270, 478, 1300, " + sid + "]") +
         parameter("ZOrder", sid) + parameter("Gain", sid + ".25") +
         parameter("Multiplication", "Element-wise(K.*u)") +
         parameter("ParamDataTypeStr", "Inherit: Inherit via internal rule") +
         parameter("OutDataTypeStr", "fixdt(1,16,8)") +
         parameter("ParamMin", "[]") + parameter("ParamMax", "[]") +
         parameter("SaturateOnIntegerOverflow", "off") +
         "  </Block>\n  <Line>\n" + parameter("ZOrder", sid) +
         parameter("Name", "gain_" + sid) + parameter("Labels", "[0, 0]") +
         parameter("Src", sid + "#out:1") +
         parameter("Points", "[19, 0; 0, 113; -558, 0; 0, -93]") +
         parameter("Dst", sid + "#in:1") + "  </Line>\n";
}

// The newer layout: a part for each system.
std::map<std::string, std::string> partsOf(int blocks) {
  std::map<std::string, std::string> parts;
  std::string root = "<ModelInformation><Model><System>\n";
  for (int system = 0; system * kBlocksPerSystem < blocks; ++system) {
    const std::string sid = std::to_string(1'000'000 + system);
    root += "<Block BlockType=\"SubSystem\" Name=\"Subsystem " + sid +
            "\" SID=\"" + sid + "\"><System Ref=\"system_" + sid +
            "\"/></Block>\n";
    std::string& part = parts["simulink/systems/system_" + sid + ".xml"];
    part = "<System>\n";
    for (int i = 0; i < kBlocksPerSystem; ++i)
      part += block(system * kBlocksPerSystem + i + 1);
    part += "</System>\n";
  }
  parts["simulink/blockdiagram.xml"] =
      root + "</System></Model></ModelInformation>\n";
  return parts;
}

fs::path packedModel(benchmark::State& state) {
  const fs::path file = fs::temp_directory_path() / "hx_import_bench.slx";
  const auto parts = partsOf(static_cast<int>(state.range(0)));
  int error = 0;
  zip_t* archive = zip_open(file.c_str(), ZIP_CREATE | ZIP_TRUNCATE, &error);
  for (const auto& [name, text] : parts)
    zip_file_add(archive, name.c_str(),
                 zip_source_buffer(archive, text.data(), text.size(), 0), 0);
  if (zip_close(archive) != 0) state.SkipWithError("cannot pack a model");
  double megabytes = 0;
  for (const auto& [name, text] : parts)
    megabytes += static_cast<double>(text.size()) / 1e6;
  state.counters["MB"] = megabytes;
  return file;
}

void BM_Import_Read(benchmark::State& state) {
  const fs::path file = packedModel(state);
  for (auto _ : state) {
    const HX_ModelFile model(file, HX_ImportLimits());
    benchmark::DoNotOptimize(model.rootSystem());
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_Import_Read)->Arg(5000)->Unit(benchmark::kMillisecond);

void BM_Import_Whole(benchmark::State& state) {
  HX_ImportRequest request;
  request.model = packedModel(state);
  request.keywordFolders = {HX_KEYWORD_FOLDER};
  for (auto _ : state)
    benchmark::DoNotOptimize(HX_ImportModel(request).document);
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_Import_Whole)
    ->Arg(5000)
    ->Arg(50000)
    ->Unit(benchmark::kMillisecond);

// Python's own clock, without the start of the interpreter.
void BM_Python_Read(benchmark::State& state) {
  const fs::path file = packedModel(state);
  const std::string command =
      "python3 " HX_BENCH_FOLDER "/read_parts.py " + file.string() + " 3";
  for (auto _ : state) {
    FILE* output = popen(command.c_str(), "r");
    long blocks = 0;
    double seconds = 0;
    const bool isRead = output != nullptr &&
                        std::fscanf(output, "%ld %lf", &blocks, &seconds) == 2;
    if (output != nullptr) pclose(output);
    if (!isRead || blocks < state.range(0)) {
      state.SkipWithError("peer not installed: python3");
      break;
    }
    state.SetIterationTime(seconds);
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_Python_Read)
    ->Arg(5000)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);

}  // namespace
