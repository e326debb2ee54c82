#include "SystemServices/HX_SystemServiceEnv.h"

#include "SystemServices/HX_SystemCall.h"
#include "SystemServices/HX_SystemFileIo.h"

HX_SystemServiceEnv::~HX_SystemServiceEnv() {
  releaseSystemCall();
  releaseSystemFileIo();
}

HX_SystemCall* HX_SystemServiceEnv::getSystemCall() {
  if (m_pSystemCall == nullptr) m_pSystemCall = new HX_SystemCall;
  return m_pSystemCall;
}

HX_SystemFileIo* HX_SystemServiceEnv::getSystemFileIo() {
  if (m_pSystemFileIo == nullptr) m_pSystemFileIo = new HX_SystemFileIo;
  return m_pSystemFileIo;
}

void HX_SystemServiceEnv::releaseSystemCall() {
  delete m_pSystemCall;
  m_pSystemCall = nullptr;
}

void HX_SystemServiceEnv::releaseSystemFileIo() {
  delete m_pSystemFileIo;
  m_pSystemFileIo = nullptr;
}

void HX_SystemServiceEnv::disown() {
  m_pSystemCall = nullptr;
  m_pSystemFileIo = nullptr;
}
