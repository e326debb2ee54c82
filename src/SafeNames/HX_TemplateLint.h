// What a name template tells without a model.
//
//   HX_TemplateLint lint;
//   lint.read("str$B_$Q:speed");
//   lint.macroCount();              // 2
//   lint.macro(1).message;          // 1203: the engine does not know $Q
//   lint.mayChange();               // false: the actual name has no $R
//   lint.alwaysMatching(HX_ReservedNames::ePatternStr, true);

#ifndef SAFENAMES_HX_TEMPLATELINT_H
#define SAFENAMES_HX_TEMPLATELINT_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "Naming/HX_MacroTable.h"
#include "platform/strings/KyCXString.h"

/// Not copied. Reports no message. The order of texts is that of the template.
class HX_UTILS_API HX_TemplateLint : public HX_Allocated {
 public:
  /// A macro in a template.
  struct Macro {
    const HX_Macro* row = nullptr;  ///< null for an unknown macro
    KyCXString text;                ///< "$B", "$(Task)", "$E(speed)"
    int position = 0;               ///< of the '$' in the template
    bool isFormal = false;          ///< in the first of two parts
    /// Message of createNameFromForm() about the macro, unless an earlier stage
    /// has replaced the macro: 0 for none, 1202 or 1203.
    int message = 0;
  };

  HX_TemplateLint();
  HX_TemplateLint(const HX_TemplateLint&) = delete;
  HX_TemplateLint& operator=(const HX_TemplateLint&) = delete;
  ~HX_TemplateLint();

  /// Reads \p form in place of the template before.
  /// RETURNS: false, with an empty template, without memory.
  bool read(const KyCXString& form);

  /// Macros of both parts.
  int macroCount() const;
  /// REQUIRES: \p index in [0, macroCount()).
  const Macro& macro(int index) const;

  /// The parts between ':'. More than two parts: the first two count.
  int partCount() const { return m_PartCount; }

  /// Whether a "$(" has no ')': the engine copies the rest as text.
  bool isUnclosed() const { return m_IsUnclosed; }

  /// Whether every result may be shortened and made distinct. Templates of one
  /// part always may; of two parts the actual one needs $R, or $S of a block,
  /// or $C of a chart object.
  bool mayChange() const { return m_MayChange; }

  /// Longest actual name that the template can give; -1 if a macro has no
  /// longest value. Names and texts of a model have none.
  int longest() const { return m_Longest; }
  /// The characters of the actual name that are no values of macros.
  int fixedLength() const { return m_FixedLength; }

  /// The patterns of \p patterns (HX_ReservedNames::HxEPatternTag) that every
  /// actual name of the template matches, whatever the values of macros are.
  unsigned int alwaysMatching(unsigned int patterns, bool isAtFileScope) const;

 private:
  struct Content;

  Content* m_pContent;  // owned; null without memory
  int m_PartCount = 1;
  int m_FixedLength = 0;
  int m_Longest = 0;
  bool m_IsUnclosed = false;
  bool m_MayChange = true;
};

#endif  // SAFENAMES_HX_TEMPLATELINT_H
