#include "support/HX_HeapCount.h"

#include <cstdlib>
#include <new>

namespace {

int s_heapBlocks = 0;

}  // namespace

int HX_HeapBlocks() { return s_heapBlocks; }

[[gnu::noinline]] void* operator new(std::size_t size) {
  ++s_heapBlocks;
  if (void* block = std::malloc(size)) return block;
  throw std::bad_alloc();
}
[[gnu::noinline]] void operator delete(void* block) noexcept {
  std::free(block);
}
[[gnu::noinline]] void operator delete(void* block, std::size_t) noexcept {
  std::free(block);
}
