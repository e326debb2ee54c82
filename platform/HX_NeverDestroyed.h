// Storage for a static object that the end of the process does not destroy.
//
//   Registry& registry() {
//     static HX_NeverDestroyed<Registry> s_registry;
//     return s_registry.value;
//   }
//
// A host's static objects may still call the platform layer from their
// destructors. The order of destruction is not ours to choose, so nothing that
// such a call reaches has a destructor that runs.

#ifndef PLATFORM_HX_NEVERDESTROYED_H
#define PLATFORM_HX_NEVERDESTROYED_H

/// Constructs the value and never runs the destructor of T. The value lies
/// inside the object, so leak checkers see everything the value owns.
template <class T>
union HX_NeverDestroyed {
  HX_NeverDestroyed() : value() {}
  HX_NeverDestroyed(const HX_NeverDestroyed&) = delete;
  HX_NeverDestroyed& operator=(const HX_NeverDestroyed&) = delete;
  ~HX_NeverDestroyed() {}  // NOLINT(modernize-use-equals-default)

  T value;  ///< valid from the construction to the end of the process
};

#endif  // PLATFORM_HX_NEVERDESTROYED_H
