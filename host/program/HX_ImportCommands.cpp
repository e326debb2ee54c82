#include "host/program/HX_ImportCommands.h"

#include <iostream>
#include <stdexcept>

#ifdef HX_HAS_IMPORT
#include "host/base/HX_InputFiles.h"
#include "host/import/HX_Import.h"
#include "host/import/HX_Rules.h"
#include "host/write/HX_DiagnosticLog.h"

namespace {

void noteInputs(const HX_ImportRequest& request) {
  HX_InputFiles().insert(request.model.string());
  if (!request.rules.empty()) HX_InputFiles().insert(request.rules.string());
  for (const auto& file : request.dictionaries)
    HX_InputFiles().insert(file.string());
}

// The line begins with the severity.
void logNote(const std::string& line, HX_DiagnosticLog& log) {
  const bool isWarning = line.starts_with("warning: ");
  log.add({isWarning ? kHxImportWarning : kHxImportNote, isWarning ? 1 : 0,
           line.substr(line.find(": ") + 2), "", ""});
}

// Paths count from \p folder. In messages a path stays as the user wrote it,
// unless the working directory has changed.
HX_Import importOf(const std::string& file, const HX_Arguments& arguments,
                   const std::filesystem::path& folder) {
  std::filesystem::path start;
  if (folder != std::filesystem::current_path()) start = folder;
  HX_ImportRequest request;
  request.model = start / file;
  for (const std::string& path : arguments.dictionaries)
    request.dictionaries.push_back(start / path);
  for (const std::string& path : arguments.searchPath)
    request.searchPath.push_back(start / path);
  if (!arguments.rules.empty()) request.rules = start / arguments.rules;
  request.keywordFolders = {start / arguments.keywords};
  for (const std::string& path : arguments.ownKeywords)
    request.keywordFolders.push_back(start / path);
  HX_Import import = HX_ImportModel(request);
  noteInputs(request);
  if (!arguments.quiet) {
    for (const std::string& note : import.notes) logNote(note, *arguments.log);
  }
  return import;
}

}  // namespace

HX_Document HX_ReadDocument(const std::string& file,
                            const HX_Arguments& arguments,
                            HX_Profile& profile) {
  if (!HX_IsModelFile(file)) {
    const HX_Profile::Phase phase(profile, "Read document");
    return {file, profile.start};
  }
  const HX_Profile::Phase phase(profile, "Import model");
  return HX_Document::ofText(file,
                             importOf(file, arguments, profile.start).document);
}

HX_ExitCode HX_ImportModelFile(const HX_Arguments& arguments) {
  std::cout << importOf(arguments.model, arguments,
                        std::filesystem::current_path())
                   .document;
  return kHxDone;
}

HX_ExitCode HX_PrintRules(const HX_Arguments& arguments) {
  std::cout << (arguments.schema ? HX_Rules::schemaText()
                                 : HX_Rules::defaultText());
  return kHxDone;
}

#else

namespace {

[[noreturn]] void refuse() {
  throw std::runtime_error(
      "this build reads no model files: the libraries for them are to be had "
      "for 64 bits only");
}

}  // namespace

HX_Document HX_ReadDocument(const std::string& file,
                            const HX_Arguments& /*arguments*/,
                            HX_Profile& profile) {
  const auto ending = std::filesystem::path(file).extension();
  if (ending == ".slx" || ending == ".mdl") refuse();
  const HX_Profile::Phase phase(profile, "Read document");
  return {file, profile.start};
}

HX_ExitCode HX_ImportModelFile(const HX_Arguments& /*arguments*/) { refuse(); }

HX_ExitCode HX_PrintRules(const HX_Arguments& /*arguments*/) { refuse(); }

#endif
