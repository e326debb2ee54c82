// Storage for a static object that the end of the process does not destroy.
//
//   Registry& registry() {
//     static HX_NeverDestroyed<Registry> s_registry;
//     return s_registry.value;
//   }
//
// Destructors of a host's static objects may still call the platform layer, and
// the order of destruction is not ours to choose. Therefore objects within
// reach of these calls have no destructor at the end of the process.

#ifndef PLATFORM_HX_NEVERDESTROYED_H
#define PLATFORM_HX_NEVERDESTROYED_H

/// Constructs the value and never runs the destructor of T. The value lies
/// inside the object: leak checkers see all blocks of the value.
template <class T>
union HX_NeverDestroyed {
  HX_NeverDestroyed() : value() {}
  HX_NeverDestroyed(const HX_NeverDestroyed&) = delete;
  HX_NeverDestroyed& operator=(const HX_NeverDestroyed&) = delete;
  ~HX_NeverDestroyed() {}  // NOLINT(modernize-use-equals-default)

  T value;  ///< valid from the construction to the end of the process
};

#endif  // PLATFORM_HX_NEVERDESTROYED_H
