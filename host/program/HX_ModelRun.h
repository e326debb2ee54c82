// A run over the model of the command line.
//
//   HX_ModelRun run(arguments);
//   print(run.generator->result);
//   return run.finish();

#ifndef HOST_PROGRAM_HX_MODELRUN_H
#define HOST_PROGRAM_HX_MODELRUN_H

#include <memory>
#include <string>
#include <vector>

#include "host/base/HX_Progress.h"
#include "host/program/HX_Commands.h"
#include "host/program/HX_Generator.h"
#include "host/program/HX_LockFile.h"
#include "host/program/HX_Profile.h"

struct HX_ModelRun {
  /// Reads the model, forms the names, and chooses among the messages. Throws
  /// HX_DocumentError and HX_InputError.
  /// \param explains  the command asks how names came about
  explicit HX_ModelRun(const HX_Arguments& arguments, bool explains = true);

  /// Ends the profile.
  HX_ExitCode finish();

  HX_Progress progress;
  HX_Profile profile;
  HX_LockFile lock;
  std::unique_ptr<HX_Generator> generator;
};

/// The folders of word lists: the installed folder, then those of the user.
std::vector<std::string> HX_KeywordFolders(const HX_Arguments& arguments);

/// Throws std::bad_alloc if the memory ended at any time: the library answers
/// missing memory with results that are not whole.
void HX_RequireMemory();

#endif  // HOST_PROGRAM_HX_MODELRUN_H
