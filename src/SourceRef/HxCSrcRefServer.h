// Hands out references to places in the generator's own code, and sorts the
// references of an item by what a message can say about them.
//
//   HxCSrcRefServer server;
//   server.getSrcRef()->setLocation("reader.cpp", 12);
//
//   const HxCSrcRef* block = nullptr;
//   HxCSrcRefServer::getSpecificSrcRefFromSet(&set, &block, nullptr, nullptr);

#ifndef SOURCEREF_HXCSRCREFSERVER_H
#define SOURCEREF_HXCSRCREFSERVER_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "SourceRef/HxCSrcRefSet.h"

class HxCInternalSrcRef;

/// One per run, created by the host. Not copied: two servers would delete the
/// same references.
class HX_UTILS_API HxCSrcRefServer : public HX_Allocated {
 public:
  HxCSrcRefServer() = default;
  HxCSrcRefServer(const HxCSrcRefServer&) = delete;
  HxCSrcRefServer& operator=(const HxCSrcRefServer&) = delete;
  /// Deletes every reference it handed out.
  ~HxCSrcRefServer();

  /// \return true; there is nothing to do
  bool boot() { return true; }
  /// \return true; the references live on until the server is destroyed
  bool shutdown() { return true; }

  /// A new reference with file "file unknown!", line -1 and cause "cause
  /// unknown!", owned by the server; the caller may set all three. Null if
  /// there is no memory.
  HxCInternalSrcRef* getSrcRef();

  /// Sorts the references of \p set into blocks (input blocks included), data
  /// dictionary objects and all others, and stores the last one of each sort;
  /// null where there is none, and everywhere for a null \p set.
  /// \param[out] blockRef, ddRef, otherRef  null for a result not wanted
  /// \return 0, which tells nothing
  static int getSpecificSrcRefFromSet(const HxCSrcRefSet* set,
                                      const HxCSrcRef** blockRef,
                                      const HxCSrcRef** ddRef,
                                      const HxCSrcRef** otherRef);

 private:
  HxCSrcRefSet m_SrcRefs;  // owned references, all HxCInternalSrcRef
};

#endif  // SOURCEREF_HXCSRCREFSERVER_H
