#include "host/messages/HX_MessageTable.h"

#include <algorithm>
#include <iterator>

#include "Control/ERR_Catalogue.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

// Ascending by number.
constexpr HX_MessageRow kRows[] = {
    {kHxBadCommandLine, 2, "{}; see hx_codegen --help",
     "The command line has an unknown word, lacks an argument, or has a value "
     "outside the range of an option.",
     "Compare the word with the output of \"hx_codegen COMMAND --help\"."},
    {kHxUnknownNumber, 2, "no message has the number {}",
     "Neither the program nor the library has a message of this number.",
     "Take the number that stands behind the severity or in the brackets."},
    {kHxUnknownName, 2, "{}: /names: found no id {}, expected the id of a name",
     "The option --name asks for an id that the list \"names\" of the document "
     "does not have.",
     "Take an id of the first column of \"hx_codegen names\"."},
    {kHxUnknownComponent, 2, "{}: found no component {}, expected one of: {}",
     "The option --component takes the path of an outermost subsystem, or '.' "
     "for everything outside the subsystems.",
     "Take a path of the list. \"hx_codegen components MODEL\" prints all."},
    {kHxUnreadable, 2, "{}",
     "A file of the command line is absent, is a folder, or may not be read.",
     "Correct the path, or the rights of the file."},
    {kHxUnwritable, 2, "{}",
     "The disk is full, a folder is read-only, or the reader of a pipe has "
     "ended. Files of the output folder are as before.",
     "Make room or give rights, then repeat the command."},
    {kHxOutOfMemory, 2, "out of memory",
     "The document needs more memory than the process may have.",
     "Raise the limit (ulimit -v), or split the model."},
    {kHxSystemFailure, 2, "{}", "The operating system refused a call.",
     "The text names the file or the call; correct its rights or limits."},
    {kHxBadSyntax, 2, "found {}, expected {}",
     "The document is not JSON in UTF-8 (RFC 8259) at this place.",
     "Correct the text at line and column."},
    {kHxBadContent, 2, "found {}, expected {}",
     "A value does not fit the schema of documents, or contradicts another "
     "value.",
     "Give the expected value. The schema is model.schema.json, installed "
     "with the program."},
    {kHxUnknownId, 2, "found {}, expected {}",
     "An item refers to an id that no item of the document has.",
     "Correct the id, or add the item."},
    {kHxTakenId, 2, "found {}, expected {}", "Two items have the same id.",
     "Give a new id to the second item."},
    {kHxReservedType, 2, "found {}, expected {}",
     "The name of a type, field or enumeration constant is a reserved word. "
     "Such names are given, not formed: the program does not change them.",
     "Rename the type, field or constant in the model."},
    {kHxBadWordList, 2, "found {}, expected {}",
     "A word list has a line that is no C name, or no word.",
     "Write a C name on each line; '#' begins a comment."},
    {kHxBadLock, 2, "{}",
     "The lock file was damaged or merged with conflicts: lines twice, "
     "conflict markers, lines out of order.",
     "Take the file of one side and generate again."},
    {kHxMoreFaults, 2, "{}",
     "The document has further faults; the first 20 are shown.",
     "Correct the faults that are shown, then run again."},
    {kHxEmptyName, 2, "The name is empty: nothing is defined.",
     "All macros of the template are empty for this item.",
     "Add literal text to the template, or a macro with a value."},
    {kHxTooLong, 1,
     "The name is longer than {} characters, and its template does not let it "
     "change ($R).",
     "The option limitNames asks for short names. Only a template with $R, or "
     "without a second part, lets a name change.",
     "Add $R to the template, or shorten the template."},
    {kHxTaken, 2,
     "The name '{}' is {}, and its template does not let it change ($R).",
     "Two items want the same name, or the name is reserved, and the template "
     "of the later item fixes the name.",
     "Add $R to the template, or a macro that tells the items apart."},
    {kHxMacrosInMacros, 2,
     "The values of macros hold macros: the name is longer than {} characters.",
     "Values of substituted macros contain further macros, which grow without "
     "end.",
     "Take the '$' out of the values under \"substitute\"."},
    {kHxManyParts, 1,
     "The name template has more than two parts; the first two count.",
     "A template has a formal and an actual part, separated by ':'.",
     "Remove the further ':'."},
    {kHxNotInLock, 2, "The lock has another name or none: {} {}",
     "The lock file has no name for the item, or a name of another wanted "
     "form, and the run may not change the lock.",
     "Run \"hx_codegen generate MODEL --lock FILE\" for the whole model."},
    {kHxSaturated, 1,
     "The initial value {} of {} does not fit the type {}; the nearest value "
     "that fits is used.",
     "The physical value, divided by the resolution, lies outside the range of "
     "the type.",
     "Correct the initial value, the resolution (lsb) or the type."},
    {kHxOutdated, 2, "would change",
     "The file is absent or differs from the file that this model gives.",
     "Run \"hx_codegen generate\" with the same options."},
    {kHxImportRefused, 2, "{}",
     "A model file, a data dictionary or the naming rules cannot be read.",
     "The text names file, part and place. Save the model anew with the tool "
     "that made it, or correct the rules."},
    {kHxImportWarning, 1, "{}",
     "The import left something out or took something in its place.",
     "Give the missing file with --path or --dictionary, or correct the "
     "model."},
    {kHxImportNote, 0, "{}",
     "The import chose something that rules can change.",
     "Nothing has to be done; a naming rule makes the choice explicit."},
};

constexpr bool isAscending() {
  for (std::size_t i = 1; i < std::size(kRows); ++i)
    if (kRows[i - 1].number >= kRows[i].number) return false;
  return true;
}
static_assert(isAscending());

// By row of the library's catalogue.
constexpr HX_LibraryHelp kLibrary[] = {
    {2, "A phase of the run has ended.", "Nothing has to be done."},
    {7,
     "A check of the library on its own data failed: a fault of the library.",
     "Keep the model and report the number to the makers."},
    {90, "A file of a report cannot be made.",
     "Make the folder writable, or choose another folder."},
    {403,
     "Types or variables depend on themselves through the items of the "
     "list.",
     "Break the circle: remove one reference between the listed items."},
    {408,
     "The name is a keyword of C or a word of a chosen word list, and its "
     "template fixes it.",
     "Rename the item, or add $R to the template."},
    {409, "The name is the name of a base type, and its template fixes it.",
     "Rename the item, or add $R to the template."},
    {410, "The name is the name of a data type, and its template fixes it.",
     "Rename the item or the type, or add $R to the template."},
    {503, "The name template of the item has no character.",
     "Give the item a template."},
    {1202,
     "The macro belongs to another kind of name, or the item has no such "
     "value here.",
     "Remove the macro; the page of macros tells where each is allowed."},
    {1203, "The language of templates has no such macro.",
     "Correct the letter or the word behind '$'."},
    {1204, "A task would contain its own name.",
     "Remove $(Task) from the template of the task."},
    {1205, "A task without a period has no time to speak of.",
     "Remove the time macro, or make the task cyclic."},
    {1206, "The time is no whole number of the chosen time base.",
     "Take a finer time base, for example us in place of ms."},
    {1207, "The time is no whole number of nanoseconds.",
     "Round the period or the offset of the task."},
    {1209, "No software component is related to the data dictionary object.",
     "Relate the object to a component, or remove the macro."},
    {1210, "The object is related to two software components.",
     "Remove one of the two relations."},
    {1272, "Note about the state of the library.", "Nothing has to be done."},
    {1273, "The library found its own data in doubt.",
     "Keep the model and report the text to the makers."},
    {1274, "The library found its own data wrong.",
     "Keep the model and report the text to the makers."},
    {1275, "The library cannot go on.",
     "Keep the model and report the text to the makers."},
    {1292, "The library found its own data in doubt.",
     "Keep the model and report the text to the makers."},
};

// A message without cause and cure would leave a user alone.
constexpr bool areAllExplained() {
  std::size_t index = 0;
  for (const ERR_CatalogueRow& row : kErrCatalogue)
    if (index == std::size(kLibrary) || kLibrary[index++].row != row.number)
      return false;
  return index == std::size(kLibrary);
}
static_assert(areAllExplained());

// No number of the program is a row or an id of the library.
constexpr bool areNumbersDistinct() {
  for (const ERR_CatalogueRow& row : kErrCatalogue)
    for (const HX_MessageRow& own : kRows)
      if (own.number == row.number || own.number == row.id) return false;
  return true;
}
static_assert(areNumbersDistinct());

}  // namespace

const HX_MessageRow* HX_FindMessage(int number) {
  const auto found = std::lower_bound(
      std::begin(kRows), std::end(kRows), number,
      [](const HX_MessageRow& row, int wanted) { return row.number < wanted; });
  return found != std::end(kRows) && found->number == number ? &*found
                                                             : nullptr;
}

std::string HX_MessageText(HX_MessageNumber number,
                           std::initializer_list<std::string_view> arguments) {
  std::string_view format = HX_FindMessage(number)->text;
  std::string text;
  for (const std::string_view argument : arguments) {
    const std::size_t place = format.find("{}");
    text.append(format.substr(0, place)).append(argument);
    format.remove_prefix(place + 2);
  }
  return text.append(format);
}

HX_MessageFacts HX_FactsOf(int number) {
  if (const HX_MessageRow* row = HX_FindMessage(number))
    return {row->severity, row->text, row->cause, row->cure};
  std::size_t index = 0;
  for (const ERR_CatalogueRow& row : kErrCatalogue) {
    if (row.number == number || row.id == number)
      return {row.severity, row.text, kLibrary[index].cause,
              kLibrary[index].cure};
    ++index;
  }
  return {};
}

std::string HX_MessageHelp(int number) {
  const HX_MessageFacts facts = HX_FactsOf(number);
  if (facts.cause.empty()) return {};
  int shown = number;
  for (const ERR_CatalogueRow& row : kErrCatalogue)
    if (row.number == number) shown = row.id;
  return std::to_string(shown) + "  " +
         HX_MessageHandler::severityName(facts.severity) + "\n\ntext   " +
         facts.text + "\ncause  " + facts.cause + "\ncure   " + facts.cure +
         "\n";
}

std::string HX_AllMessageHelp() {
  std::string all;
  for (const HX_MessageRow& row : kRows)
    all += (all.empty() ? "" : "\n") + HX_MessageHelp(row.number);
  for (const ERR_CatalogueRow& row : kErrCatalogue)
    all += "\n" + HX_MessageHelp(row.number);
  return all;
}
