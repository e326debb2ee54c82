#include "FLAG.h"

#include <string>

#include "Control/ERR_Messages.h"
#include "Control/HX_ExportInline.h"
#include "Control/HX_Memory.h"
#include "Control/HX_SelfCheck.h"
#include "Math/IMS_Log2.h"
#include "Strings/STR_StringSupport.h"
#include "platform/memory/HxCMemController.h"

namespace {

constexpr char kFlagErrorCode[] = __FILE__ "_";
constexpr char kReportHead[] = "Flag conflict found ! Flag ";

using Text = std::basic_string<char, std::char_traits<char>,
                               HX_ControllerAllocator<char>>;

// The row of flag; -1, after the assertion, if the table has none.
int rowOfFlag(unsigned int flag, int rowCount) {
  const int row = IMS_Log2(flag);
  return HX_Assert(row < rowCount, kFlagErrorCode) ? row : -1;
}

const char* nameOf(const FLAG_flag_info& row) {
  return STR_IsNullOrEmpty(row.flagName) ? "<unknown flag name>" : row.flagName;
}

struct Conflict {
  int row;             // rowOfFlag()
  unsigned int flags;  // conflicting flags of the field; 0 without a row
};

Conflict findConflict(unsigned int field, unsigned int flag, int rowCount,
                      const FLAG_flag_info* rows) {
  const int row = rowOfFlag(flag, rowCount);
  return {row, row < 0 ? 0 : field & rows[row].excludedFlags};
}

Text describe(const Conflict& conflict, int rowCount,
              const FLAG_flag_info* rows, const char* suffix) {
  Text report = kReportHead;
  report += nameOf(rows[conflict.row]);
  report += " excludes flag(s): ";
  for (unsigned int conflicts = conflict.flags; conflicts != 0;
       conflicts &= conflicts - 1) {
    const int other = rowOfFlag(FLAG_GetIthFlag(conflicts, 1), rowCount);
    if (other < 0) continue;
    report += nameOf(rows[other]);
    report += ' ';
  }
  report += suffix;
  return report;
}

// Reports a conflict, by the head of the text alone if memory runs out.
// clear: called between the forming of the text and the report.
template <class Clear>
void report(const Conflict& conflict, int rowCount, const FLAG_flag_info* rows,
            const char* suffix, Clear clear) {
  if (conflict.flags == 0) return;
  const Text text = HX_WithinMemory(
      Text(), [&] { return describe(conflict, rowCount, rows, suffix); });
  clear();
  ERR_Msg1292(text.empty() ? kReportHead : text.c_str());
}

}  // namespace

template struct HX_ExportInline<
    &FLAG_ClearAll, &FLAG_ClearFlag, &FLAG_SetFlag, &FLAG_GetFlag,
    &FLAG_GetFlags, &FLAG_GetAllFlagsFromFlagField, &FLAG_GetNumberOfFlags,
    &FLAG_GetNumberOfFlagsInField, &FLAG_GetIthFlag, &FLAG_GetIthFlagInField,
    &FLAG_CompareFlagfields>;

void hx_detail::failClearAll() { HX_Assert(false, kFlagErrorCode); }
void hx_detail::failClearFlag() { HX_Assert(false, kFlagErrorCode); }
void hx_detail::failSetFlag() { HX_Assert(false, kFlagErrorCode); }
void hx_detail::failGetFlag() { HX_Assert(false, kFlagErrorCode); }
void hx_detail::failGetFlags() { HX_Assert(false, kFlagErrorCode); }
void hx_detail::failGetAllFlags() { HX_Assert(false, kFlagErrorCode); }

unsigned int* FLAG_NewField() {
  auto* field =
      static_cast<unsigned int*>(pHXMemory->allocMemBlock(sizeof(unsigned)));
  FLAG_ClearAll(field);
  return field;
}

// NOLINTNEXTLINE(readability-non-const-parameter): see FLAG.h
unsigned int* FLAG_DupFlagField(unsigned int* field) {
  unsigned int* copy = FLAG_NewField();
  if (copy != nullptr) *copy = *field;
  return copy;
}

// NOLINTNEXTLINE(readability-non-const-parameter): see FLAG.h
int FLAG_CheckFlag(unsigned int* field, unsigned int flag, int rowCount,
                   const FLAG_flag_info* rows) {
  const Conflict conflict = findConflict(*field, flag, rowCount, rows);
  report(conflict, rowCount, rows, "", [] {});
  return static_cast<int>(conflict.flags);
}

int FLAG_SaveSetFlag(unsigned int* field, unsigned int flag, int rowCount,
                     const FLAG_flag_info* rows) {
  const Conflict conflict = findConflict(*field, flag, rowCount, rows);
  report(conflict, rowCount, rows, ". Didn't set flag.", [] {});
  if (conflict.row >= 0 && conflict.flags == 0) *field |= flag;
  return static_cast<int>(conflict.flags);
}

void FLAG_ForceSetFlag(unsigned int* field, unsigned int flag, int rowCount,
                       const FLAG_flag_info* rows) {
  *field |= flag;
  const Conflict conflict = findConflict(*field, flag, rowCount, rows);
  // Cleared before the report: the receiver of the message may read the field.
  report(conflict, rowCount, rows, ". Clearing bad flag(s).",
         [&] { *field &= ~flag; });
}
