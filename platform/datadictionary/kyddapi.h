// The client interface of the data dictionary.
//
// OWNERSHIP: texts and lists handed out belong to the caller, who returns them
// with DDAPIHeapFree(); the head of a list returns the whole list. Without
// memory a text is null and the result false, a list is empty.

#ifndef PLATFORM_DATADICTIONARY_KYDDAPI_H
#define PLATFORM_DATADICTIONARY_KYDDAPI_H

#include "platform/HX_PlatformExport.h"

/// Returns a text or a list of the interface; null is ignored.
HX_PLATFORM_API void DDAPIHeapFree(void* block);

/// Not called by the library: the number of blocks handed out and not returned
/// yet. A block returned twice counts twice.
HX_PLATFORM_API int DDAPIHeapBalance();

namespace kyddapi {

/// An element of a list of handles.
struct KYSDDHandleNode {
  KYSDDHandleNode* next;  ///< null at the end
  unsigned long handle;   ///< of an object
};

/// A connection to one object of the data dictionary.
class HX_PLATFORM_API KYCDDObject {
 public:
  /// The handle -1 (all bits set) makes an unconnected object.
  explicit KYCDDObject(unsigned long handle) : m_Handle(handle) {}

  /// RETURNS: false for no object; the connection is gone then.
  bool ConnectToDDObject(const char* path);
  bool ConnectToDDObject(unsigned long handle);
  unsigned long GetHandle() const { return m_Handle; }

  /// The child objects of one kind in the order of the dictionary.
  /// \param[out] error  0, or 1 for an unconnected object
  /// \return the head of the list, null for none
  KYSDDHandleNode* GetChildObjects(unsigned short kind, long& count,
                                   unsigned short& error) const;

  /// The number of properties that refer to objects.
  long GetNumOfProps() const;
  /// The path in property \p index; the last argument is reserved.
  /// RETURNS: false, with nothing handed out, for an index out of range.
  bool ReadRefPathFromDDK(long index, char*& path, unsigned long& length,
                          unsigned short reserved) const;
  /// The name of property \p index, and the length of the name in bytes.
  /// RETURNS: false, with nothing handed out, for an index out of range.
  bool GetPropertyName(char*& name, unsigned short& length, long index) const;
  /// The object's own name; false for an unconnected object.
  bool GetName(char*& name, unsigned short& length) const;

 private:
  unsigned long m_Handle;
};

/// A software component; the kind of the object is not checked.
class HX_PLATFORM_API KYCDDSoftwareComponent : public KYCDDObject {
 public:
  using KYCDDObject::KYCDDObject;

  /// The list of the variables of the component, one property per variable;
  /// unconnected for a component without a list.
  KYCDDObject GetRelatedVariables(unsigned short& error) const;
};

}  // namespace kyddapi

#endif  // PLATFORM_DATADICTIONARY_KYDDAPI_H
