// The model of a document, built from the platform's stand-ins.
//
//   HX_Document document("cruise_control.json", folder);
//   const HX_Model model(document, {"data/keywords"});
//   for (const HX_WantedName& name : model.names) form(name);
//
// The library sees the model that lives: options, model names, data type server
// and data dictionary belong to the process.

#ifndef HOST_MODEL_HX_MODEL_H
#define HOST_MODEL_HX_MODEL_H

#include <deque>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "SourceRef/HxCDdSrcRef.h"
#include "host/base/HX_Progress.h"
#include "host/model/HX_SourcePaths.h"
#include "host/model/HX_Types.h"
#include "host/model/HX_WantedName.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_Options.h"
#include "platform/model/SC_Chart.h"
#include "platform/model/SC_State.h"

struct HX_Document;

/// Items that depend on themselves; empty for none.
struct HX_Circle {
  std::vector<std::size_t> items;  // in the document; each uses the next
  HX_TokenEnd end = 0;             // of the first item
  std::string place;               // "FILE:LINE:COLUMN: POINTER"

  /// The first circle stays.
  void enter(const std::vector<std::size_t>& circle, HX_TokenEnd token) {
    if (!items.empty()) return;
    items = circle;
    end = token;
  }
};

/// Characters that count; see HX_SafeNames::setSignificance().
struct HX_Significance {
  int internal = 0;
  int external = 0;
  bool ignoresCase = false;
};

/// Reserved words and patterns beside those of a document.
struct HX_ReservedChoice {
  std::vector<std::string> lists;     ///< file names without ".txt"
  std::vector<std::string> patterns;  ///< names of HX_ReservedNames
};

/// Owns all items of the document, in document order.
struct HX_Model {
  /// Throws HX_DocumentError with the faults of the document, of a word list,
  /// or of a word list that no folder of \p keywordFolders has. The words of
  /// lists of the same name in several folders count together. Throws
  /// HX_InputError for a missing list of \p more.
  HX_Model(HX_Document& document,
           const std::vector<std::string>& keywordFolders,
           HX_Progress& progress, const HX_ReservedChoice& more = {});
  HX_Model(const HX_Model&) = delete;
  HX_Model& operator=(const HX_Model&) = delete;
  ~HX_Model();

  std::string name;
  std::set<std::string> words;  // of the word lists, and words of every C
  std::set<std::string> libraryWords;  // main, and names of the C library
  unsigned int patterns = 0;           // HX_ReservedNames::HxEPatternTag
  HX_Significance significance;
  HX_CodeOptions code;
  std::deque<HX_TypeItem> types;
  std::deque<HX_ScopeItem> scopes;  // parents first
  HX_ScopeItem* fileScope = nullptr;
  std::deque<HX_WantedName> names;
  HX_Circle typeCircle;
  HX_Circle variableCircle;

  // Seen through the library.
  HX_OptionsExt options;
  HX_DataTypeServer typeServer;
  std::vector<std::unique_ptr<HX_Block>> blocks;
  std::deque<SC_Chart> charts;
  std::deque<SC_State> chartObjects;
  std::deque<HxCDdSrcRef> ddRefs;
  HX_SourcePaths paths;

  /// The template of the text, made if it is new.
  const HX_Template* enterTemplate(std::string_view text);
  /// The text of the naming rule, kept once.
  const std::string* enterRule(std::string_view text);

 private:
  std::unordered_map<std::string, HX_Template> m_Templates;
  std::set<std::string> m_Rules;
};

#endif  // HOST_MODEL_HX_MODEL_H
