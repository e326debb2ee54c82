// Text of a report while the report is being built. The memory comes from the
// memory controller while a controller is installed.
//
//   HX_ReportText text = "calls ";
//   hx_detail::appendNumber(text, 12);   // "calls 12", in every locale

#ifndef DIAGNOSTICS_IMPLDIAGNOSTICS_HX_REPORTTEXT_H
#define DIAGNOSTICS_IMPLDIAGNOSTICS_HX_REPORTTEXT_H

#include <cstdint>
#include <string>

#include "Control/HX_Memory.h"
#include "implContainers/HX_Number.h"

/// Appending throws std::bad_alloc without memory: see HX_WithinMemory().
using HX_ReportText = std::basic_string<char, std::char_traits<char>,
                                        HX_ControllerAllocator<char>>;

namespace hx_detail {

/// Appends the decimal digits of \p number, with '-' in front if negative.
inline void appendNumber(HX_ReportText& text, std::int64_t number) {
  char digits[21];  // of -2^63
  text.append(digits, HX_WriteInt(digits, sizeof digits, number));
}

}  // namespace hx_detail

#endif  // DIAGNOSTICS_IMPLDIAGNOSTICS_HX_REPORTTEXT_H
