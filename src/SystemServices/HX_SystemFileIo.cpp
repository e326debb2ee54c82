#include "SystemServices/HX_SystemFileIo.h"

#include "Control/ERR_Messages.h"
#include "platform/strings/KyCXString.h"

HX_SystemFileIo::~HX_SystemFileIo() {
  while (!m_Files.empty()) std::fclose(m_Files.pop());
}

bool HX_SystemFileIo::open(const KyCXString& name, const KyCXString& mode,
                           std::FILE*& file) {
  std::FILE* opened = std::fopen(name.cstring(), mode.cstring());
  if (opened == nullptr) {
    ERR_Msg90(name.cstring());
    return false;
  }
  m_Files.append(opened);
  file = opened;
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
