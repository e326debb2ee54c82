// The allocator of RapidJSON that throws when the memory ends. The allocators
// of RapidJSON do not look.

#ifndef HOST_BASE_HX_CHECKEDALLOCATOR_H
#define HOST_BASE_HX_CHECKEDALLOCATOR_H

#include <cstddef>
#include <cstdlib>
#include <new>

/// The names are the names that RapidJSON calls. Throws std::bad_alloc.
struct HX_CheckedAllocator {
  static constexpr bool kNeedFree = true;

  void* Malloc(std::size_t size) {
    return size == 0 ? nullptr : checked(std::malloc(size));
  }
  void* Realloc(void* original, std::size_t, std::size_t size) {
    if (size != 0) return checked(std::realloc(original, size));
    std::free(original);
    return nullptr;
  }
  static void Free(void* memory) { std::free(memory); }

 private:
  static void* checked(void* memory) {
    if (memory == nullptr) throw std::bad_alloc();
    return memory;
  }
};

#endif  // HOST_BASE_HX_CHECKEDALLOCATOR_H
