// Texts of the version objects. A text and its count are one block of the
// memory controller while a controller is installed.

#ifndef SYSTEMSERVICES_IMPLSYSTEMSERVICES_HX_SHAREDTEXT_H
#define SYSTEMSERVICES_IMPLSYSTEMSERVICES_HX_SHAREDTEXT_H

#include <memory>

#include "Control/HX_Memory.h"
#include "platform/strings/KyCXString.h"

/// A counted copy of \p text. Throws std::bad_alloc: see HX_WithinMemory().
inline std::shared_ptr<KyCXString> HX_SharedText(const KyCXString& text) {
  return std::allocate_shared<KyCXString>(HX_ControllerAllocator<KyCXString>(),
                                          text);
}

/// The decimal digits of \p value.
inline KyCXString HX_Decimal(int value) {
  return KyCXString(value, false, true);
}

#endif  // SYSTEMSERVICES_IMPLSYSTEMSERVICES_HX_SHAREDTEXT_H
