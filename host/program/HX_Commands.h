// The commands of hx_codegen.

#ifndef HOST_PROGRAM_HX_COMMANDS_H
#define HOST_PROGRAM_HX_COMMANDS_H

#include <cstdint>
#include <string>
#include <vector>

class HX_DiagnosticLog;

enum HX_ExitCode { kHxDone = 0, kHxErrorsFound = 1, kHxRefused = 2 };

/// The command line.
struct HX_Arguments {
  HX_DiagnosticLog* log = nullptr;  ///< never null in a command
  std::string model;
  std::string name;
  std::string keywords;                  ///< folder of the installed word lists
  std::vector<std::string> ownKeywords;  ///< folders of the user
  std::string lock;
  std::string older;  ///< of two sets of names
  std::string format = "table";
  std::vector<std::string> templates;
  std::vector<std::string> patterns;
  std::vector<std::string> reserved;  ///< word lists beside the document's
  int retireRuns = 0;
  bool locked = false;
  std::string out;
  std::string component;  ///< path of the one component to generate
  std::string depfile;
  std::string depfileTarget;  ///< in place of the files; may be empty
  std::vector<std::string> filters;
  std::string sort;
  std::vector<std::string> columns = {"name",   "source", "template",
                                      "formal", "actual", "complete"};
  bool byComponent = false;
  bool listOutputs = false;
  bool upToDate = false;
  std::string profile;
  std::vector<std::string> dictionaries;
  std::vector<std::string> searchPath;
  std::string rules;
  bool schema = false;
  bool json = false;
  bool lines = false;
  bool quiet = false;
  int number = 0;  ///< of a message; 0 for all
  int blocks = 1000;
  std::uint64_t seed = 1;
};

// Every command throws HX_DocumentError and HX_OutputError.

HX_ExitCode HX_ShowNames(const HX_Arguments& arguments);
HX_ExitCode HX_ExplainName(const HX_Arguments& arguments);
HX_ExitCode HX_GenerateCode(const HX_Arguments& arguments);
HX_ExitCode HX_CheckModel(const HX_Arguments& arguments);
HX_ExitCode HX_ListComponents(const HX_Arguments& arguments);
HX_ExitCode HX_ReportNames(const HX_Arguments& arguments);
HX_ExitCode HX_PruneLock(const HX_Arguments& arguments);
HX_ExitCode HX_CompareNames(const HX_Arguments& arguments);
HX_ExitCode HX_LintTemplates(const HX_Arguments& arguments);
HX_ExitCode HX_HelpMessage(const HX_Arguments& arguments);
HX_ExitCode HX_SynthesizeDocument(const HX_Arguments& arguments);

/// Throws HX_OutputError if the standard output cannot be written.
void HX_FlushOutput();

#endif  // HOST_PROGRAM_HX_COMMANDS_H
