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

void reportConflict(int row, unsigned int conflicts, int rowCount,
                    const FLAG_flag_info* rows, const char* suffix) {
  std::string report = "Flag conflict found ! Flag ";
  report += nameOf(rows[row]);
  report += " excludes flag(s): ";
  for (; conflicts != 0; conflicts &= conflicts - 1) {
    const int other = rowOfFlag(FLAG_GetIthFlag(conflicts, 1), rowCount);
    if (other < 0) continue;
    report += nameOf(rows[other]);
    report += ' ';
  }
  report += suffix;
  ERR_Msg1292(report.c_str());
}

// The flags of field that conflict with flag, which are reported; row receives
// rowOfFlag().
unsigned int findConflict(const unsigned int* field, unsigned int flag,
                          int rowCount, const FLAG_flag_info* rows, int& row,
                          const char* suffix) {
  row = rowOfFlag(flag, rowCount);
  if (row < 0) return 0;
  const unsigned int conflicts = *field & rows[row].excludedFlags;
  if (conflicts != 0) reportConflict(row, conflicts, rowCount, rows, suffix);
  return conflicts;
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

unsigned int* FLAG_DupFlagField(unsigned int* field) {
  unsigned int* copy = FLAG_NewField();
  if (copy != nullptr) *copy = *field;
  return copy;
}

int FLAG_CheckFlag(unsigned int* field, unsigned int flag, int rowCount,
                   const FLAG_flag_info* rows) {
  int row = 0;
  return static_cast<int>(findConflict(field, flag, rowCount, rows, row, ""));
}

int FLAG_SaveSetFlag(unsigned int* field, unsigned int flag, int rowCount,
                     const FLAG_flag_info* rows) {
  int row = 0;
  const unsigned int conflicts =
      findConflict(field, flag, rowCount, rows, row, ". Didn't set flag.");
  if (row >= 0 && conflicts == 0) *field |= flag;
  return static_cast<int>(conflicts);
}

void FLAG_ForceSetFlag(unsigned int* field, unsigned int flag, int rowCount,
                       const FLAG_flag_info* rows) {
  *field |= flag;
  int row = 0;
  if (findConflict(field, flag, rowCount, rows, row,
                   ". Clearing bad flag(s).") != 0)
    *field &= ~flag;
}
