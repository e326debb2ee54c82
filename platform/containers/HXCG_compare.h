// How the code generator's comparisons answer.

#ifndef PLATFORM_CONTAINERS_HXCG_COMPARE_H
#define PLATFORM_CONTAINERS_HXCG_COMPARE_H

/// Zero means different: the reverse of the C library.
enum HXCG_compare { HXCG_DIFFERENT = 0, HXCG_EQUAL = 1 };

#endif  // PLATFORM_CONTAINERS_HXCG_COMPARE_H
