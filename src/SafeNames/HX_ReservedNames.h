// Words and patterns that generated names must not use.
//
// A profile is a list of words with a name: the keywords of an edition of C,
// the functions of a library, POSIX, the words of a project.
// The installed profiles lie in share/hx_utils/keywords (data/keywords in the
// tree). Reading a further profile adds words and removes none.
//
//   HX_ReservedNames reserved;
//   HX_TextFaults faults;
//   if (!reserved.readFile("c11", "keywords/c11.txt", faults)) ...
//   reserved.setPatterns(HX_ReservedNames::ePatternStr);
//   reserved.find("inline", false).profile;   // "c11"
//   reserved.find("strong", false).pattern;   // ePatternStr
//
// A word list is a text file with a C identifier per line: blanks around it do
// not count, '#' starts a comment, empty lines are left out. Lines may end in
// "\r\n", and the file may start with a byte order mark.

#ifndef SAFENAMES_HX_RESERVEDNAMES_H
#define SAFENAMES_HX_RESERVEDNAMES_H

#include <cstddef>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "SafeNames/HX_TextFaults.h"
#include "platform/strings/KyCXString.h"

/// Not copied. Independent of the keyword dictionary of HxCNames. Reports no
/// message.
class HX_UTILS_API HX_ReservedNames : public HX_Allocated {
 public:
  /// Patterns of ISO/IEC 9899:2011, 7.1.3 and 7.31, and of C++. All can be on
  /// or off.
  enum HxEPatternTag : unsigned int {
    ePatternUnderscoreCapital = 0x1,  ///< '_' and a capital: "_Bool"
    ePatternFirstUnderscores = 0x2,   ///< "__" in front
    ePatternUnderscores = 0x4,        ///< "__" anywhere (C++)
    ePatternFileUnderscore = 0x8,     ///< '_' in front, at file scope only
    ePatternStr = 0x10,               ///< "str" and a lower case letter
    ePatternMem = 0x20,               ///< "mem" and a lower case letter
    ePatternWcs = 0x40,               ///< "wcs" and a lower case letter
    ePatternIs = 0x80,                ///< "is" and a lower case letter
    ePatternTo = 0x100,               ///< "to" and a lower case letter
    ePatternErrno = 0x200,            ///< 'E' and a capital or a digit
    ePatternSignal = 0x400,           ///< "SIG" in front
    ePatternLocale = 0x800,           ///< "LC_" in front
    ePatternType = 0x1000,            ///< "_t" at the end (POSIX)
    ePatternAll = 0x1FFF
  };

  /// The answer of find(). At most one member is not zero.
  struct Reservation {
    const char* profile = nullptr;  ///< the first profile that has the word
    unsigned int pattern = 0;       ///< the first chosen pattern that matches
    /// Whether the name is reserved.
    explicit operator bool() const { return profile != nullptr || pattern; }
  };

  /// No word, no pattern.
  HX_ReservedNames();
  HX_ReservedNames(const HX_ReservedNames&) = delete;
  HX_ReservedNames& operator=(const HX_ReservedNames&) = delete;
  ~HX_ReservedNames();

  /// Adds the words of a list of \p length bytes to profile \p profile. A known
  /// word keeps the old profile.
  /// RETURNS: false, with no word added, if a line is no identifier or memory
  /// runs out; \p faults then has the lines.
  bool readText(const char* profile, const char* text, std::size_t length,
                HX_TextFaults& faults);

  /// The same with the content of a file. A missing file, a folder and
  /// an unreadable file are faults of line 0.
  bool readFile(const char* profile, const char* path, HX_TextFaults& faults);

  /// The number of different words.
  int wordCount() const;
  /// Word and profile in the order of addition.
  /// REQUIRES: \p index in [0, wordCount()).
  const char* word(int index) const;
  const char* profileOf(int index) const;

  /// Switches the patterns of the set \p patterns on and the rest off.
  void setPatterns(unsigned int patterns) { m_Patterns = patterns; }
  /// The patterns that are on.
  unsigned int patterns() const { return m_Patterns; }

  /// Whether \p name is a word of a profile or matches a pattern.
  /// \param isAtFileScope  whether ePatternFileUnderscore applies
  /// RETURNS: words before patterns. OWNERSHIP: the profile's name belongs to
  /// this object.
  Reservation find(const KyCXString& name, bool isAtFileScope) const;

  /// The first pattern of \p patterns that \p name matches; 0 for none.
  static unsigned int matching(const KyCXString& name, unsigned int patterns,
                               bool isAtFileScope);

  /// Names of patterns for options and messages: "underscore-capital", "str",
  /// "_t". RETURNS: null for a number that is no single pattern.
  static const char* patternName(unsigned int pattern);
  /// The pattern of that name; 0 for an unknown name.
  static unsigned int patternOf(const char* name);

 private:
  struct Words;

  Words* m_pWords;  // owned; null without memory
  unsigned int m_Patterns = 0;
};

#endif  // SAFENAMES_HX_RESERVEDNAMES_H
