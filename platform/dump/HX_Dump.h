// A writer of developer dumps: nested sections of labelled entries.

#ifndef PLATFORM_DUMP_HX_DUMP_H
#define PLATFORM_DUMP_HX_DUMP_H

#include "platform/HX_PlatformExport.h"

class HX_Dumpable;
class KyCXString;

/// A host derives a class per output format.
class HX_PLATFORM_API HX_Dump {
 public:
  virtual ~HX_Dump();

  /// Opens the section of \p object, headed by \p className.
  virtual void openObject(const HX_Dumpable* object,
                          const KyCXString& className) = 0;
  /// One entry of the open section; \p level is the indentation.
  virtual void writeEntry(const KyCXString& label, const KyCXString& value,
                          int level) = 0;
  /// Closes the section of \p object.
  virtual void closeObject(const HX_Dumpable* object) = 0;
};

#endif  // PLATFORM_DUMP_HX_DUMP_H
