// A register of open files, which it closes when it is destroyed.

#ifndef SYSTEMSERVICES_HX_SYSTEMFILEIO_H
#define SYSTEMSERVICES_HX_SYSTEMFILEIO_H

#include <cstdio>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/containers/list.h"

class KyCXString;

/// Destruction closes the files still open, in the order of their opening. Not
/// copied: two registers would close the same files.
class HX_UTILS_API HX_SystemFileIo : public HX_Allocated {
 public:
  HX_SystemFileIo() = default;
  HX_SystemFileIo(const HX_SystemFileIo&) = delete;
  HX_SystemFileIo& operator=(const HX_SystemFileIo&) = delete;
  ~HX_SystemFileIo();

  /// Opens \p name with the fopen() mode \p mode.
  /// \param[out] file  the handle, owned by this register; written on success
  /// \return false after message 90 (fatal error) if the file cannot be opened
  bool open(const KyCXString& name, const KyCXString& mode, std::FILE*& file);

  /// Closes a file of this register.
  /// \return false, with nothing done, for null and for any other file
  bool close(std::FILE* file);

 private:
  leda::list<std::FILE*> m_Files;  // in the order of opening
};

#endif  // SYSTEMSERVICES_HX_SYSTEMFILEIO_H
