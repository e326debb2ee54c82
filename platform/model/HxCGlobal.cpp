#include "platform/model/HxCGlobal.h"

#include "platform/HX_NeverDestroyed.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HX_SlBlockHandlesDB.h"

namespace {

struct Global {
  HX_OptionsExt defaultOptions;
  HX_SlBlockHandlesDB defaultHandles;
  HX_OptionsExt* options = &defaultOptions;
  HX_SlBlockHandlesDB* handles = &defaultHandles;
  HxCIvData* ivData = nullptr;
  HX_DataTypeServer* dataTypeServer = nullptr;
  KyCXString modelName;
  KyCXString subsystemName;
  KyCXString systemPath;
};

Global& global() {
  static HX_NeverDestroyed<Global> s_global;
  return s_global.value;
}

}  // namespace

HX_OptionsExt* HxCGlobal::getOptions() { return global().options; }

void HX_GlobalStandIn::setOptions(HX_OptionsExt* options) {
  global().options = options != nullptr ? options : &global().defaultOptions;
}

HX_SlBlockHandlesDB* HxCGlobal::getSlBlockHandlesDB() {
  return global().handles;
}

void HX_GlobalStandIn::setSlBlockHandlesDB(HX_SlBlockHandlesDB* handles) {
  global().handles = handles != nullptr ? handles : &global().defaultHandles;
}

HxCIvData* HxCGlobal::getIvData() { return global().ivData; }

void HX_GlobalStandIn::setIvData(HxCIvData* ivData) {
  global().ivData = ivData;
}

HX_DataTypeServer* HxCGlobal::getDataTypeServer() {
  return global().dataTypeServer;
}

void HX_GlobalStandIn::setDataTypeServer(HX_DataTypeServer* server) {
  global().dataTypeServer = server;
}

const KyCXString& GLB_GetModelName() { return global().modelName; }

void GLB_SetModelName(const KyCXString& name) { global().modelName = name; }

const KyCXString& GLB_GetSubsystemName() { return global().subsystemName; }

void GLB_SetSubsystemName(const KyCXString& name) {
  global().subsystemName = name;
}

const KyCXString& GLB_GetFullSystemPath() { return global().systemPath; }

void GLB_SetFullSystemPath(const KyCXString& path) {
  global().systemPath = path;
}
