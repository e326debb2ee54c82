// Counts the blocks that a test program takes from the heap, and lets the heap
// run out.

#ifndef SUPPORT_HX_HEAPCOUNT_H
#define SUPPORT_HX_HEAPCOUNT_H

/// Blocks asked for by new since the start of the program. A program that uses
/// this header gets the counting operator new.
int HX_HeapBlocks();

/// Blocks of new that no delete has given back yet.
int HX_LiveHeapBlocks();

/// True if the operator new of the test program is the one of the library too.
/// A DLL of Windows has an operator new of its own.
bool HX_HeapReachesLibrary();

/// Skips a test that lets the library run out of memory where the test program
/// cannot.
#define HX_NEEDS_HEAP_OF_LIBRARY() \
  if (!HX_HeapReachesLibrary())    \
  GTEST_SKIP() << "the library has an operator new of its own"

/// Heap that runs out, installed while the object lives. Only operator new
/// fails, by std::bad_alloc; malloc() does not.
class HX_FailingHeap {
 public:
  /// The allocation with the given number fails (0 is the next allocation),
  /// with \p allAfter all later allocations as well.
  HX_FailingHeap(int number, bool allAfter);
  HX_FailingHeap(const HX_FailingHeap&) = delete;
  HX_FailingHeap& operator=(const HX_FailingHeap&) = delete;
  ~HX_FailingHeap();

  /// Allocations asked for since the constructor, failed ones included.
  int allocated() const;
  /// Live blocks now minus live blocks at the constructor.
  int liveBlocks() const;

 private:
  int m_Start;
  int m_LiveAtStart;
};

#endif  // SUPPORT_HX_HEAPCOUNT_H
