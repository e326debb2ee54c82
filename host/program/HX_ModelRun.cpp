#include "host/program/HX_ModelRun.h"

#include <new>

#include "host/base/HX_System.h"
#include "host/program/HX_ImportCommands.h"
#include "host/write/HX_DiagnosticLog.h"

HX_ModelRun::HX_ModelRun(const HX_Arguments& arguments, bool explains)
    : progress(!arguments.quiet && HX_IsErrorOutputTerminal()),
      profile(arguments.profile),
      lock(arguments.lock, profile.start / arguments.lock,
           arguments.locked || !arguments.component.empty()),
      generator(std::make_unique<HX_Generator>(
          profile, progress,
          HX_ReadDocument(arguments.model, arguments, profile),
          HX_KeywordFolders(arguments),
          HX_ReservedChoice{arguments.reserved, arguments.patterns})) {
  generator->keepsSpaces = explains;
  generator->asLines = arguments.lines;
  generator->run(lock.lock(), arguments.component, arguments.name);
  arguments.log->choose(generator->result);
  HX_RequireMemory();
}

HX_ExitCode HX_ModelRun::finish() {
  profile.finish();
  const bool hasErrors = generator->result.hasErrors();
#ifdef NDEBUG
  // The process ends. Giving back millions of pieces of memory one by one
  // takes a tenth of the run.
  static_cast<void>(generator.release());
#endif
  return hasErrors ? kHxErrorsFound : kHxDone;
}

std::vector<std::string> HX_KeywordFolders(const HX_Arguments& arguments) {
  std::vector<std::string> folders{arguments.keywords};
  folders.insert(folders.end(), arguments.ownKeywords.begin(),
                 arguments.ownKeywords.end());
  return folders;
}

void HX_RequireMemory() {
  if (HX_DidMemoryEnd()) throw std::bad_alloc();
}
