// Access to the simulation tool's data.

#ifndef PLATFORM_MATLAB_HX_SIMULINKINTERFACE_H
#define PLATFORM_MATLAB_HX_SIMULINKINTERFACE_H

class HX_SimulinkInterface {
 public:
  /// A handle that no block has.
  static constexpr double s_invalidHandle = -1.0;
};

#endif  // PLATFORM_MATLAB_HX_SIMULINKINTERFACE_H
