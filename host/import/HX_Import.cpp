#include "host/import/HX_Import.h"

#include <fstream>

#include "host/import/HX_Dictionary.h"
#include "host/import/HX_Literals.h"
#include "host/import/HX_ModelDocument.h"
#include "host/import/HX_ModelFile.h"
#include "host/import/HX_ModelTree.h"
#include "host/import/HX_NameItems.h"
#include "host/import/HX_Notes.h"
#include "host/import/HX_PartText.h"
#include "host/import/HX_References.h"
#include "host/import/HX_Rules.h"
#include "host/import/HX_TypeTable.h"

namespace fs = std::filesystem;

namespace {

bool readWords(const fs::path& file, HX_TypeTable::Reserved& words) {
  std::ifstream stream(file);
  for (std::string line; std::getline(stream, line);) {
    const std::string_view text = line;
    const std::string_view word = HX_Trimmed(text.substr(0, text.find('#')));
    if (!word.empty()) words.emplace(word);
  }
  return stream.is_open();
}

HX_TypeTable::Reserved reservedWords(const HX_ImportRequest& request,
                                     const HX_Rules& rules) {
  std::vector<std::string> lists = rules.keywords;
  lists.push_back("c90");
  HX_TypeTable::Reserved words;
  for (const std::string& list : lists) {
    bool isRead = false;
    for (const fs::path& folder : request.keywordFolders)
      isRead = readWords(folder / (list + ".txt"), words) || isRead;
    if (!isRead)
      throw HX_ImportError("the word list '" + list +
                           "' of the naming rules is in no folder");
  }
  return words;
}

// The dictionary of the model comes first, then the dictionaries of the
// request.
void readDictionaries(const HX_ImportRequest& request, const HX_ModelFile& file,
                      const HX_References& references,
                      HX_Dictionary& dictionary, HX_Notes& notes) {
  const std::string own = HX_OneLine(file.dictionary());
  const fs::path path = references.pathOf(own);
  if (!path.empty()) dictionary.read(path);
  bool isGiven = own.empty() || !path.empty();
  for (const fs::path& given : request.dictionaries) {
    isGiven = isGiven || given.filename() == own;
    std::error_code ignored;
    if (path.empty() || !fs::equivalent(path, given, ignored))
      dictionary.read(given);
  }
  if (!isGiven)
    notes.add("warning",
              "the data dictionary '" + own +
                  "' was found neither beside the model nor on --path",
              "");
}

}  // namespace

HX_Import HX_ImportModel(const HX_ImportRequest& request) {
  HX_Notes notes;
  const HX_Rules rules =
      request.rules.empty() ? HX_Rules() : HX_Rules(request.rules);
  std::vector<fs::path> folders = {request.model.parent_path()};
  folders.insert(folders.end(), request.searchPath.begin(),
                 request.searchPath.end());
  HX_References references(folders, request.limits);
  const HX_ModelFile file(request.model, request.limits);
  HX_Dictionary dictionary(request.limits, notes);
  readDictionaries(request, file, references, dictionary, notes);
  const HX_ModelTree tree(file, references, request.limits, notes);

  const HX_TypeTable::Reserved reserved = reservedWords(request, rules);
  HX_TypeTable types(rules, dictionary, reserved, notes);
  HX_NameItems items(rules, dictionary, types, notes);
  items.collect(tree.root());
  types.addDictionary();
  return {HX_WriteModelDocument({tree.root(), rules, dictionary, types, items}),
          notes.lines()};
}

bool HX_IsModelFile(const fs::path& file) {
  return file.extension() == ".slx" || file.extension() == ".mdl";
}
