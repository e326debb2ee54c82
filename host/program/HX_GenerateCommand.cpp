// hx_codegen generate, check and components: the code of a model, as a whole or
// by component.
#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <memory>
#include <optional>

#include "host/base/HX_ComparingOutput.h"
#include "host/base/HX_InputFiles.h"
#include "host/base/HX_Output.h"
#include "host/base/HX_System.h"
#include "host/program/HX_ModelRun.h"
#include "host/write/HX_DiagnosticLog.h"
#include "host/write/HX_NameMap.h"

namespace fs = std::filesystem;

namespace {

/// The files of a folder: of a component, or of the whole model.
struct Part {
  int component;    // -1 for the whole model
  fs::path folder;  // as the user counts
};

std::vector<Part> partsOf(const HX_Arguments& arguments,
                          const HX_Generator& generator) {
  if (!generator.components) return {{-1, arguments.out}};
  std::vector<Part> parts;
  const auto& all = generator.components->all();
  for (std::size_t i = 0; i < all.size(); ++i) {
    const int index = static_cast<int>(i);
    if (generator.component < 0 || generator.component == index)
      parts.push_back({index, fs::path(arguments.out) / all[i].files.code});
  }
  return parts;
}

/// Hands files on and notes their names.
class NotingSink : public HX_FileSink {
 public:
  NotingSink(HX_FileSink& inner, const fs::path& folder,
             std::vector<std::string>& paths)
      : m_Inner(inner), m_Folder(folder), m_Paths(paths) {}

  std::ostream& open(const std::string& name) override {
    m_Paths.push_back((m_Folder / name).string());
    return m_Inner.open(name);
  }

 private:
  HX_FileSink& m_Inner;
  const fs::path m_Folder;
  std::vector<std::string>& m_Paths;
};

// As make reads the text: a blank and '#' need a backslash, '$' a second '$'.
std::string escaped(const std::string& path) {
  std::string text;
  for (const char c : path) {
    if (c == ' ' || c == '#') text += '\\';
    if (c == '$') text += '$';
    text += c;
  }
  return text;
}

void writeDependencies(std::ostream& out, std::vector<std::string> outputs) {
  std::sort(outputs.begin(), outputs.end());
  for (const std::string& path : outputs) out << escaped(path) << ' ';
  out << ':';
  for (const std::string& path : HX_InputFiles())
    out << " \\\n  " << escaped(path);
  out << '\n';
}

// Not an HX_Output: parallel runs for components share the folder.
void placeDepfile(const fs::path& path, const std::string& target,
                  const std::vector<std::string>& outputs) {
  const fs::path part = path.string() + "." + HX_ProcessNumber();
  std::ofstream out(part, std::ios::binary);
  writeDependencies(
      out, target.empty() ? outputs : std::vector<std::string>{target});
  out.close();
  std::error_code error;
  if (out) fs::rename(part, path, error);
  if (out && !error) return;
  fs::remove(part, error);
  throw HX_OutputError(path.string() + ": cannot be written");
}

/// Several folders that change together.
class Outputs {
 public:
  HX_Output& add(const fs::path& folder) {
    return *m_All.emplace_back(std::make_unique<HX_Output>(folder));
  }
  void commit() {
    for (; m_Committed < m_All.size(); ++m_Committed) {
      try {
        m_All[m_Committed]->commit();
      } catch (const HX_OutputError&) {
        undo();
        throw;
      }
    }
  }
  void undo() {
    while (m_Committed > 0) m_All[--m_Committed]->undo();
  }

 private:
  std::vector<std::unique_ptr<HX_Output>> m_All;
  std::size_t m_Committed = 0;
};

void printSummary(const HX_Arguments& arguments, const HX_RunResult& result,
                  std::size_t changed) {
  std::cout << result.names.size() << " names, " << result.variables.size()
            << " variables; " << changed << " files written to "
            << arguments.out << '\n';
}

// REQUIRES: no errors so far.
void placeFiles(const HX_Arguments& arguments, HX_ModelRun& run,
                bool writesLock) {
  HX_Generator& generator = *run.generator;
  HX_RunResult& result = generator.result;
  const fs::path& start = run.profile.start;
  Outputs outputs;
  std::vector<std::string> paths;
  std::size_t changed = 0;
  for (const Part& part : partsOf(arguments, generator)) {
    HX_Output& output = outputs.add(start / part.folder);
    NotingSink sink(output, part.folder, paths);
    generator.write(part.component, sink);
    changed += output.finish();
  }
  arguments.log->choose(result);
  arguments.log->add(result);
  if (result.hasErrors()) return;
  // Last: a lock that was not replaced gives the same names again.
  if (writesLock) {
    HX_Output& output = outputs.add(run.lock.folder());
    run.lock.write(output);
    output.finish();
  }
  if (arguments.json)
    HX_WriteJson(std::cout, *generator.model, result, arguments.lines);
  // If a report cannot be written, no file of the code changes.
  run.profile.finish();
  HX_FlushOutput();
  HX_RequireMemory();
  outputs.commit();
  if (!arguments.depfile.empty())
    placeDepfile(start / arguments.depfile, arguments.depfileTarget, paths);
  if (arguments.json || arguments.quiet) return;
  printSummary(arguments, result, changed);
  if (std::cout.flush()) return;
  outputs.undo();
  HX_FlushOutput();
}

// Writes all files nowhere.
void listFiles(const HX_Arguments& arguments, HX_Generator& generator) {
  for (const Part& part : partsOf(arguments, generator)) {
    HX_ComparingOutput nowhere("/dev/null");
    generator.write(part.component, nowhere);
    for (const std::string& name : nowhere.names())
      std::cout << (part.folder / name).string() << '\n';
  }
}

void compareFiles(const HX_Arguments& arguments, HX_ModelRun& run,
                  bool writesLock) {
  HX_Generator& generator = *run.generator;
  const auto compare = [&](const fs::path& folder, const auto& write) {
    HX_ComparingOutput output(run.profile.start / folder);
    write(output);
    if (!arguments.upToDate) return;
    for (const std::string& name : output.changed())
      arguments.log->add({kHxOutdated, 2, HX_MessageText(kHxOutdated, {}), "",
                          "", (folder / name).string()});
  };
  for (const Part& part : partsOf(arguments, generator))
    compare(part.folder,
            [&](HX_FileSink& sink) { generator.write(part.component, sink); });
  if (writesLock)
    compare(fs::path(arguments.lock).parent_path(),
            [&](HX_FileSink& sink) { run.lock.write(sink); });
}

// A run for a component takes all names from the lock.
bool isLocked(const HX_Arguments& arguments) {
  return arguments.locked || !arguments.component.empty();
}

}  // namespace

HX_ExitCode HX_GenerateCode(const HX_Arguments& arguments) {
  HX_ModelRun run(arguments, false);
  HX_Generator& generator = *run.generator;
  if (arguments.byComponent) generator.splitIntoComponents();
  if (arguments.listOutputs) {
    listFiles(arguments, generator);
    return kHxDone;
  }
  if (generator.result.hasErrors()) {
    arguments.log->add(generator.result);
    return run.finish();
  }
  if (isLocked(arguments) && run.lock.addChanges(*arguments.log) > 0)
    return kHxErrorsFound;
  const bool writesLock = run.lock.lock() != nullptr && !isLocked(arguments) &&
                          generator.forming.has_value();
  if (writesLock) run.lock.lock()->endRun(arguments.retireRuns);
  if (!writesLock && run.lock.lock() != nullptr)
    HX_InputFiles().insert(arguments.lock);
  placeFiles(arguments, run, writesLock);
  return run.finish();
}

HX_ExitCode HX_CheckModel(const HX_Arguments& arguments) {
  HX_ModelRun run(arguments, false);
  HX_Generator& generator = *run.generator;
  HX_RunResult& result = generator.result;
  if (arguments.byComponent) generator.splitIntoComponents();
  bool isDifferent = false;
  if (!result.hasErrors()) {
    const bool isChanged =
        isLocked(arguments) && run.lock.addChanges(*arguments.log) > 0;
    const bool writesLock = run.lock.lock() != nullptr && !isLocked(arguments);
    if (writesLock) run.lock.lock()->endRun(arguments.retireRuns);
    const std::size_t before = arguments.log->size();
    compareFiles(arguments, run, writesLock);
    isDifferent = isChanged || arguments.log->size() > before;
    arguments.log->choose(result);
  }
  arguments.log->add(result);
  const HX_ExitCode code = run.finish();
  return isDifferent ? kHxErrorsFound : code;
}

HX_ExitCode HX_ListComponents(const HX_Arguments& arguments) {
  HX_ModelRun run(arguments, false);
  run.generator->splitIntoComponents();
  for (const auto& component : run.generator->components->all())
    std::cout << component.path << '\t' << component.files.code << '\n';
  arguments.log->add(run.generator->result);
  return run.finish();
}
