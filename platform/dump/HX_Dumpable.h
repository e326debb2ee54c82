// The base class of objects in a developer dump.

#ifndef PLATFORM_DUMP_HX_DUMPABLE_H
#define PLATFORM_DUMP_HX_DUMPABLE_H

#include "platform/HX_PlatformExport.h"
#include "platform/strings/KyCXString.h"

class HX_Dump;

/// Holds no data; the defaults dump nothing.
class HX_PLATFORM_API HX_Dumpable {
 public:
  HX_Dumpable() = default;
  HX_Dumpable(const HX_Dumpable&) = default;
  HX_Dumpable& operator=(const HX_Dumpable&) = default;
  virtual ~HX_Dumpable();

  /// The file for this object's section; empty for the writer's own choice.
  virtual KyCXString getDumpFileName() const;
  virtual KyCXString getNameForDump() const;
  virtual KyCXString getLinkNameForDump() const;
  virtual KyCXString getColorForDump() const;
  virtual void dumpStart(HX_Dump* dumper, const KyCXString& title) const;
  virtual void dumpFinish(HX_Dump* dumper) const;
  virtual void dump(HX_Dump* dumper, bool recursive) const;
};

#endif  // PLATFORM_DUMP_HX_DUMPABLE_H
