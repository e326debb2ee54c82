#include "host/program/HX_Commands.h"

#include <filesystem>
#include <iostream>
#include <new>
#include <optional>

#include "host/base/HX_System.h"
#include "host/base/HX_Text.h"
#include "host/model/HX_Document.h"
#include "host/model/HX_Synthesis.h"
#include "host/program/HX_Generator.h"
#include "host/program/HX_ImportCommands.h"
#include "host/program/HX_LockFile.h"
#include "host/program/HX_Version.h"
#include "host/write/HX_NameMap.h"
#include "host/write/HX_NameTable.h"
#include "host/write/HX_Report.h"

namespace {

HX_NameForming::Progress progressOf(const HX_Arguments& arguments) {
  if (arguments.quiet || !HX_IsErrorOutputTerminal())
    return [](std::size_t, std::size_t) {};
  return [](std::size_t done, std::size_t all) {
    if (all < 5000) return;
    if (done % 1000 == 0)
      std::cerr << "\rnames: " << done << " of " << all << std::flush;
    if (done == all) std::cerr << '\r' << std::string(40, ' ') << '\r';
  };
}

// The library answers missing memory with results that are not whole.
void requireMemory() {
  if (HX_DidMemoryEnd()) throw std::bad_alloc();
}

void showNames(const HX_Arguments& arguments, HX_Generator& generator) {
  const HX_Profile::Phase phase(generator.profile, "Print");
  if (arguments.json)
    HX_WriteJson(std::cout, generator.result);
  else
    HX_WriteTable(std::cout, generator.result);
}

void explainName(const HX_Arguments& arguments, HX_Generator& generator) {
  if (!generator.forming)  // a circle of types
    return HX_WriteFindings(std::cerr, generator.result);
  for (const HX_FormedName* name : generator.result.names) {
    if (name->wanted->id == arguments.name)
      return HX_WriteExplanation(std::cout, *name,
                                 generator.forming->explain(*name->wanted));
  }
  throw HX_InputError(HX_Visible(arguments.model) + ": /names: found no id " +
                      HX_Quoted(arguments.name) +
                      ", expected the id of a name");
}

void generateCode(const HX_Arguments& arguments, HX_Generator& generator,
                  const HX_LockFile* lock) {
  const HX_RunResult& result = generator.result;
  if (result.hasErrors()) return HX_WriteFindings(std::cerr, result);
  std::optional<HX_Output> lockOutput;
  if (lock != nullptr) {
    lock->write(lockOutput.emplace(lock->folder()));
    lockOutput->finish();
  }
  HX_Output output(generator.profile.start / arguments.out);
  const std::size_t changed = generator.write(output);
  HX_WriteFindings(std::cerr, result);
  if (arguments.json)
    HX_WriteJson(std::cout, result);
  else if (!arguments.quiet)
    std::cout << result.names.size() << " names, " << result.variables.size()
              << " variables; " << changed << " files written to "
              << arguments.out << '\n';
  // If a report cannot be written, no file of the code changes.
  generator.profile.finish();
  HX_FlushOutput();
  requireMemory();
  output.commit();
  // Last: a lock that was not replaced gives the same names again.
  if (lockOutput) lockOutput->commit();
}

std::string firstLine(const std::string& text) {
  return text.substr(0, text.find('\n'));
}

// A circle of types leaves no names; the page shows the circle.
void writeReport(const HX_Arguments& arguments, HX_Generator& generator) {
  const std::filesystem::path file = generator.profile.start / arguments.out;
  HX_Output output(file.parent_path());
  const auto explain = [&](const HX_WantedName& name) {
    return generator.forming->explain(name);
  };
  HX_WriteReport(output.open(file.filename().string()),
                 {*generator.model, generator.result, explain,
                  generator.profile.runs(), firstLine(HX_VersionText())});
  output.finish();
  if (!arguments.quiet)
    std::cout << generator.result.names.size() << " names in " << arguments.out
              << '\n';
  HX_FlushOutput();
  output.commit();
}

using Command = void (*)(const HX_Arguments&, HX_Generator&);

std::vector<std::string> keywordFolders(const HX_Arguments& arguments) {
  std::vector<std::string> folders{arguments.keywords};
  folders.insert(folders.end(), arguments.ownKeywords.begin(),
                 arguments.ownKeywords.end());
  return folders;
}

HX_LockFile lockFileOf(const HX_Arguments& arguments,
                       const std::filesystem::path& start) {
  return {arguments.lock, start / arguments.lock, arguments.locked};
}

HX_ExitCode runOverModel(const HX_Arguments& arguments, Command command) {
  HX_Profile profile(arguments.profile);
  HX_LockFile lock = lockFileOf(arguments, profile.start);
  HX_Generator generator(profile,
                         HX_ReadDocument(arguments.model, arguments, profile),
                         keywordFolders(arguments));
  generator.run(progressOf(arguments), lock.lock());
  requireMemory();
  command(arguments, generator);
  profile.finish();
  return generator.result.hasErrors() ? kHxErrorsFound : kHxDone;
}

}  // namespace

HX_ExitCode HX_ShowNames(const HX_Arguments& arguments) {
  return runOverModel(arguments, showNames);
}

HX_ExitCode HX_ExplainName(const HX_Arguments& arguments) {
  return runOverModel(arguments, explainName);
}

HX_ExitCode HX_GenerateCode(const HX_Arguments& arguments) {
  HX_Profile profile(arguments.profile);
  HX_LockFile lock = lockFileOf(arguments, profile.start);
  HX_Generator generator(profile,
                         HX_ReadDocument(arguments.model, arguments, profile),
                         keywordFolders(arguments));
  generator.run(progressOf(arguments), lock.lock());
  requireMemory();
  const bool writesLock = lock.lock() != nullptr && !arguments.locked &&
                          !generator.result.hasErrors() &&
                          generator.forming.has_value();
  if (arguments.locked && !generator.result.hasErrors() &&
      lock.writeChanges(std::cerr) > 0)
    return kHxErrorsFound;
  if (writesLock) lock.lock()->endRun(arguments.retireRuns);
  generateCode(arguments, generator, writesLock ? &lock : nullptr);
  profile.finish();
  return generator.result.hasErrors() ? kHxErrorsFound : kHxDone;
}

HX_ExitCode HX_ReportNames(const HX_Arguments& arguments) {
  return runOverModel(arguments, writeReport);
}

HX_ExitCode HX_PruneLock(const HX_Arguments& arguments) {
  HX_LockFile lock(arguments.lock,
                   std::filesystem::current_path() / arguments.lock, true);
  lock.lock()->prune();
  HX_Output output(lock.folder());
  lock.write(output);
  output.finish();
  output.commit();
  return kHxDone;
}

HX_ExitCode HX_SynthesizeDocument(const HX_Arguments& arguments) {
  HX_Synthesize(std::cout, arguments.blocks, arguments.seed);
  return kHxDone;
}

void HX_FlushOutput() {
  if (!std::cout.flush())
    throw HX_OutputError("standard output: cannot be written");
}
