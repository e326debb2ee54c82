// The objects of the data dictionary, as a tree of paths.
//
//   HX_DdTree& tree = HX_DdTree::instance();
//   tree.add("//DD0/Pool/Variables/Ctrl/speed");      // parents come with it
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

/// Paths begin with "//DD0"; a path that begins with one '/' counts from there.
/// Names compare by character. Handles count from 1 and stay until clear().
class HX_PLATFORM_API HX_DdTree {
 public:
  /// A handle that no object has.
  static constexpr unsigned long kInvalidHandle = ~0UL;
  /// The kind of software components.
  static constexpr unsigned short kSoftwareComponent = 145;

  /// A property that refers to another object by its path below the pool.
  struct Reference {
    std::string property;  ///< its name
    std::string path;      ///< without a '/' in front
  };

  /// The one tree of the process.
  static HX_DdTree& instance();
  /// Deletes all objects.
  void clear();

  /// The handle of the object at \p path, which is made if it is new, like
  /// every missing object above it (with kind 0).
  unsigned long add(const std::string& path, unsigned short kind = 0);
  /// Adds a property, whether or not there is one of that name; needs a valid
  /// handle.
  void addReference(unsigned long handle, const std::string& property,
                    const std::string& path);

  /// kInvalidHandle if there is no such object.
  unsigned long find(const std::string& path) const;
  bool isValid(unsigned long handle) const;

  /// These need a valid handle.
  const std::string& path(unsigned long handle) const;
  std::string name(unsigned long handle) const;
  const std::vector<Reference>& references(unsigned long handle) const;
  /// Handles of the children of one kind, in the order of their making.
  std::vector<unsigned long> children(unsigned long handle,
                                      unsigned short kind) const;

 private:
  struct Object {
    std::string path;
    unsigned short kind;
    std::vector<unsigned long> children;  // in the order of their making
    std::vector<Reference> references;
  };

  const Object& object(unsigned long handle) const {
    return m_Objects[handle - 1];
  }

  std::vector<Object> m_Objects;
  std::unordered_map<std::string, unsigned long> m_Handles;  // by path
};

#endif  // PLATFORM_DATADICTIONARY_HX_DDTREE_H
