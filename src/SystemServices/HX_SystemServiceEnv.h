// Creates the system services on first demand.

#ifndef SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H
#define SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class HX_SystemCall;
class HX_SystemFileIo;

/// OWNERSHIP: the object owns its services until their release or the object's
/// destruction. Copies share the services: call disown() on all copies but one
/// before a copy is destroyed or releases a service. Assignment forgets the
/// services of the target without a release.
class HX_UTILS_API HX_SystemServiceEnv : public HX_Allocated {
 public:
  HX_SystemServiceEnv() = default;
  HX_SystemServiceEnv(const HX_SystemServiceEnv&) = default;
  HX_SystemServiceEnv& operator=(const HX_SystemServiceEnv&) = default;
  ~HX_SystemServiceEnv();

  /// RETURNS: the same object on each call until its release; null without
  /// memory.
  HX_SystemCall* getSystemCall();
  HX_SystemFileIo* getSystemFileIo();

  /// Deletes the service; the next demand creates a new one.
  void releaseSystemCall();
  /// The same, and closes the files that are still open.
  void releaseSystemFileIo();

  /// Forgets the services without a release.
  void disown();

 private:
  HX_SystemCall* m_pSystemCall = nullptr;
  HX_SystemFileIo* m_pSystemFileIo = nullptr;
};

#endif  // SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H
