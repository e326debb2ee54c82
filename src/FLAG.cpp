#include "FLAG.h"

#include <string>

#include "Control/ERR_Messages.h"
#include "Control/HX_SelfCheck.h"
#include "Math/IMS_Log2.h"
#include "Strings/STR_StringSupport.h"
#include "platform/memory/HxCMemController.h"

namespace {

constexpr char kErrorCode[] = __FILE__ "_";
constexpr char kHeader[] = "FLAG.h";
constexpr char kHeaderErrorCode[] = "FLAG.h_";

// The row of flag; -1, after the assertion, if the table has none.
int rowOfFlag(unsigned int flag, int rowCount) {
  const int row = IMS_Log2(flag);
  return HX_Assert(row < rowCount, kErrorCode) ? row : -1;
}

const char* nameOf(const FLAG_flag_info& row) {
  return STR_IsNullOrEmpty(row.flagName) ? "<unknown flag name>" : row.flagName;
}

struct Conflict {
  int row;             // rowOfFlag()
  unsigned int flags;  // those of the field that conflict; 0 without a row
};

Conflict findConflict(unsigned int field, unsigned int flag, int rowCount,
                      const FLAG_flag_info* rows) {
  const int row = rowOfFlag(flag, rowCount);
  return {row, row < 0 ? 0 : field & rows[row].excludedFlags};
}

std::string describe(const Conflict& conflict, int rowCount,
                     const FLAG_flag_info* rows, const char* suffix) {
  std::string report = "Flag conflict found ! Flag ";
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

void report(const Conflict& conflict, int rowCount, const FLAG_flag_info* rows,
            const char* suffix) {
  if (conflict.flags == 0) return;
  ERR_Msg1292(describe(conflict, rowCount, rows, suffix).c_str());
}

}  // namespace

void hx_detail::failFlagField(int line) {
  HX_Assert(false, kHeaderErrorCode, kHeader, line);
}

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
  report(conflict, rowCount, rows, "");
  return static_cast<int>(conflict.flags);
}

int FLAG_SaveSetFlag(unsigned int* field, unsigned int flag, int rowCount,
                     const FLAG_flag_info* rows) {
  const Conflict conflict = findConflict(*field, flag, rowCount, rows);
  report(conflict, rowCount, rows, ". Didn't set flag.");
  if (conflict.row >= 0 && conflict.flags == 0) *field |= flag;
  return static_cast<int>(conflict.flags);
}

void FLAG_ForceSetFlag(unsigned int* field, unsigned int flag, int rowCount,
                       const FLAG_flag_info* rows) {
  *field |= flag;
  const Conflict conflict = findConflict(*field, flag, rowCount, rows);
  if (conflict.flags == 0) return;
  const std::string text =
      describe(conflict, rowCount, rows, ". Clearing bad flag(s).");
  *field &= ~flag;  // before the report: who receives it may read the field
  ERR_Msg1292(text.c_str());
}
