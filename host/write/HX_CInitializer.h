// Initial values of a variable as C.
//
//   HX_CInitializer initializer(name);
//   initializer.text();    // "{1, {2U, 3U}}"
//   initializer.unfit();   // physical values that were saturated

#ifndef HOST_WRITE_HX_CINITIALIZER_H
#define HOST_WRITE_HX_CINITIALIZER_H

#include <string>
#include <vector>

#include "host/names/HX_FormedName.h"

/// Values of the document go to the scalars of the type in their order. Values
/// are scaled to steps of the type, rounded and saturated as in the simulation.
/// Scalars without a value are 0; an array ends behind its last value. Braces
/// are complete, and no field of a structure is left out: compilers warn of
/// both.
class HX_CInitializer {
 public:
  /// REQUIRES: the variable has an initial value.
  explicit HX_CInitializer(const HX_FormedName& name);

  const std::string& text() const { return m_Text; }
  const std::vector<double>& unfit() const { return m_Unfit; }

 private:
  bool hasValue() const { return m_At < m_Wanted.initial.size(); }
  void append(const HX_TypeItem& type);
  void appendScalar(const HX_TypeItem& type);
  double stepsOf(const HX_TypeItem& type, double physical);

  const HX_WantedName& m_Wanted;
  std::size_t m_At = 0;  // of the next value
  std::string m_Text;
  std::vector<double> m_Unfit;
};

#endif  // HOST_WRITE_HX_CINITIALIZER_H
