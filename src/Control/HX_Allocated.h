// The allocation convention of the library's own classes.
//
// A class that is created with new derives from HX_Allocated; a struct that
// cannot derive uses the two functions. Memory comes from the memory controller
// while a controller is installed, from the C heap otherwise.

#ifndef CONTROL_HX_ALLOCATED_H
#define CONTROL_HX_ALLOCATED_H

#include <cstddef>
#include <new>

#include "HX_Export.h"

/// \p size bytes from the memory controller or the C heap; null if there is
/// no memory.
HX_UTILS_API void* HX_Allocate(std::size_t size) noexcept;

/// Returns a block of HX_Allocate(); null is ignored.
/// REQUIRES: the controller of the allocation is still installed.
HX_UTILS_API void HX_Free(void* block) noexcept;

/// Empty base class. If memory runs out, a new expression is null: no
/// constructor runs and nothing is thrown. The same holds for arrays and for
/// new (std::nothrow).
class HX_Allocated {
 public:
  /// By HX_Allocate() and HX_Free(); null if there is no memory.
  static void* operator new(std::size_t size) noexcept {
    return HX_Allocate(size);
  }
  /// The same for an array.
  static void* operator new[](std::size_t size) noexcept {
    return HX_Allocate(size);
  }
  /// The same, for callers who say that null is expected.
  static void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    return HX_Allocate(size);
  }
  /// The same for an array.
  static void* operator new[](std::size_t size,
                              const std::nothrow_t&) noexcept {
    return HX_Allocate(size);
  }
  /// Constructs at a place that the caller owns.
  static void* operator new(std::size_t, void* place) noexcept { return place; }
  /// Gives a block of new back; null is ignored.
  static void operator delete(void* block) noexcept { HX_Free(block); }
  /// Gives a block of new[] back; null is ignored.
  static void operator delete[](void* block) noexcept { HX_Free(block); }
  /// Called by the compiler when a constructor throws.
  static void operator delete(void* block, const std::nothrow_t&) noexcept {
    HX_Free(block);
  }
  /// Called by the compiler when a constructor throws.
  static void operator delete[](void* block, const std::nothrow_t&) noexcept {
    HX_Free(block);
  }
  /// Does nothing: the caller owns the place.
  static void operator delete(void*, void*) noexcept {}

 protected:
  HX_Allocated() = default;
  ~HX_Allocated() = default;
  HX_Allocated(const HX_Allocated&) = default;
  HX_Allocated& operator=(const HX_Allocated&) = default;
};

#endif  // CONTROL_HX_ALLOCATED_H
