// The policy for missing memory, for every class of the library.
//
// An exported operation that runs out of memory throws nothing. The operation
// returns its failure value (null, false, 0 or an empty text, as the header of
// the class says) and leaves its objects as they were before the call, or as
// the header says. Containers inside the library throw std::bad_alloc; the
// exported operation around them ends the exception with HX_WithinMemory():
//
//   bool HX_Register::add(int value) {
//     return HX_WithinMemory(false, [&] {
//       m_Values.push_back(value);
//       return true;
//     });
//   }

#ifndef CONTROL_HX_MEMORY_H
#define CONTROL_HX_MEMORY_H

#include <cstddef>
#include <limits>
#include <new>
#include <stdexcept>
#include <utility>

#include "Control/HX_Allocated.h"

/// Runs \p work, which takes no argument.
/// RETURNS: the result of \p work; \p failure if memory runs out on the way.
/// Exceptions other than std::bad_alloc and std::length_error pass through,
/// because the host threw them.
template <class Result, class Work>
Result HX_WithinMemory(Result failure, Work&& work) {
  try {
    return std::forward<Work>(work)();
  } catch (const std::bad_alloc&) {
    return failure;
  } catch (const std::length_error&) {
    return failure;
  }
}

/// Runs \p work, which returns nothing.
/// RETURNS: true; false if memory runs out on the way.
template <class Work>
bool HX_WithinMemory(Work&& work) {
  return HX_WithinMemory(false, [&] {
    work();
    return true;
  });
}

/// Standard allocator over HX_Allocate() and HX_Free(), for containers inside
/// the library: their blocks come from the memory controller while one is
/// installed. allocate() throws std::bad_alloc.
template <class T>
struct HX_ControllerAllocator {
  /// Required by std::allocator_traits.
  using value_type = T;
  HX_ControllerAllocator() = default;
  /// Allocators have no state: a copy of another type is an allocator as well.
  template <class U>
  HX_ControllerAllocator(const HX_ControllerAllocator<U>&) noexcept {}

  /// Memory for \p count objects. Throws std::bad_alloc if memory runs out.
  T* allocate(std::size_t count) {
    static_assert(alignof(T) <= alignof(std::max_align_t));
    // NOLINTNEXTLINE(bugprone-sizeof-expression): T may be a pointer
    constexpr std::size_t kSize = sizeof(T);
    if (count > std::numeric_limits<std::size_t>::max() / kSize)
      throw std::bad_alloc();
    void* block = HX_Allocate(count * kSize);
    if (block == nullptr) throw std::bad_alloc();
    return static_cast<T*>(block);
  }
  /// Returns memory of allocate().
  void deallocate(T* block, std::size_t) noexcept { HX_Free(block); }

  /// True: any allocator may return the memory of any allocator.
  friend bool operator==(const HX_ControllerAllocator&,
                         const HX_ControllerAllocator&) {
    return true;
  }
};

#endif  // CONTROL_HX_MEMORY_H
