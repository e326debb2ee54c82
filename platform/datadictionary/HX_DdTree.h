// The objects of the data dictionary, as a tree of paths: fills the stand-in.
//
//   HX_DdTree& tree = HX_DdTree::instance();
//   tree.add("//DD0/Pool/Variables/Ctrl/speed");      // and the parents
//   auto c = tree.add("//DD0/Pool/Autosar/SoftwareComponents/Engine",
//                     HX_DdTree::kSoftwareComponent);
//   tree.addReference(tree.add(tree.path(c) + "/RelatedVariables"),
//                     "In", "Variables/Ctrl");

#ifndef PLATFORM_DATADICTIONARY_HX_DDTREE_H
#define PLATFORM_DATADICTIONARY_HX_DDTREE_H

#include <string>
#include <unordered_map>
#include <vector>

#include "platform/HX_PlatformExport.h"

/// Paths begin with "//DD0"; a path with a single '/' in front counts from
/// "//DD0".
/// Names compare by character. Handles count from 1 and stay until clear().
class HX_PLATFORM_API HX_DdTree {
 public:
  /// The handle of no object.
  static constexpr unsigned long kInvalidHandle = ~0UL;
  /// The kind of software components.
  static constexpr unsigned short kSoftwareComponent = 145;

  /// A property that refers to an object by the path below the pool.
  struct Reference {
    std::string property;  ///< name of the property
    std::string path;      ///< without a '/' in front
  };

  /// The tree of the process. The end of the process does not destroy the tree.
  static HX_DdTree& instance();
  /// Deletes all objects.
  void clear();

  /// Makes the object at \p path unless present, and every missing object above
  /// with kind 0. A \p kind other than 0 also changes a present object.
  /// RETURNS: the handle of the object.
  unsigned long add(const std::string& path, unsigned short kind = 0);
  /// Adds a property; several properties may have the same name.
  /// REQUIRES: a valid handle.
  void addReference(unsigned long handle, const std::string& property,
                    const std::string& path);

  /// kInvalidHandle for an unknown path; whether a handle is known.
  unsigned long find(const std::string& path) const;
  bool isValid(unsigned long handle) const;

  /// REQUIRES: a valid handle.
  const std::string& path(unsigned long handle) const;
  std::string name(unsigned long handle) const;
  const std::vector<Reference>& references(unsigned long handle) const;
  /// Handles of the children of one kind, in the order of creation.
  std::vector<unsigned long> children(unsigned long handle,
                                      unsigned short kind) const;

 private:
  struct Object {
    std::string path;
    unsigned short kind;
    std::vector<unsigned long> children;  // in the order of creation
    std::vector<Reference> references;
  };

  const Object& object(unsigned long handle) const {
    return m_Objects[handle - 1];
  }

  std::vector<Object> m_Objects;
  std::unordered_map<std::string, unsigned long> m_Handles;  // by path
};

#endif  // PLATFORM_DATADICTIONARY_HX_DDTREE_H
