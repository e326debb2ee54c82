// Questions about data dictionary objects by their handles.

#ifndef PLATFORM_DATADICTIONARY_HX_DATADICTIONARY_H
#define PLATFORM_DATADICTIONARY_HX_DATADICTIONARY_H

#include "platform/HX_PlatformExport.h"

class KyCXString;

/// Outputs are written only where the result is true.
class HX_PLATFORM_API HX_DataDictionary {
 public:
  /// True for the handle of an object.
  static bool isValidDdHandle(unsigned long handle);
  /// The path from "//DD0" down; the last part of the path.
  /// RETURNS: false, with the text unchanged, for no handle of an object.
  static bool getObjectFullPathName(unsigned long handle, KyCXString& path);
  static bool getObjectName(unsigned long handle, KyCXString& name);
};

#endif  // PLATFORM_DATADICTIONARY_HX_DATADICTIONARY_H
