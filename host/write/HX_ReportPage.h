// The page of a report before and after the place of the data.

#ifndef HOST_WRITE_HX_REPORTPAGE_H
#define HOST_WRITE_HX_REPORTPAGE_H

#include <cstddef>

/// Pieces in order; compilers limit the length of one literal.
extern const char* const kHxPageBeforeData[];
extern const std::size_t kHxPageBeforeDataCount;
extern const char* const kHxPageAfterData[];
extern const std::size_t kHxPageAfterDataCount;

#endif  // HOST_WRITE_HX_REPORTPAGE_H
