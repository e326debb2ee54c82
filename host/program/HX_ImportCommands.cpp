#include "host/program/HX_ImportCommands.h"

#include <iostream>
#include <stdexcept>

#ifdef HX_HAS_IMPORT
#include "host/import/HX_Import.h"
#include "host/import/HX_Rules.h"

namespace {

HX_ImportRequest requestOf(const HX_Arguments& arguments) {
  HX_ImportRequest request;
  request.model = arguments.model;
  request.dictionaries.assign(arguments.dictionaries.begin(),
                              arguments.dictionaries.end());
  request.searchPath.assign(arguments.searchPath.begin(),
                            arguments.searchPath.end());
  request.rules = arguments.rules;
  request.keywordFolder = arguments.keywords;
  return request;
}

}  // namespace

HX_ExitCode HX_ImportModelFile(const HX_Arguments& arguments) {
  const HX_Import import = HX_ImportModel(requestOf(arguments));
  if (!arguments.quiet) {
    for (const std::string& note : import.notes) std::cerr << note << '\n';
  }
  std::cout << import.document;
  return kHxDone;
}

HX_ExitCode HX_PrintRules(const HX_Arguments& arguments) {
  std::cout << (arguments.schema ? HX_Rules::schemaText()
                                 : HX_Rules::defaultText());
  return kHxDone;
}

#else

namespace {

[[noreturn]] HX_ExitCode refuse() {
  throw std::runtime_error(
      "this build reads no model files: the libraries for them are to be had "
      "for 64 bits only");
}

}  // namespace

HX_ExitCode HX_ImportModelFile(const HX_Arguments& /*arguments*/) { refuse(); }

HX_ExitCode HX_PrintRules(const HX_Arguments& /*arguments*/) { refuse(); }

#endif
