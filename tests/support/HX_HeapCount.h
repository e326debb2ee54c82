// Counts what a test program asks of the heap.

#ifndef SUPPORT_HX_HEAPCOUNT_H
#define SUPPORT_HX_HEAPCOUNT_H

/// Blocks asked for by new since the start of the program. A program that calls
/// this gets the counting operator new.
int HX_HeapBlocks();

#endif  // SUPPORT_HX_HEAPCOUNT_H
