// Hands out references to places in the code of the generator, and sorts the
// references of an item by kind.
//
//   HxCSrcRefServer server;
//   if (HxCInternalSrcRef* here = server.getSrcRef())   // null: no memory
//     here->setLocation("reader.cpp", 12);
//
//   const HxCSrcRef* block = nullptr;
//   HxCSrcRefServer::getSpecificSrcRefFromSet(&set, &block, nullptr, nullptr);

#ifndef SOURCEREF_HXCSRCREFSERVER_H
#define SOURCEREF_HXCSRCREFSERVER_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "SourceRef/HxCSrcRefSet.h"

class HxCInternalSrcRef;

/// One server per run, created by the host. Not copied, because two servers
/// would delete the same references.
class HX_UTILS_API HxCSrcRefServer : public HX_Allocated {
 public:
  HxCSrcRefServer() = default;
  HxCSrcRefServer(const HxCSrcRefServer&) = delete;
  HxCSrcRefServer& operator=(const HxCSrcRefServer&) = delete;
  /// Deletes every reference of getSrcRef().
  ~HxCSrcRefServer();

  /// \return true; the operation does nothing else
  bool boot() { return true; }
  /// \return true; all references stay until the server is destroyed
  bool shutdown() { return true; }

  /// RETURNS: a new reference with file "file unknown!", line -1 and cause
  /// "cause unknown!"; the caller may set all three. Null if memory runs out.
  /// OWNERSHIP: the server owns the reference.
  HxCInternalSrcRef* getSrcRef();

  /// Sorts the references of \p set into blocks (input blocks included), data
  /// dictionary objects and all others, and stores the last reference of every
  /// kind. Stores null for a kind without a reference; \p set may be null.
  /// \param[out] blockRef, ddRef, otherRef  null for a result not wanted
  /// \return 0, without meaning
  static int getSpecificSrcRefFromSet(const HxCSrcRefSet* set,
                                      const HxCSrcRef** blockRef,
                                      const HxCSrcRef** ddRef,
                                      const HxCSrcRef** otherRef);

 private:
  HxCSrcRefSet m_SrcRefs;  // owned references, all HxCInternalSrcRef
};

#endif  // SOURCEREF_HXCSRCREFSERVER_H
