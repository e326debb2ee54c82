// Register of open files.
//
//   HX_SystemFileIo files;
//   std::FILE* log = nullptr;
//   if (files.open("log.txt", "w", log)) std::fputs("begin\n", log);
//   files.close(log);

#ifndef SYSTEMSERVICES_HX_SYSTEMFILEIO_H
#define SYSTEMSERVICES_HX_SYSTEMFILEIO_H

#include <cstdio>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/containers/list.h"

class KyCXString;

/// Destruction closes the files still open, in the order of opening. Not
/// copied, because two registers would close the same files.
class HX_UTILS_API HX_SystemFileIo : public HX_Allocated {
 public:
  HX_SystemFileIo() = default;
  HX_SystemFileIo(const HX_SystemFileIo&) = delete;
  HX_SystemFileIo& operator=(const HX_SystemFileIo&) = delete;
  ~HX_SystemFileIo();

  /// Opens \p name with the fopen() mode \p mode.
  /// \param[out] file  the handle; written on success
  /// OWNERSHIP: the register owns the handle.
  /// RETURNS: false after message 90 (fatal error) if the file cannot be
  /// opened; false without memory, and no file is opened.
  bool open(const KyCXString& name, const KyCXString& mode, std::FILE*& file);

  /// Closes a file of this register.
  /// RETURNS: false for null and for any other file; such a file stays open.
  bool close(std::FILE* file);

 private:
  leda::list<std::FILE*> m_Files;  // in the order of opening
};

#endif  // SYSTEMSERVICES_HX_SYSTEMFILEIO_H
