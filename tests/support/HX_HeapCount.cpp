// Replaces the global operator new and delete of a test program.
#include "support/HX_HeapCount.h"

#include <climits>
#include <cstdlib>
#include <new>

#include "platform/strings/KyCXString.h"

namespace {

int s_Asked = 0;
int s_Live = 0;
int s_FirstFailure = INT_MAX;
int s_LastFailure = INT_MAX;

void* allocate(std::size_t size) noexcept {
  const int number = s_Asked++;
  if (number >= s_FirstFailure && number <= s_LastFailure) return nullptr;
  void* block = std::malloc(size);
  if (block != nullptr) ++s_Live;
  return block;
}

void release(void* block) noexcept {
  if (block != nullptr) --s_Live;
  std::free(block);
}

}  // namespace

int HX_HeapBlocks() { return s_Asked; }

int HX_LiveHeapBlocks() { return s_Live; }

bool HX_HeapReachesLibrary() {
  const int before = s_Asked;
  KyCXString text;
  text.reserve(1000);
  return s_Asked > before;
}

HX_FailingHeap::HX_FailingHeap(int number, bool allAfter)
    : m_Start(s_Asked), m_LiveAtStart(s_Live) {
  s_FirstFailure = s_Asked + number;
  s_LastFailure = allAfter ? INT_MAX : s_FirstFailure;
}

HX_FailingHeap::~HX_FailingHeap() { s_FirstFailure = s_LastFailure = INT_MAX; }

int HX_FailingHeap::allocated() const { return s_Asked - m_Start; }

int HX_FailingHeap::liveBlocks() const { return s_Live - m_LiveAtStart; }

[[gnu::noinline]] void* operator new(std::size_t size) {
  if (void* block = allocate(size)) return block;
  throw std::bad_alloc();
}
[[gnu::noinline]] void* operator new(std::size_t size,
                                     const std::nothrow_t&) noexcept {
  return allocate(size);
}
[[gnu::noinline]] void operator delete(void* block) noexcept { release(block); }
[[gnu::noinline]] void operator delete(void* block, std::size_t) noexcept {
  release(block);
}
[[gnu::noinline]] void operator delete(void* block,
                                       const std::nothrow_t&) noexcept {
  release(block);
}
// The sanitizers replace the forms for arrays, which would not call the above.
[[gnu::noinline]] void* operator new[](std::size_t size) {
  return operator new(size);
}
[[gnu::noinline]] void* operator new[](std::size_t size,
                                       const std::nothrow_t&) noexcept {
  return allocate(size);
}
[[gnu::noinline]] void operator delete[](void* block) noexcept {
  release(block);
}
[[gnu::noinline]] void operator delete[](void* block, std::size_t) noexcept {
  release(block);
}
