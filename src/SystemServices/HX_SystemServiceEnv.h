// Creates the system services on first demand.

#ifndef SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H
#define SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class HX_SystemCall;
class HX_SystemFileIo;

/// OWNERSHIP: the object owns the services until release or destruction. Copies
/// share the services: exactly one copy may release them, call disown() on
/// every other copy first. Assignment forgets the services of the target
/// without a release.
class HX_UTILS_API HX_SystemServiceEnv : public HX_Allocated {
 public:
  HX_SystemServiceEnv() = default;
  HX_SystemServiceEnv(const HX_SystemServiceEnv&) = default;
  HX_SystemServiceEnv& operator=(const HX_SystemServiceEnv&) = default;
  ~HX_SystemServiceEnv();

  /// RETURNS: the same object on every call until the release; null without
  /// memory.
  HX_SystemCall* getSystemCall();
  HX_SystemFileIo* getSystemFileIo();

  /// Deletes the service; the next demand creates a new one.
  void releaseSystemCall();
  /// Deletes the service and closes the files still open.
  void releaseSystemFileIo();

  /// Forgets the services without a release.
  void disown();

 private:
  HX_SystemCall* m_pSystemCall = nullptr;
  HX_SystemFileIo* m_pSystemFileIo = nullptr;
};

#endif  // SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H
