#pragma once
// Counts the bytes that the global operator new hands out while armed, so a
// benchmark can report what one object costs on the heap. The replacement
// operators live in HeapCounter.cpp, a translation unit of their own, so that
// the compiler never sees them inlined into code that news and deletes.
#include <cstddef>

namespace norvik::bench {

// Starts counting from zero.
void StartHeapCount();
// Stops counting and answers the bytes allocated since StartHeapCount.
std::size_t StopHeapCount();

}  // namespace norvik::bench
