#include "platform/memory/HxCMemController.h"

#include <cstdlib>

HxCMemController* pHXMemory = nullptr;

HxCMemController::~HxCMemController() = default;

void* HxCMemController::allocMemBlock(unsigned long size) {
  return std::malloc(size);
}

void HxCMemController::freeMemBlock(void* block) { std::free(block); }
