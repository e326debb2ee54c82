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
// of the caller's own; only FLAG_NewField() and FLAG_DupFlagField() allocate.
//
// Where an operation asserts that its field is not null, a null field raises
// the internal assertion (message 7); the operation then does nothing and
// returns 0 or false. All others need a valid field and table.

#ifndef FLAG_H
#define FLAG_H

#include <bit>

#include "HX_Export.h"
#include "platform/containers/HXCG_compare.h"

/// A row of a conflict table. The caller's table has one row per bit position:
/// row i describes the flag 2^i.
struct FLAG_flag_info {
  unsigned int excludedFlags;  ///< may not be set together with this flag
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

// A field is an unsigned int* in every signature, also where it is only read:
// NOLINTBEGIN(readability-non-const-parameter)

/// A new field without flags, owned by the caller: a block of the memory
/// controller, which must be installed. Null, after the assertion of
/// FLAG_ClearAll(), if there is no memory.
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

/// The mask of the \p i-th set bit: 1 asks for the lowest, the number of flags
/// for the highest. 0 if there is no such bit.
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
// The row of a flag is that of its highest bit; the flag 0 uses row 0. A row
// that is not among the rowCount rows raises the internal assertion. The
// conflicting flags are those of the field that the row excludes; they are
// reported as message 1292 (internal warning).

/// Only looks: reports a conflict and changes nothing.
/// \return the conflicting flags; 0 if there are none or the row is missing
HX_UTILS_API int FLAG_CheckFlag(unsigned int* field, unsigned int flag,
                                int rowCount, const FLAG_flag_info* rows);

/// Sets \p flag unless it conflicts, which is reported, or its row is missing.
/// \return the conflicting flags; 0 if the flag was set or the row is missing
HX_UTILS_API int FLAG_SaveSetFlag(unsigned int* field, unsigned int flag,
                                  int rowCount, const FLAG_flag_info* rows);

/// Sets \p flag; if it then conflicts, clears \p flag again, even one that had
/// been set before the call, and reports that. A flag whose row is missing
/// stays set. A row that excludes its own flag conflicts always.
HX_UTILS_API void FLAG_ForceSetFlag(unsigned int* field, unsigned int flag,
                                    int rowCount, const FLAG_flag_info* rows);

// NOLINTEND(readability-non-const-parameter)

#endif  // FLAG_H
