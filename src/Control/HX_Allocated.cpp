#include "Control/HX_Allocated.h"

#include <cstdlib>

#include "platform/memory/HxCMemController.h"

void* HX_Allocate(std::size_t size) noexcept {
  if (pHXMemory == nullptr) return std::malloc(size);
  return pHXMemory->allocMemBlock(static_cast<unsigned long>(size));
}

void HX_Free(void* block) noexcept {
  if (block == nullptr) return;
  if (pHXMemory == nullptr)
    std::free(block);
  else
    pHXMemory->freeMemBlock(block);
}
