// What became of a wanted name, and the results of a run.

#ifndef HOST_NAMES_HX_FORMEDNAME_H
#define HOST_NAMES_HX_FORMEDNAME_H

#include <cstdint>
#include <deque>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "host/model/HX_SourcePaths.h"
#include "host/model/HX_WantedName.h"
#include "host/names/HX_Findings.h"

/// Why a name differs from the expanded template.
struct HX_Change {
  enum HxEReasonTag {
    eNone,  ///< no change
    eMadeIdentifier,
    eShortened,
    eKeyword,   ///< also a word of a word list
    eBaseType,  ///< the name of a base type
    eType,      ///< the name of any other type
    eTakenByConstant,
    eTakenByName,
    ePattern,     ///< matches a chosen pattern; detail is the pattern
    eRewritten,   ///< changed so that no chosen pattern matches
    eIndistinct,  ///< agrees with another name early; detail is the name
    eHeld,        ///< the lock holds the name for the item in detail
    eRetired,     ///< the lock keeps the name of the item in detail
    eLocked,      ///< name of the lock
    eNoVariant,   ///< every variant is taken
    eLibrary,     ///< function or object of the C library
    eMacro        ///< macro that the generated code defines
  };

  HxEReasonTag reason = eNone;
  const HX_WantedName* owner = nullptr;  // for eTakenByName
  std::string detail = {};

  /// A word for programs, for example "takenByName".
  const char* kind() const;

  /// Empty for eNone. \return for example "shortened", "taken by m/Pedal/Gain
  /// ('gain')"
  std::string text() const;
};

/// Where a name is declared in the generated code.
struct HX_CodePlace {
  enum HxEFileTag { eNone, eHeader, eSource };
  HxEFileTag file = eNone;
  int line = 0;  // from 1
};

struct HX_FormedName {
  explicit HX_FormedName(const HX_WantedName& name) : wanted(&name) {}

  const HX_WantedName* wanted;
  KyCXString actual;
  bool isComplete = false;
  bool isDefined = false;     // stands in a scope and may be written into code
  mutable HX_CodePlace code;  // entered by the writer of the code
  std::vector<HX_Change> changes;
  std::vector<HX_Finding> findings;

  /// RETURNS: the path of the best source; empty without a source.
  std::string sourcePath() const;

  const KyCXString& formal() const {
    return m_OtherFormal != nullptr ? *m_OtherFormal : actual;
  }
  /// The name before the search for a free name.
  const KyCXString& wantedText() const {
    return m_OtherWanted != nullptr ? *m_OtherWanted : actual;
  }
  /// REQUIRES: `actual` has its final value, as below.
  void setWantedText(const KyCXString& text) {
    if (!(text == actual))
      m_OtherWanted = std::make_unique<const KyCXString>(text);
  }
  void setFormal(const KyCXString& formal) {
    if (!(formal == actual))
      m_OtherFormal = std::make_unique<const KyCXString>(formal);
  }

 private:
  // Null if equal to actual.
  std::unique_ptr<const KyCXString> m_OtherFormal;
  std::unique_ptr<const KyCXString> m_OtherWanted;
};

/// The first eight bytes of a text as a number: where the numbers differ, texts
/// have the order of the numbers. Sorting by numbers first reads less memory.
inline std::uint64_t HX_PrefixOf(std::string_view text) {
  std::uint64_t prefix = 0;
  for (std::size_t i = 0; i < 8; ++i)
    prefix = prefix << 8 |
             (i < text.size() ? static_cast<unsigned char>(text[i]) : 0U);
  return prefix;
}

/// The texts of \p name.changes in their order.
std::string HX_JoinedChanges(const HX_FormedName& name, const char* separator);

/// RETURNS: the last block of the sources, else the last dictionary object,
/// else the last other source; null without a source.
const HxCSrcRef* HX_BestSource(const HX_WantedName& name);

struct HX_RunResult {
  std::vector<const HX_TypeItem*> types;  // in the order of definition
  std::deque<HX_FormedName> formed;
  std::vector<const HX_FormedName*> names;      // in the order of the report
  std::vector<const HX_FormedName*> variables;  // in the order of definition
  std::vector<HX_Finding> findings;             // about no single name
  std::string codeFile;  // of a component, without extension; else empty

  /// Whether any finding is an error.
  bool hasErrors() const;
};

#endif  // HOST_NAMES_HX_FORMEDNAME_H
