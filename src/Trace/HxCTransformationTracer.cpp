#include "Trace/HxCTransformationTracer.h"

#include "Control/ERR_Messages.h"

std::FILE* HxCTransformationTracer::m_pTraceFile = nullptr;

bool HxCTransformationTracer::boot(const char* fileName) {
  shutdown();
  const char* name = fileName != nullptr ? fileName : "";
  m_pTraceFile = std::fopen(name, "a");
  if (m_pTraceFile == nullptr) ERR_Msg90(name);
  return m_pTraceFile != nullptr;
}

bool HxCTransformationTracer::shutdown() {
  if (m_pTraceFile != nullptr) std::fclose(m_pTraceFile);
  m_pTraceFile = nullptr;
  return true;
}

void HxCTransformationTracer::logTransformation(const char* text) {
  if (m_pTraceFile == nullptr || text == nullptr) return;
  std::fprintf(m_pTraceFile, "%s \n ", text);
}
