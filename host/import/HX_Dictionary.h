// Data dictionaries (.sldd): enumerations, buses, parameters, signals, aliases.

#ifndef HOST_IMPORT_HX_DICTIONARY_H
#define HOST_IMPORT_HX_DICTIONARY_H

#include <filesystem>
#include <map>
#include <pugixml.hpp>
#include <string>
#include <string_view>
#include <vector>

#include "host/import/HX_ImportError.h"

class HX_Notes;

/// A field of a bus or a constant of an enumeration.
struct HX_DictionaryMember {
  std::string name;
  std::string type;        ///< of a field
  std::string dimensions;  ///< of a field
  std::string value;       ///< of a constant
};

struct HX_DictionaryEntry {
  enum Kind { eEnumeration, eBus, eParameter, eSignal, eAlias, eOther };

  Kind kind;
  std::string name;
  std::string dictionary;   ///< the file name without folder and ending
  std::string type;         ///< of a parameter, a signal, or behind an alias
  std::string value;        ///< of a parameter
  bool isPrefixed = false;  ///< constants carry the name of the enumeration
  std::vector<HX_DictionaryMember> members;
};

class HX_Dictionary {
 public:
  using Entries = std::map<std::string, HX_DictionaryEntry, std::less<>>;

  HX_Dictionary(const HX_ImportLimits& limits, HX_Notes& notes)
      : m_Limits(limits), m_Notes(notes) {}

  /// Adds the entries of a file. An entry of an earlier file stays, with a
  /// warning. Throws HX_ImportError.
  void read(const std::filesystem::path& file);

  /// RETURNS: the entry with this name and kind; null for none.
  const HX_DictionaryEntry* find(std::string_view name,
                                 HX_DictionaryEntry::Kind kind) const;

  const Entries& entries() const { return m_Entries; }

 private:
  void readEntry(pugi::xml_node object, const std::string& dictionary);

  const HX_ImportLimits& m_Limits;
  HX_Notes& m_Notes;
  Entries m_Entries;
};

#endif  // HOST_IMPORT_HX_DICTIONARY_H
