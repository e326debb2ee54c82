// The allocation convention of the library's own classes.
//
// A class that is created with new derives from HX_Allocated (a struct that
// cannot derive from it uses the two functions): its memory comes from the
// memory controller while one is installed and from the C heap otherwise.

#ifndef CONTROL_HX_ALLOCATED_H
#define CONTROL_HX_ALLOCATED_H

#include <cstddef>
#include <new>

#include "HX_Export.h"

/// \p size bytes from the memory controller or the C heap; null if there is
/// no memory.
HX_UTILS_API void* HX_Allocate(std::size_t size) noexcept;

/// Returns a block of HX_Allocate(). The same controller must be installed as
/// at its allocation; null is ignored.
HX_UTILS_API void HX_Free(void* block) noexcept;

/// Empty base class. A failed allocation makes the new expression null, no
/// constructor runs and nothing is thrown; the same holds for arrays and for
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
  /// The same, for callers who say that they expect null.
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
  /// Takes nothing back: the place is the caller's.
  static void operator delete(void*, void*) noexcept {}

 protected:
  HX_Allocated() = default;
  ~HX_Allocated() = default;
  HX_Allocated(const HX_Allocated&) = default;
  HX_Allocated& operator=(const HX_Allocated&) = default;
};

#endif  // CONTROL_HX_ALLOCATED_H
