// The client interface of the data dictionary.
//
// Every text and every list that it hands out belongs to the caller, who
// returns it with DDAPIHeapFree(); a list is returned as a whole by its head.

#ifndef PLATFORM_DATADICTIONARY_KYDDAPI_H
#define PLATFORM_DATADICTIONARY_KYDDAPI_H

#include "platform/HX_PlatformExport.h"

/// Returns what the interface handed out; null is ignored.
HX_PLATFORM_API void DDAPIHeapFree(void* block);

/// Blocks handed out and not returned yet; a block returned twice counts as
/// one less each time.
HX_PLATFORM_API int DDAPIHeapBalance();

namespace kyddapi {

/// A handle in a list of them.
struct KYSDDHandleNode {
  KYSDDHandleNode* next;  ///< null at the end
  unsigned long handle;   ///< of an object
};

/// A connection to one object of the data dictionary.
class HX_PLATFORM_API KYCDDObject {
 public:
  /// The handle -1 (all bits set) makes an unconnected object.
  explicit KYCDDObject(unsigned long handle) : m_Handle(handle) {}

  /// False, and unconnected from then on, if there is no such object.
  bool ConnectToDDObject(const char* path);
  bool ConnectToDDObject(unsigned long handle);
  unsigned long GetHandle() const { return m_Handle; }

  /// The child objects of one kind in the order of the dictionary.
  /// \param[out] error  0, or 1 for an unconnected object
  /// \return the head of the list, null for none
  KYSDDHandleNode* GetChildObjects(unsigned short kind, long& count,
                                   unsigned short& error) const;

  /// Number of the properties that refer to other objects.
  long GetNumOfProps() const;
  /// The path that property \p index refers to; the last argument is reserved.
  /// \return false, with nothing handed out, for an index that does not exist
  bool ReadRefPathFromDDK(long index, char*& path, unsigned long& length,
                          unsigned short reserved) const;
  /// The name of property \p index, and its length in bytes. \return false,
  /// with nothing handed out, for an index that does not exist
  bool GetPropertyName(char*& name, unsigned short& length, long index) const;
  /// The object's own name; false for an unconnected object.
  bool GetName(char*& name, unsigned short& length) const;

 private:
  unsigned long m_Handle;
};

/// An object that is a software component; the kind is not checked.
class HX_PLATFORM_API KYCDDSoftwareComponent : public KYCDDObject {
 public:
  using KYCDDObject::KYCDDObject;

  /// The list of the variables that belong to the component, one property
  /// each; unconnected if the component has none.
  KYCDDObject GetRelatedVariables(unsigned short& error) const;
};

}  // namespace kyddapi

#endif  // PLATFORM_DATADICTIONARY_KYDDAPI_H
