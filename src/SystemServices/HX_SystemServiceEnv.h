// Creates the system services on first demand.

#ifndef SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H
#define SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class HX_SystemCall;
class HX_SystemFileIo;

/// Owns the services until they are released or it is destroyed. Copies share
/// the services: all but one of them must give them up with disown() before
/// they are destroyed or the services released. Assignment forgets the target's
/// own services without releasing them.
class HX_UTILS_API HX_SystemServiceEnv : public HX_Allocated {
 public:
  HX_SystemServiceEnv() = default;
  HX_SystemServiceEnv(const HX_SystemServiceEnv&) = default;
  HX_SystemServiceEnv& operator=(const HX_SystemServiceEnv&) = default;
  ~HX_SystemServiceEnv();

  /// The same object on each call until it is released.
  HX_SystemCall* getSystemCall();
  HX_SystemFileIo* getSystemFileIo();

  /// Deletes the service; the next demand creates a new one.
  void releaseSystemCall();
  /// The same, and closes the files that are still open.
  void releaseSystemFileIo();

  /// Forgets the services without releasing them.
  void disown();

 private:
  HX_SystemCall* m_pSystemCall = nullptr;
  HX_SystemFileIo* m_pSystemFileIo = nullptr;
};

#endif  // SYSTEMSERVICES_HX_SYSTEMSERVICEENV_H
