// hx_codegen: from a model document to names and C code.
#include <CLI/CLI.hpp>
#include <algorithm>
#include <charconv>
#include <cstdint>
#include <iostream>
#include <map>
#include <new>

#include "Control/HxCUtilsControl.h"
#include "LedaIntegerSupport.h"
#include "Math/FPS_FloatingPointSupport.h"
#include "SafeNames/HX_ReservedNames.h"
#include "host/base/HX_Faults.h"
#include "host/base/HX_Output.h"
#include "host/base/HX_ResponseFile.h"
#include "host/base/HX_System.h"
#include "host/base/HX_Text.h"
#include "host/import/HX_ImportError.h"
#include "host/program/HX_Commands.h"
#include "host/program/HX_ImportCommands.h"
#include "host/program/HX_Version.h"
#include "host/write/HX_DiagnosticLog.h"
#include "host/write/HX_NameColumns.h"

namespace {

constexpr char kFooter[] =
    "Examples:\n"
    "  hx_codegen names model.json\n"
    "  hx_codegen explain model.json --name set_speed\n"
    "  hx_codegen generate model.json --out code --profile profile\n"
    "  hx_codegen generate model.json --out code --lock names.lock\n"
    "  hx_codegen diff old.lock names.lock --format sed\n"
    "  hx_codegen lint '$S_$B' 'str$B' --pattern str\n"
    "  hx_codegen names model.slx --dictionary types.sldd\n"
    "  hx_codegen import model.slx > model.json\n"
    "  hx_codegen report model.json --out report.html\n"
    "  hx_codegen synthesize --blocks 10000 --seed 7 > large.json\n"
    "\n"
    "Exit codes:\n"
    "  0  done; warnings at most\n"
    "  1  done, but a message was an error; no code is written\n"
    "  2  refused: the command line or the document is wrong, or something\n"
    "     cannot be read or written; the output folder is as it was";

// CLI11 reads negative numbers as unsigned numbers.
const CLI::Validator isSeed(
    [](std::string& text) -> std::string {
      std::uint64_t seed = 0;
      const char* end = text.data() + text.size();
      const auto read = std::from_chars(text.data(), end, seed);
      if (read.ec == std::errc() && read.ptr == end) return {};
      return "Value " + text + " not in range [0 - 18446744073709551615]";
    },
    "SEED");

const std::map<std::string, HX_DiagnosticLog::HxEFormatTag> kFormats = {
    {"text", HX_DiagnosticLog::eText},
    {"json", HX_DiagnosticLog::eJson},
    {"sarif", HX_DiagnosticLog::eSarif}};

using Command = HX_ExitCode (*)(const HX_Arguments&);

/// The command line and the chosen command.
struct CommandLine {
  /// Options about messages go to \p log.
  explicit CommandLine(HX_DiagnosticLog& log);

  CLI::App* add(const char* name, const char* description, Command chosen);
  CLI::App* addOverModel(const char* name, const char* description,
                         Command chosen);
  void addPatterns(CLI::App& added);
  void addImportOptions(CLI::App& added);
  void addBuildOptions(CLI::App& added);
  void addMessageOptions(CLI::App& added);

  CLI::App app{"Forms the names of a model and writes its C code.",
               "hx_codegen"};
  HX_Arguments arguments;
  Command command = nullptr;
};

CLI::App* CommandLine::add(const char* name, const char* description,
                           Command chosen) {
  CLI::App* added = app.add_subcommand(name, description);
  added->callback([this, chosen] { command = chosen; });
  addMessageOptions(*added);
  return added;
}

CLI::App* CommandLine::addOverModel(const char* name, const char* description,
                                    Command chosen) {
  CLI::App* added = add(name, description, chosen);
  added
      ->add_option("MODEL", arguments.model,
                   "the model document, or a model file (.slx)")
      ->required();
  added->add_option("--lock", arguments.lock, "file of the names to keep");
  added->add_option("--profile", arguments.profile,
                    "folder for reports on what took how long");
  added
      ->add_option("--reserved", arguments.reserved,
                   "word list beside those of the document; may be repeated")
      ->allow_extra_args(false);
  addPatterns(*added);
  addImportOptions(*added);
  return added;
}

void CommandLine::addMessageOptions(CLI::App& added) {
  HX_DiagnosticLog& log = *arguments.log;
  added
      .add_option_function<std::string>(
          "--diagnostics",
          [&log](const std::string& form) { log.format = kFormats.at(form); },
          "form of the messages on the error output")
      ->check(CLI::IsMember({"text", "json", "sarif"}));
  added.add_flag("--werror", log.warningsAreErrors, "warnings are errors");
  added
      .add_option("--silence", log.silenced,
                  "numbers of warnings and notes to leave out, with ','")
      ->delimiter(',')
      ->allow_extra_args(false);
}

void CommandLine::addPatterns(CLI::App& added) {
  const auto check = [](const std::string& name) {
    return HX_ReservedNames::patternOf(name.c_str()) != 0
               ? std::string()
               : "unknown pattern " + name;
  };
  added
      .add_option("--pattern", arguments.patterns,
                  "reserved pattern that names must not match; may be "
                  "repeated")
      ->allow_extra_args(false)
      ->check(CLI::Validator(check, ""));
}

void CommandLine::addBuildOptions(CLI::App& added) {
  added.add_option("--out", arguments.out, "folder for the files");
  CLI::Option* lock = added.get_option("--lock");
  added
      .add_flag("--locked", arguments.locked,
                "refuse new and changed names, change no lock")
      ->needs(lock);
  added
      .add_option("--retire", arguments.retireRuns,
                  "runs after which names of items that went are free "
                  "(0: never)")
      ->check(CLI::Range(0, 1'000'000))
      ->needs(lock);
  CLI::Option* whole = added.add_flag("--by-component", arguments.byComponent,
                                      "a folder with files for each component");
  added
      .add_option("--component", arguments.component,
                  "path of the one component to write; '.' for what lies "
                  "outside the components")
      ->needs(lock)
      ->excludes(whole);
}

void CommandLine::addImportOptions(CLI::App& added) {
  added.add_option("--rules", arguments.rules,
                   "file of naming rules, for a model file");
  const auto addList = [&](const char* name, std::vector<std::string>& list,
                           const char* description) {
    added.add_option(name, list, description)->allow_extra_args(false);
  };
  addList("--dictionary", arguments.dictionaries,
          "data dictionary (.sldd); may be repeated");
  addList("--path", arguments.searchPath,
          "folder of referenced models and libraries; may be repeated");
  addList("--keywords", arguments.ownKeywords,
          "folder of further word lists; may be repeated");
  added.add_flag("--quiet", arguments.quiet, "no progress, notes, summary");
}

CommandLine::CommandLine(HX_DiagnosticLog& log) {
  arguments.log = &log;
  app.footer(kFooter);
  app.require_subcommand(1);
  app.set_version_flag("--version", HX_VersionText());
  arguments.keywords = HX_ProgramFolder() / HX_DATA_FOLDER / "keywords";

  CLI::App* names =
      addOverModel("names", "print a table of all names", HX_ShowNames);
  names->add_flag("--json", arguments.json, "print the name map instead");
  names->add_flag("--lines", arguments.lines,
                  "print the name map with a JSON document per line");
  const CLI::IsMember isColumn(HX_NameColumns());
  names->add_option("--columns", arguments.columns, "columns, with ','")
      ->delimiter(',')
      ->allow_extra_args(false)
      ->check(isColumn);
  names->add_option("--sort", arguments.sort, "column to sort by")
      ->check(isColumn);
  names
      ->add_option("--filter", arguments.filters,
                   "COLUMN=PATTERN or COLUMN!=PATTERN with '*', or a text of "
                   "any column; may be repeated")
      ->allow_extra_args(false)
      ->check(CLI::Validator(HX_CheckFilter, ""));

  CLI::App* explain = addOverModel(
      "explain", "show macro by macro how a name came", HX_ExplainName);
  explain->add_option("--name", arguments.name, "the id of the name")
      ->required();
  explain->add_flag("--json", arguments.json, "print JSON instead");

  CLI::App* generate =
      addOverModel("generate", "write C code and name map", HX_GenerateCode);
  addBuildOptions(*generate);
  generate->get_option("--out")->required();
  generate->add_flag("--json", arguments.json, "print the name map as well");
  generate->add_flag("--lines", arguments.lines,
                     "write name_map.jsonl, a JSON document per line, in place "
                     "of name_map.json");
  generate->add_flag("--list-outputs", arguments.listOutputs,
                     "print the paths of the files, write nothing");
  generate->add_option("--depfile", arguments.depfile,
                       "file for make: which files the code depends on");
  generate
      ->add_option("--depfile-target", arguments.depfileTarget,
                   "what depends, in place of the files of the code")
      ->needs(generate->get_option("--depfile"));

  CLI::App* check = addOverModel(
      "check", "do all but writing; 1 if there are errors", HX_CheckModel);
  addBuildOptions(*check);
  check
      ->add_flag("--up-to-date", arguments.upToDate,
                 "1 also if a file would change")
      ->needs(check->get_option("--out"));
  addOverModel("components", "print path and file name of each component",
               HX_ListComponents);

  CLI::App* lock = app.add_subcommand("lock", "work on a lock file");
  lock->require_subcommand(1);
  CLI::App* prune = lock->add_subcommand(
      "prune", "free the names of items that went, and former names");
  prune->callback([this] { command = HX_PruneLock; });
  addMessageOptions(*prune);
  prune->add_option("LOCK", arguments.lock, "the lock file")->required();

  CLI::App* compare = add(
      "diff", "compare names: documents, locks or name maps", HX_CompareNames);
  compare->add_option("OLD", arguments.older, "the names before")->required();
  compare->add_option("NEW", arguments.model, "the names now")->required();
  compare->add_option("--format", arguments.format, "table, json or sed")
      ->check(CLI::IsMember({"table", "json", "sed"}));
  compare
      ->add_option("--keywords", arguments.ownKeywords,
                   "folder of further word lists; may be repeated")
      ->allow_extra_args(false);

  CLI::App* lint =
      add("lint", "check name templates without a model", HX_LintTemplates);
  lint->add_option("TEMPLATE", arguments.templates, "templates to check");
  lint->add_option("--rules", arguments.rules, "file of naming rules");
  addPatterns(*lint);
  lint->add_flag("--json", arguments.json, "print JSON instead");

  CLI::App* import = add("import", "print a model file as a model document",
                         HX_ImportModelFile);
  import->add_option("MODEL.slx", arguments.model, "the model file")
      ->required();
  addImportOptions(*import);
  add("rules", "print the built-in naming rules", HX_PrintRules)
      ->add_flag("--schema", arguments.schema, "print the schema of rules");
  CLI::App* report =
      addOverModel("report", "write a page with names, model, types and times",
                   HX_ReportNames);
  report
      ->add_option("--out", arguments.out, "the file, for example report.html")
      ->required();
  report->add_option(
      "--since", arguments.older,
      "document, lock or name map to mark renamed names against");

  add("help", "print text, cause and cure of a message", HX_HelpMessage)
      ->add_option("NUMBER", arguments.number,
                   "the number of the message; without it all are printed")
      ->check(CLI::PositiveNumber);

  CLI::App* synthesis =
      add("synthesize", "print a document of any size, for trying scale",
          HX_SynthesizeDocument);
  synthesis->add_option("--blocks", arguments.blocks, "number of blocks")
      ->check(CLI::Range(0, 10'000'000));
  synthesis->add_option("--seed", arguments.seed, "of the random numbers")
      ->check(isSeed);
}

// A line with the wrong word.
std::string textOf(CLI::App& app, const CLI::ParseError& error) {
  std::string what = error.what();
  const std::vector<std::string> unread = app.remaining(true);
  if (app.get_subcommands().empty() && !unread.empty())
    what = "no command " + HX_Quoted(unread.front());
  constexpr std::size_t kMost = 300;
  if (what.size() > kMost) what = what.substr(0, kMost) + "...";
  return HX_MessageText(kHxBadCommandLine, {HX_Visible(what)});
}

// The form of the messages about a wrong command line.
void findFormat(int argc, char** argv, HX_DiagnosticLog& log) {
  const std::string option = "--diagnostics";
  for (int i = 1; i < argc; ++i) {
    const std::string word = argv[i];
    std::string value;
    if (word == option && i + 1 < argc) value = argv[i + 1];
    if (word.starts_with(option + "=")) value = word.substr(option.size() + 1);
    if (kFormats.count(value) > 0) log.format = kFormats.at(value);
  }
}

int run(int argc, char** argv, HX_DiagnosticLog& log) {
  CommandLine line(log);
  int code = kHxDone;
  try {
    std::vector<std::string> words = HX_ExpandArguments(argc, argv);
    std::reverse(words.begin(), words.end());
    line.app.parse(std::move(words));
    log.model = line.arguments.model;
    code = line.command(line.arguments);
  } catch (const CLI::Success& help) {
    line.app.exit(help);
  } catch (const CLI::ParseError& error) {
    findFormat(argc, argv, log);
    log.add({kHxBadCommandLine, 2, textOf(line.app, error), "", ""});
    return kHxRefused;
  }
  HX_FlushOutput();
  return code;
}

// Failures end as messages.
int runWithLog(int argc, char** argv, HX_DiagnosticLog& log) {
  const auto add = [&log](HX_MessageNumber number,
                          const std::exception& error) {
    log.add({number, 2, error.what(), "", ""});
  };
  try {
    return run(argc, argv, log);
  } catch (const std::bad_alloc&) {
    throw;
  } catch (const HX_DocumentError& error) {
    for (const HX_Diagnostic& fault : error.faults) log.add(fault);
  } catch (const HX_InputError& error) {
    add(error.number, error);
  } catch (const HX_OutputError& error) {
    add(kHxUnwritable, error);
  } catch (const HX_ImportError& error) {
    add(kHxImportRefused, error);
  } catch (const std::exception& error) {
    add(kHxSystemFailure, error);
  }
  return kHxRefused;
}

/// The library, booted while alive. Servers in use are booted by their users.
struct Library {
  Library() {
    control.boot();
    ModInit_FPS_FloatingPointSupport();
    LedaIntegerSupportBoot();
  }
  Library(const Library&) = delete;
  Library& operator=(const Library&) = delete;
  ~Library() { control.shutdown(); }

  HxCUtilsControl control;
};

int refuseMemory() {
  HX_WriteError("hx_codegen: out of memory [203]\n");
  return kHxRefused;
}

}  // namespace

int main(int argc, char** argv) {
  try {
    HX_PrepareProcess();
    if (!HX_KeepMemoryBack()) return refuseMemory();
    const Library library;
    HX_DiagnosticLog log;
    const int code = runWithLog(argc, argv, log);
    log.write(std::cerr, code, HX_ErrorTerminal());
    return code;
  } catch (const std::bad_alloc&) {
    return refuseMemory();
  } catch (const std::exception& error) {
    std::cerr << "hx_codegen: " << error.what() << '\n';
  }
  return kHxRefused;
}
