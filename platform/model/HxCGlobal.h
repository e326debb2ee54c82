// The model and the run, as every component reads them.

#ifndef PLATFORM_MODEL_HXCGLOBAL_H
#define PLATFORM_MODEL_HXCGLOBAL_H

#include "platform/HX_PlatformExport.h"
#include "platform/model/HX_ModelStandIn.h"
#include "platform/strings/KyCXString.h"

class HX_DataTypeServer;
class HX_OptionsExt;
class HX_SlBlockHandlesDB;
class HxCIvData;

/// Each operation reads one entry. OWNERSHIP: the host's.
class HX_PLATFORM_API HxCGlobal : public HX_GlobalStandIn {
 public:
  /// Never null.
  static HX_OptionsExt* getOptions();
  static HX_SlBlockHandlesDB* getSlBlockHandlesDB();

  /// Null until the host sets an entry.
  static HxCIvData* getIvData();
  static HX_DataTypeServer* getDataTypeServer();
};

/// The name of the model, the name of the subsystem and the path of the
/// subsystem that code is generated for.
HX_PLATFORM_API const KyCXString& GLB_GetModelName();
HX_PLATFORM_API const KyCXString& GLB_GetSubsystemName();
HX_PLATFORM_API const KyCXString& GLB_GetFullSystemPath();

#endif  // PLATFORM_MODEL_HXCGLOBAL_H
