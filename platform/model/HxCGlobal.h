// Information about the model and the run that every component reads.

#ifndef PLATFORM_MODEL_HXCGLOBAL_H
#define PLATFORM_MODEL_HXCGLOBAL_H

#include "platform/HX_PlatformExport.h"
#include "platform/strings/KyCXString.h"

class HX_DataTypeServer;
class HX_OptionsExt;
class HX_SlBlockHandlesDB;
class HxCIvData;

/// Nothing is owned: the host keeps what it sets alive. Null resets an entry
/// to its default, which is an object with default values for the options and
/// the block handles, and null for the others.
class HX_PLATFORM_API HxCGlobal {
 public:
  /// Each of these reads or sets one entry.
  static HX_OptionsExt* getOptions();
  static void setOptions(HX_OptionsExt* options);
  static HX_SlBlockHandlesDB* getSlBlockHandlesDB();
  static void setSlBlockHandlesDB(HX_SlBlockHandlesDB* handles);
  static HxCIvData* getIvData();
  static void setIvData(HxCIvData* ivData);
  static HX_DataTypeServer* getDataTypeServer();
  static void setDataTypeServer(HX_DataTypeServer* server);
};

/// The model that code is generated for; empty at first.
HX_PLATFORM_API const KyCXString& GLB_GetModelName();
HX_PLATFORM_API void GLB_SetModelName(const KyCXString& name);
/// The subsystem that code is generated for.
HX_PLATFORM_API const KyCXString& GLB_GetSubsystemName();
HX_PLATFORM_API void GLB_SetSubsystemName(const KyCXString& name);
/// The path of that subsystem in the model.
HX_PLATFORM_API const KyCXString& GLB_GetFullSystemPath();
HX_PLATFORM_API void GLB_SetFullSystemPath(const KyCXString& path);

#endif  // PLATFORM_MODEL_HXCGLOBAL_H
