#include "host/program/HX_Commands.h"

#include <filesystem>
#include <iostream>
#include <memory>
#include <new>
#include <optional>

#include "host/base/HX_System.h"
#include "host/base/HX_Text.h"
#include "host/messages/HX_MessageTable.h"
#include "host/model/HX_Document.h"
#include "host/model/HX_Synthesis.h"
#include "host/program/HX_Generator.h"
#include "host/program/HX_ImportCommands.h"
#include "host/program/HX_LockFile.h"
#include "host/program/HX_NameSets.h"
#include "host/program/HX_Version.h"
#include "host/write/HX_DiagnosticLog.h"
#include "host/write/HX_NameMap.h"
#include "host/write/HX_NameTable.h"
#include "host/write/HX_Report.h"

namespace {

// The library answers missing memory with results that are not whole.
void requireMemory() {
  if (HX_DidMemoryEnd()) throw std::bad_alloc();
}

void showNames(const HX_Arguments& arguments, HX_Generator& generator) {
  const HX_Profile::Phase phase(generator.profile, "Print");
  if (arguments.log->format != HX_DiagnosticLog::eText)
    arguments.log->add(generator.result);
  if (arguments.json || arguments.lines)
    HX_WriteJson(std::cout, *generator.model, generator.result,
                 arguments.lines);
  else
    HX_WriteTable(std::cout, generator.result, generator.progress);
}

void explainName(const HX_Arguments& arguments, HX_Generator& generator) {
  if (!generator.forming)  // a circle of types
    return arguments.log->add(generator.result);
  for (const HX_FormedName* name : generator.result.names) {
    if (name->wanted->id == arguments.name)
      return HX_WriteExplanation(std::cout, *name,
                                 generator.forming->explain(*name->wanted));
  }
  throw HX_InputError(
      HX_MessageText(kHxUnknownName,
                     {HX_Visible(arguments.model), HX_Quoted(arguments.name)}),
      kHxUnknownName);
}

void generateCode(const HX_Arguments& arguments, HX_Generator& generator,
                  const HX_LockFile* lock) {
  HX_RunResult& result = generator.result;
  if (result.hasErrors()) return arguments.log->add(result);
  std::optional<HX_Output> lockOutput;
  if (lock != nullptr) {
    lock->write(lockOutput.emplace(lock->folder()));
    lockOutput->finish();
  }
  HX_Output output(generator.profile.start / arguments.out);
  const std::size_t changed = generator.write(output, arguments.lines);
  arguments.log->choose(result);
  arguments.log->add(result);
  if (result.hasErrors()) return;
  if (arguments.json)
    HX_WriteJson(std::cout, *generator.model, result, arguments.lines);
  // If a report cannot be written, no file of the code changes.
  generator.profile.finish();
  HX_FlushOutput();
  requireMemory();
  output.commit();
  // Last: a lock that was not replaced gives the same names again.
  if (lockOutput) lockOutput->commit();
  if (arguments.json || arguments.quiet) return;
  std::cout << result.names.size() << " names, " << result.variables.size()
            << " variables; " << changed << " files written to "
            << arguments.out << '\n';
  if (std::cout.flush()) return;
  output.undo();
  if (lockOutput) lockOutput->undo();
  HX_FlushOutput();
}

std::string firstLine(const std::string& text) {
  return text.substr(0, text.find('\n'));
}

// The renamed names by id; \p since has the names of the older run.
std::map<std::string, HX_OlderName> renamedSince(HX_NameDiff& since,
                                                 const std::string& older,
                                                 const HX_RunResult& result) {
  std::map<std::string, HX_OlderName> renamed;
  if (older.empty()) return renamed;
  HX_AddFormedNames(since, HX_NameDiff::eNew, result);
  if (!since.compare()) throw std::bad_alloc();
  for (int i = 0; i < since.rowCount(); ++i) {
    const HX_NameDiff::Row& row = since.row(i);
    if (row.change == HX_NameDiff::eRenamed)
      renamed[std::string(row.after.item)] = {std::string(row.before.name),
                                              HX_ReasonOf(row)};
  }
  return renamed;
}

// A circle of types leaves no names; the page shows the circle.
void writeReport(const HX_Arguments& arguments, HX_Generator& generator,
                 HX_NameDiff& since) {
  const std::filesystem::path file = generator.profile.start / arguments.out;
  HX_Output output(file.parent_path());
  const auto explain = [&](const HX_WantedName& name) {
    return generator.forming->explain(name);
  };
  HX_WriteReport(
      output.open(file.filename().string()),
      {*generator.model, generator.result, explain, generator.profile.runs(),
       firstLine(HX_VersionText()), arguments.older,
       renamedSince(since, arguments.older, generator.result)});
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

/// A run over the model of the command line.
struct ModelRun {
  /// \param explains  the command asks how names came about
  explicit ModelRun(const HX_Arguments& arguments, bool explains = true)
      : progress(!arguments.quiet && HX_IsErrorOutputTerminal()),
        profile(arguments.profile),
        lock(lockFileOf(arguments, profile.start)),
        generator(std::make_unique<HX_Generator>(
            profile, progress,
            HX_ReadDocument(arguments.model, arguments, profile),
            keywordFolders(arguments),
            HX_ReservedChoice{arguments.reserved, arguments.patterns})) {
    generator->keepsSpaces = explains;
    generator->run(lock.lock());
    arguments.log->choose(generator->result);
    requireMemory();
  }

  HX_ExitCode finish() {
    profile.finish();
    const bool hasErrors = generator->result.hasErrors();
#ifdef NDEBUG
    // The process ends. Giving back millions of pieces of memory one by one
    // takes a tenth of the run.
    static_cast<void>(generator.release());
#endif
    return hasErrors ? kHxErrorsFound : kHxDone;
  }

  HX_Progress progress;
  HX_Profile profile;
  HX_LockFile lock;
  std::unique_ptr<HX_Generator> generator;
};

HX_ExitCode runOverModel(const HX_Arguments& arguments, Command command,
                         bool explains = true) {
  ModelRun run(arguments, explains);
  command(arguments, *run.generator);
  return run.finish();
}

}  // namespace

HX_ExitCode HX_ShowNames(const HX_Arguments& arguments) {
  return runOverModel(arguments, showNames, false);
}

HX_ExitCode HX_ExplainName(const HX_Arguments& arguments) {
  return runOverModel(arguments, explainName);
}

HX_ExitCode HX_GenerateCode(const HX_Arguments& arguments) {
  ModelRun run(arguments, false);
  const bool hasErrors = run.generator->result.hasErrors();
  const bool writesLock = run.lock.lock() != nullptr && !arguments.locked &&
                          !hasErrors && run.generator->forming.has_value();
  if (arguments.locked && !hasErrors && run.lock.addChanges(*arguments.log) > 0)
    return kHxErrorsFound;
  if (writesLock) run.lock.lock()->endRun(arguments.retireRuns);
  generateCode(arguments, *run.generator, writesLock ? &run.lock : nullptr);
  return run.finish();
}

HX_ExitCode HX_ReportNames(const HX_Arguments& arguments) {
  HX_NameDiff since;
  if (!arguments.older.empty())
    HX_AddNames(since, HX_NameDiff::eOld, arguments.older, arguments);
  ModelRun run(arguments);
  writeReport(arguments, *run.generator, since);
  return run.finish();
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

HX_ExitCode HX_HelpMessage(const HX_Arguments& arguments) {
  const std::string help = arguments.number == 0
                               ? HX_AllMessageHelp()
                               : HX_MessageHelp(arguments.number);
  if (help.empty())
    throw HX_InputError(
        HX_MessageText(kHxUnknownNumber, {std::to_string(arguments.number)}),
        kHxUnknownNumber);
  std::cout << help;
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
