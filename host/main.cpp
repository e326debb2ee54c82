// hx_codegen: from a model document to names and C code.
#include <fcntl.h>
#include <unistd.h>

#include <CLI/CLI.hpp>
#include <csignal>
#include <iostream>

#include "host/HX_CWriter.h"
#include "host/HX_Generator.h"
#include "host/HX_Output.h"
#include "host/HX_Synthesis.h"
#include "host/HX_Version.h"

namespace {

enum ExitCode { kDone = 0, kErrorsFound = 1, kRefused = 2 };

struct Arguments {
  std::string model;
  std::string name;
  std::string keywords = HX_KEYWORD_FOLDER;
  std::string out;
  std::string profile;
  bool json = false;
  bool quiet = false;
  int blocks = 1000;
  std::uint64_t seed = 1;
};

constexpr char kFooter[] =
    "Examples:\n"
    "  hx_codegen names model.json\n"
    "  hx_codegen explain model.json --name set_speed\n"
    "  hx_codegen generate model.json --out code --profile profile\n"
    "  hx_codegen synthesize --blocks 10000 --seed 7 > large.json\n"
    "\n"
    "Exit codes:\n"
    "  0  done; warnings at most\n"
    "  1  done, but a message was an error; no code is written\n"
    "  2  refused: the command line or the document is wrong, or a file "
    "cannot\n"
    "     be read or written; nothing is written";

// Long work tells how far it is, if someone is there to read it.
HX_NameRun::Progress progressOf(const Arguments& arguments) {
  if (arguments.quiet || isatty(STDERR_FILENO) == 0)
    return [](std::size_t, std::size_t) {};
  return [](std::size_t done, std::size_t all) {
    if (all < 5000) return;
    if (done % 1000 == 0)
      std::cerr << "\rnames: " << done << " of " << all << std::flush;
    if (done == all) std::cerr << '\r' << std::string(40, ' ') << '\r';
  };
}

HX_Document readDocument(const Arguments& arguments, HX_Profile& profile) {
  const HX_Profile::Phase phase(profile, "Read document");
  return HX_Document(arguments.model, profile.start());
}

int exitCodeOf(const HX_RunResult& result) {
  return result.hasErrors() ? kErrorsFound : kDone;
}

int showNames(const Arguments& arguments, HX_Profile& profile) {
  const HX_Document document = readDocument(arguments, profile);
  HX_Generator generator(document, profile.start() / arguments.keywords,
                         profile);
  const HX_RunResult& result =
      generator.run(HX_Generator::eAsInDocument, progressOf(arguments));
  const HX_Profile::Phase phase(profile, "Print");
  if (arguments.json)
    HX_WriteNamesAsJson(std::cout, result);
  else
    std::cout << HX_NamesAsTable(result);
  return exitCodeOf(result);
}

void writeFindings(const HX_RunResult& result) {
  for (const HX_FormedName& name : result.names) {
    for (const HX_Finding& finding : name.findings)
      std::cerr << name.item->id << ": " << HX_FindingAsLine(finding);
  }
  for (const HX_Finding& finding : result.findings)
    std::cerr << HX_FindingAsLine(finding);
}

int explainName(const Arguments& arguments, HX_Profile& profile) {
  const HX_Document document = readDocument(arguments, profile);
  HX_Generator generator(document, profile.start() / arguments.keywords,
                         profile);
  const HX_RunResult& result =
      generator.run(HX_Generator::eAsInDocument, progressOf(arguments));
  if (result.names.empty() && result.hasErrors()) {
    writeFindings(result);  // a cycle among the types: no names were formed
    return kErrorsFound;
  }
  const HX_FormedName* name = generator.find(arguments.name);
  if (name == nullptr)
    document.root().at("names").fail("a name with the id \"" + arguments.name +
                                     "\"");
  std::cout << HX_ExplanationAsText(*name, generator.explain(*name));
  return exitCodeOf(result);
}

void flushOutput() {
  if (!std::cout.flush())
    throw HX_OutputError("standard output: cannot be written");
}

int generateCode(const Arguments& arguments, HX_Profile& profile) {
  const HX_Document document = readDocument(arguments, profile);
  HX_Generator generator(document, profile.start() / arguments.keywords,
                         profile);
  HX_RunResult& result =
      generator.run(HX_Generator::eById, progressOf(arguments));
  HX_Output output(profile.start() / arguments.out);
  std::size_t changed = 0;
  if (!result.hasErrors()) {
    const HX_Profile::Phase phase(profile, "Write C");
    for (const auto& [name, text] :
         HX_CWriter(generator.model(), result).files())
      output.open(name) << text;
    HX_WriteNamesAsJson(output.open("name_map.json"), result);
    HX_WriteNamesAsCsv(output.open("name_map.csv"), result);
    changed = output.finish();
  }
  writeFindings(result);
  if (result.hasErrors()) return kErrorsFound;
  if (arguments.json) {
    HX_WriteNamesAsJson(std::cout, result);
  } else if (!arguments.quiet) {
    std::cout << result.names.size() << " names, " << result.variables.size()
              << " variables; " << changed << " files written to "
              << arguments.out << '\n';
  }
  flushOutput();  // without a reader no file changes
  output.commit();
  return kDone;
}

int synthesize(const Arguments& arguments, HX_Profile&) {
  std::cout << HX_Synthesize(arguments.blocks, arguments.seed);
  return kDone;
}

using Command = int (*)(const Arguments&, HX_Profile&);

CLI::App* addModelCommand(CLI::App& app, Arguments& arguments, const char* name,
                          const char* description) {
  CLI::App* command = app.add_subcommand(name, description);
  command->add_option("MODEL.json", arguments.model, "the model document")
      ->required();
  command->add_option("--keywords", arguments.keywords,
                      "folder of the word lists that the document names");
  command->add_option("--profile", arguments.profile,
                      "folder for reports on what took how long");
  command->add_flag("--quiet", arguments.quiet, "no progress, no summary");
  return command;
}

// A write that fails shall come back as an error, and no file that is opened
// shall become the standard output of a program that was started without one.
void prepareProcess() {
  std::signal(SIGPIPE, SIG_IGN);
  std::signal(SIGXFSZ, SIG_IGN);
  int file = 0;
  while (file >= 0 && file <= STDERR_FILENO) file = open("/dev/null", O_RDONLY);
  close(file);
}

int run(int argc, char** argv) {
  CLI::App app("Forms the names of a model and writes its C code.",
               "hx_codegen");
  app.footer(kFooter);
  app.require_subcommand(1);
  app.set_version_flag("--version", HX_VersionText());
  Arguments arguments;
  Command command = nullptr;

  CLI::App* names =
      addModelCommand(app, arguments, "names", "print a table of all names");
  names->add_flag("--json", arguments.json, "print JSON instead");
  names->callback([&] { command = showNames; });

  CLI::App* explain = addModelCommand(app, arguments, "explain",
                                      "show macro by macro how a name came");
  explain->add_option("--name", arguments.name, "the id of the name")
      ->required();
  explain->callback([&] { command = explainName; });

  CLI::App* generate =
      addModelCommand(app, arguments, "generate", "write C code and name map");
  generate->add_option("--out", arguments.out, "folder for the files")
      ->required();
  generate->add_flag("--json", arguments.json, "print the name map as well");
  generate->callback([&] { command = generateCode; });

  CLI::App* synthesis = app.add_subcommand(
      "synthesize", "print a document of any size, for trying scale");
  synthesis->add_option("--blocks", arguments.blocks, "number of blocks")
      ->check(CLI::Range(0, 10'000'000));
  synthesis->add_option("--seed", arguments.seed, "of the random numbers");
  synthesis->callback([&] { command = synthesize; });

  int code = kDone;
  try {
    app.parse(argc, argv);
    HX_Profile profile(arguments.profile);
    code = command(arguments, profile);
    profile.finish();
  } catch (const CLI::ParseError& error) {
    code = app.exit(error) == 0 ? kDone : kRefused;
  }
  flushOutput();
  return code;
}

}  // namespace

int main(int argc, char** argv) {
  prepareProcess();
  try {
    return run(argc, argv);
  } catch (const std::exception& error) {
    std::cerr << "hx_codegen: " << error.what() << '\n';
  } catch (...) {
    std::cerr << "hx_codegen: unknown failure\n";
  }
  return kRefused;
}
