#include "SafeNames/HX_TextFaults.h"

#include "Control/HX_Memory.h"

void HX_TextFaults::add(int line, const char* text) {
  if (m_Count < kKept) {
    Fault& fault = m_Faults[m_Count];
    fault.line = line;
    HX_WithinMemory([&] { fault.text = text; });
  }
  ++m_Count;
}
