// The words that generated names must not be.
//
//   HX_Keywords keywords;
//   keywords.loadList("host/keywords", "c99");
//   keywords.isReserved("inline");   // "keyword"

#ifndef HOST_HX_KEYWORDS_H
#define HOST_HX_KEYWORDS_H

#include <map>
#include <string>

#include "Naming/HxCNames.h"

/// Boots the keyword dictionary of the library and enters every word there; it
/// lives as long as this object.
///
/// The library reports a word that is used as a name; a name that may be
/// changed is better changed, without a report. For that the host asks here
/// first.
class HX_Keywords {
 public:
  HX_Keywords();
  ~HX_Keywords();
  HX_Keywords(const HX_Keywords&) = delete;
  HX_Keywords& operator=(const HX_Keywords&) = delete;

  /// Enters the words of <folder>/<list>.txt: one on a line, lines that begin
  /// with '#' are comments.
  /// \return false if there is no such file
  bool loadList(const std::string& folder, const std::string& list);

  void add(const std::string& word, HxCNames::tagHxEDictEntryType type);

  /// "keyword", "base type name" or "type name"; null for a free name.
  const char* isReserved(const std::string& name) const;

  const std::map<std::string, HxCNames::tagHxEDictEntryType>& words() const {
    return m_Words;
  }

 private:
  std::map<std::string, HxCNames::tagHxEDictEntryType> m_Words;
  HxCNames m_Names;
};

#endif  // HOST_HX_KEYWORDS_H
