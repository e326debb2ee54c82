// Marks the exports of the shared object of the platform layer.

#ifndef PLATFORM_HX_PLATFORMEXPORT_H
#define PLATFORM_HX_PLATFORMEXPORT_H

#if !defined(HX_PLATFORM_SHARED)
#define HX_PLATFORM_API
#elif defined(_WIN32) && defined(HX_PLATFORM_BUILDING)
#define HX_PLATFORM_API __declspec(dllexport)
#elif defined(_WIN32)
#define HX_PLATFORM_API __declspec(dllimport)
#else
#define HX_PLATFORM_API __attribute__((visibility("default")))
#endif

#endif  // PLATFORM_HX_PLATFORMEXPORT_H
