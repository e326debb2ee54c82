// Text operations for option strings and data dictionary paths.
//
//   leda::array<KyCXString> keys{"name", "size"};
//   leda::array<KyCXString> values;
//   HX_StringParser().parseKeyValuePairs("Name = Foo ; SIZE=3", "=", ";", keys,
//                                        values);
//   // values: "Foo", "3"

#ifndef STRINGS_HX_STRINGPARSER_H
#define STRINGS_HX_STRINGPARSER_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/containers/array.h"
#include "platform/strings/KyCXString.h"

/// Holds no data. No operation reports a message. Letter case is that of ASCII.
class HX_UTILS_API HX_StringParser : public HX_Allocated {
 public:
  /// At which ends to remove.
  enum remove_etp : int {
    eRemoveLeading = 0,
    eRemoveTrailing = 1,
    eRemoveBoth = 2
  };

  HX_StringParser() = default;

  /// Reads pairs such as "Name = Foo ; SIZE=3" for a list of known \p keys.
  ///
  /// An item without \p keyValueSep, and one whose key is not known, is not
  /// recognised. Keys match without regard to case and to blanks around them;
  /// values lose the blanks around them and keep their case. Of equal keys in
  /// \p keys the last one receives the value; of equal keys in \p str the last
  /// value counts. An empty separator counts as one that does not occur.
  /// \param[out] values  one slot per key; the slot of a key that does not
  ///   occur keeps what it held, and is empty if it is new. No other argument
  ///   may be one of its texts.
  /// \return the last item (or, of a pair, its key) that was not recognised, in
  ///   lower case and without surrounding white space (a key: blanks); empty
  ///   if there was none or if it was a pair without a key. An item that is all
  ///   white space does not count.
  KyCXString parseKeyValuePairs(const KyCXString& str,
                                const KyCXString& keyValueSep,
                                const KyCXString& pairSep,
                                const leda::array<KyCXString>& keys,
                                leda::array<KyCXString>& values) const;

  /// \p str without the characters of \p chars at the chosen ends; a \p mode
  /// that is not in the enumeration removes nothing.
  KyCXString removeChars(const KyCXString& str, const KyCXString& chars,
                         remove_etp mode) const;

  /// Separates the sections between the keywords from the rest.
  ///
  /// "x[[abc]]y" gives "abc" and "xy". Several sections are joined without
  /// anything between them, and so is the rest; the keywords appear in neither.
  /// The search ignores case. Without an end keyword the section reaches to the
  /// end of the text. An empty keyword counts as one that does not occur.
  /// \param[out] embedded, outside  may be \p str itself
  void divideKeywordEmbeddedString(const KyCXString& str,
                                   const KyCXString& startKeyword,
                                   const KyCXString& endKeyword,
                                   KyCXString& embedded,
                                   KyCXString& outside) const;

  /// Describes an object that a user script put into the data dictionary.
  ///
  /// ".../CGTmpData/hxscript_Controller/3/Gain_Var" gives "User script object
  /// Gain_Var of block Controller"; the middle part may be missing, and what
  /// follows it may hold slashes. Any other path is copied as it is, also one
  /// without a slash after the block; case matters.
  /// \param[out] text  may be \p path itself
  void processDDPath(const KyCXString& path, KyCXString& text) const;
};

#endif  // STRINGS_HX_STRINGPARSER_H
