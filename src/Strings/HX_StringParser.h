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
/// A result may be the same object as an argument. Without memory results keep
/// their texts and a returned text is empty.
class HX_UTILS_API HX_StringParser : public HX_Allocated {
 public:
  /// Ends of a text to remove characters from.
  enum remove_etp : int {
    eRemoveLeading = 0,
    eRemoveTrailing = 1,
    eRemoveBoth = 2
  };

  HX_StringParser() = default;

  /// Reads pairs such as "Name = Foo ; SIZE=3" for a list of known \p keys.
  ///
  /// Keys match without regard to case and to blanks around; values lose the
  /// blanks around and keep their case. Of equal keys in \p keys the last key
  /// receives the value; of equal keys in \p str the last value counts. An
  /// item without \p keyValueSep or with an unknown key is not recognised. An
  /// empty separator counts as a separator that does not occur.
  /// \param[out] values  one slot per key; the slot of a key that does not
  ///   occur keeps its text, a new slot is empty
  /// RETURNS: the last item, or the key of the last pair, that was not
  ///   recognised, in lower case and without white space around (a key: without
  ///   blanks around). Empty if every item was recognised and for a pair
  ///   without a key. An item of white space alone does not count.
  KyCXString parseKeyValuePairs(const KyCXString& str,
                                const KyCXString& keyValueSep,
                                const KyCXString& pairSep,
                                const leda::array<KyCXString>& keys,
                                leda::array<KyCXString>& values) const;

  /// RETURNS: \p str without the characters of \p chars at the chosen ends;
  ///   unchanged for a \p mode outside the enumeration.
  KyCXString removeChars(const KyCXString& str, const KyCXString& chars,
                         remove_etp mode) const;

  /// Separates the sections between the keywords from the rest.
  ///
  /// "x[[abc]]y" gives "abc" and "xy". Sections are joined without anything
  /// between, and so are the pieces of the rest; the keywords appear in neither
  /// text. The search ignores case. Without an end keyword a section reaches to
  /// the end of the text. An empty keyword counts as a keyword that does not
  /// occur.
  void divideKeywordEmbeddedString(const KyCXString& str,
                                   const KyCXString& startKeyword,
                                   const KyCXString& endKeyword,
                                   KyCXString& embedded,
                                   KyCXString& outside) const;

  /// Describes an object that a user script put into the data dictionary.
  ///
  /// ".../CGTmpData/hxscript_Controller/3/Gain_Var" gives "User script object
  /// Gain_Var of block Controller"; the middle part may be missing, and the
  /// object may hold slashes. Any other path is copied unchanged, also a path
  /// without a slash after the block; case matters.
  void processDDPath(const KyCXString& path, KyCXString& text) const;
};

#endif  // STRINGS_HX_STRINGPARSER_H
