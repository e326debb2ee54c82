#include "SystemServices/HX_SystemFileIo.h"

#include "Control/ERR_Messages.h"
#include "Control/HX_Memory.h"
#include "platform/strings/KyCXString.h"

HX_SystemFileIo::~HX_SystemFileIo() {
  while (!m_Files.empty()) std::fclose(m_Files.pop());
}

bool HX_SystemFileIo::open(const KyCXString& name, const KyCXString& mode,
                           std::FILE*& file) {
  // The entry comes first: no file stays open without an entry.
  auto entry = m_Files.first();
  if (!HX_WithinMemory([&] { entry = m_Files.append(nullptr); })) return false;
  std::FILE* opened = std::fopen(name.cstring(), mode.cstring());
  if (opened == nullptr) {
    m_Files.del_item(entry);
    ERR_Msg90(name.cstring());
    return false;
  }
  m_Files[entry] = file = opened;
  return true;
}

bool HX_SystemFileIo::close(std::FILE* file) {
  if (file == nullptr) return false;
  for (auto item = m_Files.first(); item; item = m_Files.succ(item)) {
    if (m_Files[item] != file) continue;
    std::fclose(file);
    m_Files.del_item(item);
    return true;
  }
  return false;
}
