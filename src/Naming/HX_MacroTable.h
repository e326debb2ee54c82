// Table of all macros of name templates, for engines, hosts and linters.
//
//   for (const HX_Macro& macro : HX_Macros())
//     std::printf("%s  %s\n", macro.text, macro.meaning);
//
//   const HX_Macro* macro = HX_FindMacro("Sa_$(Period10ms)", 3);
//   macro->placeholder;   // "__Period10ms_"
//   macro->stage;         // HX_Macro::eStageMultirate

#ifndef NAMING_HX_MACROTABLE_H
#define NAMING_HX_MACROTABLE_H

#include <span>

#include "HX_Export.h"
#include "platform/strings/KyCXString.h"

/// Row of the table. All texts are constants of the library.
struct HX_Macro {
  /// Operation that puts in the value. Stages run in this order.
  enum HxEStageTag : int {
    eStageCaller = 0,     ///< HxCNames::substAllDollarZByValue() by the caller
    eStageMultirate = 1,  ///< the operations HxCNames::replaceMultirate...()
    eStageTemplate = 2,   ///< HxCNames::createNameFromForm()
    eStageSymbol = 3      ///< HxCNames::handleSymbolNameMacro()
  };

  /// Object that the value comes from.
  enum HxEOriginTag : int {
    eOriginNone = 0,      ///< a constant, or a text given with the name
    eOriginModel = 1,     ///< model or subsystem under generation
    eOriginSource = 2,    ///< source reference or intermediate-view block
    eOriginDdObject = 3,  ///< data dictionary object
    eOriginType = 4,      ///< data type
    eOriginTask = 5,      ///< task or interrupt service routine
    eOriginSymbol = 6     ///< symbol of the symbol table
  };

  /// The macro as written in a template: "$B", "$(Task)".
  const char* text;
  /// Bit in the macro bit sets of HxCNames; 0 for a macro without a bit.
  unsigned int bit;
  HxEStageTag stage;
  HxEOriginTag origin;
  /// Message of createNameFromForm() about the macro: 0 for macros of the
  /// template stage, 1202 (not supported here) or 1203 (unknown).
  int message;
  /// Text that createNameFromForm() writes without a value: a placeholder
  /// ("_B"), nothing, or the macro itself for a later stage.
  const char* placeholder;
  /// Meaning of the value, without an article: "block name".
  const char* meaning;
  /// One value, for documents and messages.
  const char* example;
};

/// All macros: letters of the template stage by bit, other letters, extended
/// macros. Each text stands in exactly one row.
HX_UTILS_API std::span<const HX_Macro> HX_Macros();

/// RETURNS: the macro that begins at \p position of \p form; null for literal
/// text, an unknown macro, or a position outside \p form. The argument of "$E"
/// is no part of the macro.
HX_UTILS_API const HX_Macro* HX_FindMacro(const KyCXString& form,
                                          int position = 0);

#endif  // NAMING_HX_MACROTABLE_H
