#include "host/program/HX_Commands.h"

#include <filesystem>
#include <iostream>

#include "host/base/HX_ComparingOutput.h"
#include "host/base/HX_System.h"
#include "host/base/HX_Text.h"
#include "host/messages/HX_MessageTable.h"
#include "host/model/HX_Document.h"
#include "host/model/HX_Synthesis.h"
#include "host/program/HX_Generator.h"
#include "host/program/HX_LockFile.h"
#include "host/program/HX_ModelRun.h"
#include "host/program/HX_NameSets.h"
#include "host/program/HX_Version.h"
#include "host/write/HX_DiagnosticLog.h"
#include "host/write/HX_NameColumns.h"
#include "host/write/HX_NameMap.h"
#include "host/write/HX_NameTable.h"
#include "host/write/HX_Report.h"

namespace {

void showNames(const HX_Arguments& arguments, HX_Generator& generator) {
  const HX_Profile::Phase phase(generator.profile, "Print");
  // The writer of the code has messages too.
  if (!generator.result.hasErrors()) {
    HX_ComparingOutput nowhere("/dev/null");
    generator.writeCode(nowhere);
    arguments.log->choose(generator.result);
  }
  if (arguments.log->format != HX_DiagnosticLog::eText)
    arguments.log->add(generator.result);
  for (const HX_FormedName& name : generator.result.formed) name.code = {};
  HX_SelectNames(generator.result.names, arguments.filters, arguments.sort);
  if (arguments.json || arguments.lines)
    HX_WriteJson(std::cout, *generator.model, generator.result,
                 arguments.lines);
  else
    HX_WriteTable(std::cout, generator.result, arguments.columns,
                  HX_OutputTerminal().width, generator.progress);
}

void explainName(const HX_Arguments& arguments, HX_Generator& generator) {
  if (!generator.forming)  // a circle of types
    return arguments.log->add(generator.result);
  for (const HX_FormedName* name : generator.result.names) {
    if (name->wanted->id != arguments.name) continue;
    const auto write =
        arguments.json ? HX_WriteExplanationJson : HX_WriteExplanation;
    return write(std::cout, *name, generator.forming->explain(*name->wanted),
                 generator.forming->steps());
  }
  throw HX_InputError(
      HX_MessageText(kHxUnknownName,
                     {HX_Visible(arguments.model), HX_Quoted(arguments.name)}),
      kHxUnknownName);
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

HX_ExitCode runOverModel(const HX_Arguments& arguments, Command command,
                         bool explains = true) {
  HX_ModelRun run(arguments, explains);
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

HX_ExitCode HX_ReportNames(const HX_Arguments& arguments) {
  HX_NameDiff since;
  if (!arguments.older.empty())
    HX_AddNames(since, HX_NameDiff::eOld, arguments.older, arguments);
  HX_ModelRun run(arguments);
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
