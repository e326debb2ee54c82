// Flag fields: up to 32 flags in one word, passed around by pointer.
//
//   enum : unsigned int { kVolatile = 1, kConst = 2, kMacro = 4 };
//   const FLAG_flag_info rows[] = {
//       {kMacro, "volatile"}, {0, "const"}, {kVolatile, "macro"}};
//
//   unsigned int* field = FLAG_NewField();
//   FLAG_SetFlag(field, kVolatile);
//   FLAG_SaveSetFlag(field, kMacro, 3, rows);   // kVolatile; reports, not set
//   pHXMemory->freeMemBlock(field);
//
// A flag is a mask: bit i stands for the value 2^i. A field may also be a word
// of the caller; only FLAG_NewField() and FLAG_DupFlagField() allocate.
//
// Null fields: an operation documented to assert raises the internal assertion
// (message 7) for a null field, does nothing and returns 0 or false. All other
// operations REQUIRE a valid field and table.

#ifndef FLAG_H
#define FLAG_H

#include <bit>

#include "HX_Export.h"
#include "platform/containers/HXCG_compare.h"

/// A row of a conflict table. The caller's table has one row per bit position:
/// row i describes the flag 2^i.
struct FLAG_flag_info {
  unsigned int excludedFlags;  ///< flags that exclude the flag of the row
  const char* flagName;        ///< for reports; may be null or empty
};

namespace hx_detail {

// The assertions of a null field, one per operation: message 7 tells the line
// of FLAG.cpp and so the operation.
HX_UTILS_API void failClearAll();
HX_UTILS_API void failClearFlag();
HX_UTILS_API void failSetFlag();
HX_UTILS_API void failGetFlag();
HX_UTILS_API void failGetFlags();
HX_UTILS_API void failGetAllFlags();

inline bool isFlagField(const unsigned int* field, void (*fail)()) {
  if (field != nullptr) [[likely]]
    return true;
  fail();
  return false;
}

}  // namespace hx_detail

// A field is an unsigned int* in every signature, also in operations that only
// read:
// NOLINTBEGIN(readability-non-const-parameter)

/// RETURNS: a new field without flags, a block of the memory controller; null,
/// after the assertion of FLAG_ClearAll(), if memory runs out.
/// REQUIRES: a memory controller is installed.
/// OWNERSHIP: the caller owns the field.
HX_UTILS_API unsigned int* FLAG_NewField();

/// A new field with the flags of \p field; as FLAG_NewField().
HX_UTILS_API unsigned int* FLAG_DupFlagField(unsigned int* field);

/// Asserts that the field is not null.
HX_UTILS_INLINE_API inline void FLAG_ClearAll(unsigned int* field) {
  if (hx_detail::isFlagField(field, hx_detail::failClearAll)) *field = 0;
}

/// Asserts that the field is not null.
HX_UTILS_INLINE_API inline void FLAG_ClearFlag(unsigned int* field,
                                               unsigned int flags) {
  if (hx_detail::isFlagField(field, hx_detail::failClearFlag)) *field &= ~flags;
}

/// Asserts that the field is not null.
HX_UTILS_INLINE_API inline void FLAG_SetFlag(unsigned int* field,
                                             unsigned int flags) {
  if (hx_detail::isFlagField(field, hx_detail::failSetFlag)) *field |= flags;
}

/// True if any of \p flags is set; false for no flags. Asserts that the field
/// is not null.
HX_UTILS_INLINE_API inline bool FLAG_GetFlag(unsigned int* field,
                                             unsigned int flags) {
  return hx_detail::isFlagField(field, hx_detail::failGetFlag) &&
         (*field & flags) != 0;
}

/// True if all of \p flags are set; true for no flags. Asserts that the field
/// is not null.
HX_UTILS_INLINE_API inline bool FLAG_GetFlags(unsigned int* field,
                                              unsigned int flags) {
  return hx_detail::isFlagField(field, hx_detail::failGetFlags) &&
         (*field & flags) == flags;
}

/// The whole word. Asserts that the field is not null.
HX_UTILS_INLINE_API inline unsigned int FLAG_GetAllFlagsFromFlagField(
    unsigned int* field) {
  return hx_detail::isFlagField(field, hx_detail::failGetAllFlags) ? *field : 0;
}

/// The number of set bits.
HX_UTILS_INLINE_API inline int FLAG_GetNumberOfFlags(unsigned int word) {
  return std::popcount(word);
}
HX_UTILS_INLINE_API inline int FLAG_GetNumberOfFlagsInField(
    unsigned int* field) {
  return FLAG_GetNumberOfFlags(*field);
}

/// The mask of set bit number \p i, counted from 1 upwards from the lowest bit.
/// 0 if the word has fewer set bits.
HX_UTILS_INLINE_API inline unsigned int FLAG_GetIthFlag(unsigned int word,
                                                        int i) {
  if (i < 1) return 0;
  while (--i > 0 && word != 0) word &= word - 1;
  return word & (0U - word);
}
HX_UTILS_INLINE_API inline unsigned int FLAG_GetIthFlagInField(
    unsigned int* field, int i) {
  return FLAG_GetIthFlag(*field, i);
}

/// HXCG_EQUAL if both fields hold the same flags.
HX_UTILS_INLINE_API inline HXCG_compare FLAG_CompareFlagfields(
    unsigned int* a, unsigned int* b) {
  return *a == *b ? HXCG_EQUAL : HXCG_DIFFERENT;
}

// Setting under a table of flags that exclude each other.
//
// The row of a flag is the row of the highest bit; the flag 0 uses row 0. A row
// outside [0, rowCount) raises the internal assertion. Flags of the field that
// the row excludes are in conflict and reported as message 1292 (internal
// warning). If memory runs out, the report is cut after "Flag conflict found !
// Flag "; results and field are the same.

/// Reports a conflict and changes nothing.
/// \return the conflicting flags; 0 without a conflict or without a row
HX_UTILS_API int FLAG_CheckFlag(unsigned int* field, unsigned int flag,
                                int rowCount, const FLAG_flag_info* rows);

/// Sets \p flag if the row exists and no flag conflicts; reports a conflict.
/// \return the conflicting flags; 0 if the flag was set or the row is missing
HX_UTILS_API int FLAG_SaveSetFlag(unsigned int* field, unsigned int flag,
                                  int rowCount, const FLAG_flag_info* rows);

/// Sets \p flag. On a conflict, reports and clears \p flag again, even if the
/// flag was set before the call. Without a row the flag stays set. A row that
/// excludes the flag of the row always conflicts.
HX_UTILS_API void FLAG_ForceSetFlag(unsigned int* field, unsigned int flag,
                                    int rowCount, const FLAG_flag_info* rows);

// NOLINTEND(readability-non-const-parameter)

#endif  // FLAG_H
