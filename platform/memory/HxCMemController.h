// The generator's memory controller.
//
//   HxCMemController controller;
//   pHXMemory = &controller;   // the library allocates there from now on
//   ...
//   pHXMemory = nullptr;       // and from the C heap again

#ifndef PLATFORM_MEMORY_HXCMEMCONTROLLER_H
#define PLATFORM_MEMORY_HXCMEMCONTROLLER_H

#include "platform/HX_PlatformExport.h"

/// Hands out blocks of the C heap; a host derives a controller. The controller
/// that allocated a block frees the block.
class HX_PLATFORM_API HxCMemController {
 public:
  HxCMemController() = default;
  HxCMemController(const HxCMemController&) = delete;
  HxCMemController& operator=(const HxCMemController&) = delete;
  virtual ~HxCMemController();

  /// \p size bytes, aligned for every type and owned by the caller; null
  /// without memory.
  virtual void* allocMemBlock(unsigned long size);
  /// Takes a block back; null is ignored.
  virtual void freeMemBlock(void* block);
};

/// The installed controller, not owned; null until the host installs one.
extern HX_PLATFORM_API HxCMemController* pHXMemory;

#endif  // PLATFORM_MEMORY_HXCMEMCONTROLLER_H
