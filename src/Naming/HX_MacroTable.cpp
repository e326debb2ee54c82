// Lookup in the macro table: no macro text is the beginning of another text.

#include "Naming/HX_MacroTable.h"

#include "Naming/HX_MacroRows.h"

std::span<const HX_Macro> HX_Macros() { return hx_macros::kTable; }

const HX_Macro* HX_FindMacro(const KyCXString& form, int position) {
  if (form[position] != '$') return nullptr;
  for (const HX_Macro& row : hx_macros::kTable) {
    int length = 1;
    while (row.text[length] != 0 &&
           form[position + length] ==
               static_cast<unsigned char>(row.text[length]))
      ++length;
    if (row.text[length] == 0) return &row;
  }
  return nullptr;
}
