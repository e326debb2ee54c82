#include "host/model/HX_Model.h"

#include <filesystem>

#include "SafeNames/HX_ReservedNames.h"
#include "host/model/HX_Document.h"
#include "host/model/HX_ModelReading.h"
#include "host/model/HX_WordList.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/model/HxCGlobal.h"

namespace {

using Reading = HX_ModelReading;
using Value = HX_BoundValue;

// A list of the user adds to the installed list of the same name.
// RETURNS: false if no folder has the list, or a list cannot be read.
bool readWords(const std::vector<std::string>& folders, std::string_view list,
               std::set<std::string>& words) {
  bool isFound = false;
  for (const std::string& folder : folders) {
    const std::string file = folder + "/" + std::string(list) + ".txt";
    std::error_code error;
    if (!std::filesystem::exists(file, error)) continue;
    isFound = HX_ReadWordList(file, words);
    if (!isFound) break;
  }
  return isFound;
}

void readWordList(Reading& r, const Value& value) {
  if (!readWords(r.keywordFolders, value.text, r.model.words))
    r.faults.add(
        value.place, HX_Quoted(value.text),
        "the name of a word list in " + HX_Visible(r.keywordFolders.back()));
}

// Words that a compiler of some edition refuses: the same code compiles as C90
// to C23, with GNU extensions, and its headers as C++.
constexpr const char* kLanguageLists[] = {"c99", "c11", "c23", "cpp20",
                                          "gnu_c"};
constexpr const char* kLibraryLists[] = {"main", "std_c90", "std_c99",
                                         "std_c11", "std_c23"};

void readInstalledList(const std::vector<std::string>& folders,
                       const std::string& list, std::set<std::string>& words) {
  for (const std::string& folder : folders)
    if (HX_ReadWordList(folder + "/" + list + ".txt", words)) return;
  throw HX_InputError(HX_Visible(folders.front()) + "/" + list +
                      ".txt: cannot be read: expected a word list");
}

constexpr HX_FieldBinding kBindings[] = {
    {"$schema", [](Reading&, const Value&) {}},
    {"model.name",
     [](Reading& r, const Value& v) {
       r.model.name = v.text;
       GLB_SetModelName(v.nameText());
     }},
    {"model.subsystem",
     [](Reading&, const Value& v) { GLB_SetSubsystemName(v.nameText()); }},
    {"model.systemId",
     [](Reading& r, const Value& v) {
       r.model.options.setHxSystemID(v.nameText());
     }},
    {"options.limitNames",
     [](Reading& r, const Value& v) {
       r.model.options.setLimitVariableNameLength(v.boolean);
     }},
    {"options.keywords", readWordList},
    {"options.patterns",
     [](Reading& r, const Value& v) {
       r.model.patterns |=
           HX_ReservedNames::patternOf(std::string(v.text).c_str());
     }},
    {"options.significant.internal",
     [](Reading& r, const Value& v) {
       r.model.significance.internal = v.integer();
     }},
    {"options.significant.external",
     [](Reading& r, const Value& v) {
       r.model.significance.external = v.integer();
     }},
    {"options.code.stdint",
     [](Reading& r, const Value& v) { r.model.code.usesStdint = v.boolean; }},
    {"options.code.checkWidths",
     [](Reading& r, const Value& v) { r.model.code.checksWidths = v.boolean; }},
    {"options.code.banner",
     [](Reading& r, const Value& v) { r.model.code.hasBanner = v.boolean; }},
    {"options.code.comments",
     [](Reading& r, const Value& v) {
       if (!r.model.code.comments) r.model.code.comments.emplace();
       r.model.code.comments->insert(HX_ValueOf(kHxCommentParts, v.text));
     }},
    {"options.significant.ignoreCase",
     [](Reading& r, const Value& v) {
       r.model.significance.ignoresCase = v.boolean;
     }},
};

}  // namespace

int HX_Ids::find(const HX_Use& use) {
  if (!use.isGiven()) return -1;
  const int item = HX_IdTable::item(use.entry);
  if (item < 0)
    ++m_Unknown.try_emplace(use.entry, Unknown{use.place, 0})
          .first->second.uses;
  return item;
}

void HX_Ids::report(HX_Faults& faults) const {
  if (!isWhole) return;
  for (const auto& [entry, unknown] : m_Unknown) {
    std::string found = HX_Quoted(text(entry));
    if (unknown.uses > 1)
      found += " (" + std::to_string(unknown.uses) + " uses)";
    faults.add(unknown.first, found, std::string("the id of ") + what(),
               kHxUnknownId);
  }
}

void HX_ModelReading::define(HX_Ids& ids, const HX_Use& id, std::size_t item) {
  if (!id.isGiven() || ids.define(id.entry, static_cast<int>(item))) return;
  faults.add(id.place, HX_Quoted(ids.text(id.entry)) + " again",
             "an id that is not taken yet", kHxTakenId);
}

HX_Bindings HX_OptionBindings() { return {kBindings, std::size(kBindings)}; }

HX_Model::HX_Model(HX_Document& document,
                   const std::vector<std::string>& keywordFolders,
                   HX_Progress& progress, const HX_ReservedChoice& more) {
  HxCGlobal::setOptions(&options);
  HxCGlobal::setDataTypeServer(&typeServer);
  HX_DdTree::instance().clear();
  GLB_SetModelName("");
  GLB_SetSubsystemName("");
  for (const char* list : kLanguageLists)
    readInstalledList(keywordFolders, list, words);
  for (const char* list : kLibraryLists)
    readInstalledList(keywordFolders, list, libraryWords);
  HX_ModelReading reading(*this, document.faults, keywordFolders);
  if (HX_ReadDocument(document, reading, progress)) {
    progress.begin("building the model");
    // Headers that the code then includes define macros.
    if (code.usesStdint || code.checksWidths)
      readInstalledList(keywordFolders, "std_macros", words);
    if (names.empty() && document.faults.count() > 0)
      reading.nameIds.isWhole = false;
    HX_ResolveSources(reading);
    HX_ResolveTypes(reading);
    for (std::size_t i = 0; i < names.size(); ++i)
      reading.define(reading.nameIds, reading.names[i].id, i);
    HX_ResolveScopes(reading);
    HX_ResolveNames(reading);
    for (const HX_Ids* ids : {&reading.sources.ids, &reading.typeIds,
                              &reading.scopeIds, &reading.nameIds})
      ids->report(document.faults);
  }
  progress.end();
  document.throwIfFaulty();
  for (const std::string& list : more.lists)
    if (!readWords(keywordFolders, list, words))
      throw HX_InputError("found no word list " + HX_Quoted(list) + " in " +
                          HX_Visible(keywordFolders.back()));
  for (const std::string& pattern : more.patterns)
    patterns |= HX_ReservedNames::patternOf(pattern.c_str());
  for (HX_Circle* circle : {&typeCircle, &variableCircle}) {
    if (!circle->items.empty()) circle->place = document.placeText(circle->end);
  }
}

HX_Model::~HX_Model() {
  HxCGlobal::setOptions(nullptr);
  HxCGlobal::setDataTypeServer(nullptr);
  HX_DdTree::instance().clear();
}

const std::string* HX_Model::enterRule(std::string_view text) {
  return &*m_Rules.emplace(text).first;
}

const HX_Template* HX_Model::enterTemplate(std::string_view text) {
  const auto [found, isNew] = m_Templates.try_emplace(std::string(text));
  if (isNew) found->second = {HX_NameText(text), &found->first};
  return &found->second;
}
