// hx_codegen: from a model document to names and C code.
#include <fcntl.h>
#include <unistd.h>

#include <CLI/CLI.hpp>
#include <csignal>
#include <iostream>

#include "host/model/HX_Document.h"
#include "host/model/HX_Synthesis.h"
#include "host/program/HX_Generator.h"
#include "host/program/HX_Version.h"

namespace {

enum ExitCode { kDone = 0, kErrorsFound = 1, kRefused = 2 };

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
    "  2  refused: the command line or the document is wrong, or something\n"
    "     cannot be read or written; the output folder is as it was";

// Installed or in the build tree, the data lie in the same place beside the
// program.
std::string keywordFolder() {
  const auto program = std::filesystem::read_symlink("/proc/self/exe");
  return program.parent_path() / HX_DATA_FOLDER / "keywords";
}

struct Arguments {
  std::string model;
  std::string name;
  std::string keywords = keywordFolder();
  std::string out;
  std::string profile;
  bool json = false;
  bool quiet = false;
  int blocks = 1000;
  std::uint64_t seed = 1;
};

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

void flushOutput() {
  if (!std::cout.flush())
    throw HX_OutputError("standard output: cannot be written");
}

void showNames(const Arguments& arguments, HX_Generator& generator) {
  const HX_Profile::Phase phase(generator.profile, "Print");
  if (arguments.json)
    HX_WriteJson(std::cout, generator.result);
  else
    HX_WriteTable(std::cout, generator.result);
}

void explainName(const Arguments& arguments, HX_Generator& generator) {
  if (!generator.nameRun)  // a cycle among the types: no names were formed
    return HX_WriteFindings(std::cerr, generator.result);
  for (const HX_Name* name : generator.result.names) {
    if (name->id == arguments.name)
      return HX_WriteExplanation(std::cout, *name,
                                 generator.nameRun->explain(*name));
  }
  throw HX_DocumentError(arguments.model +
                         ": /names: expected a name with the id \"" +
                         arguments.name + "\"");
}

void generateCode(const Arguments& arguments, HX_Generator& generator) {
  const HX_RunResult& result = generator.result;
  if (result.hasErrors()) return HX_WriteFindings(std::cerr, result);
  HX_Output output(generator.profile.start / arguments.out);
  const std::size_t changed = generator.write(output);
  HX_WriteFindings(std::cerr, result);
  if (arguments.json)
    HX_WriteJson(std::cout, result);
  else if (!arguments.quiet)
    std::cout << result.names.size() << " names, " << result.variables.size()
              << " variables; " << changed << " files written to "
              << arguments.out << '\n';
  // If the rest cannot be written, no file of the code changes.
  generator.profile.finish();
  flushOutput();
  output.commit();
}

using Command = void (*)(const Arguments&, HX_Generator&);

ExitCode runOverModel(const Arguments& arguments, Command command) {
  HX_Profile profile(arguments.profile);
  HX_Generator generator(profile, arguments.model, arguments.keywords);
  generator.run(progressOf(arguments));
  command(arguments, generator);
  profile.finish();
  return generator.result.hasErrors() ? kErrorsFound : kDone;
}

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

int run(int argc, char** argv) {
  CLI::App app("Forms the names of a model and writes its C code.",
               "hx_codegen");
  app.footer(kFooter);
  app.require_subcommand(1);
  app.set_version_flag("--version", HX_VersionText());
  Arguments arguments;
  ExitCode code = kDone;

  CLI::App* names =
      addModelCommand(app, arguments, "names", "print a table of all names");
  names->add_flag("--json", arguments.json, "print JSON instead");
  names->callback([&] { code = runOverModel(arguments, showNames); });

  CLI::App* explain = addModelCommand(app, arguments, "explain",
                                      "show macro by macro how a name came");
  explain->add_option("--name", arguments.name, "the id of the name")
      ->required();
  explain->callback([&] { code = runOverModel(arguments, explainName); });

  CLI::App* generate =
      addModelCommand(app, arguments, "generate", "write C code and name map");
  generate->add_option("--out", arguments.out, "folder for the files")
      ->required();
  generate->add_flag("--json", arguments.json, "print the name map as well");
  generate->callback([&] { code = runOverModel(arguments, generateCode); });

  CLI::App* synthesis = app.add_subcommand(
      "synthesize", "print a document of any size, for trying scale");
  synthesis->add_option("--blocks", arguments.blocks, "number of blocks")
      ->check(CLI::Range(0, 10'000'000));
  synthesis->add_option("--seed", arguments.seed, "of the random numbers");
  synthesis->callback(
      [&] { std::cout << HX_Synthesize(arguments.blocks, arguments.seed); });

  try {
    app.parse(argc, argv);
  } catch (const CLI::ParseError& error) {
    code = app.exit(error) == 0 ? kDone : kRefused;
  }
  flushOutput();
  return code;
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

}  // namespace

int main(int argc, char** argv) {
  try {
    prepareProcess();
    return run(argc, argv);
  } catch (const std::exception& error) {
    std::cerr << "hx_codegen: " << error.what() << '\n';
  } catch (...) {
    std::cerr << "hx_codegen: unknown failure\n";
  }
  return kRefused;
}
