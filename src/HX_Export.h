// Marks what the library exports from its shared object.

#ifndef HX_EXPORT_H
#define HX_EXPORT_H

#if !defined(HX_UTILS_SHARED)
#define HX_UTILS_API
#elif defined(_WIN32) && defined(HX_UTILS_BUILDING)
#define HX_UTILS_API __declspec(dllexport)
#elif defined(_WIN32)
#define HX_UTILS_API __declspec(dllimport)
#else
#define HX_UTILS_API __attribute__((visibility("default")))
#endif

/// Marks inline functions. A shared object exports them, see
/// Control/HX_ExportInline.h; a host compiles their bodies instead of
/// importing.
#if defined(_WIN32) && !defined(HX_UTILS_BUILDING)
#define HX_UTILS_INLINE_API
#else
#define HX_UTILS_INLINE_API HX_UTILS_API
#endif

#endif  // HX_EXPORT_H
