// Questions to the simulation tool.
//
//   mxArray* path = mxCreateString("cruise/Gain 1");
//   mxArray* handle = HX_SimulinkInterface::getMxSlData(path, "Handle");

#ifndef PLATFORM_MATLAB_HX_SIMULINKINTERFACE_H
#define PLATFORM_MATLAB_HX_SIMULINKINTERFACE_H

#include "platform/HX_PlatformExport.h"
#include "platform/matlab/HX_MxArray.h"

class HX_SimulinkTree;
class KyCXString;

/// Asks the open model; one for the process.
class HX_PLATFORM_API HX_SimulinkInterface {
 public:
  /// A handle that no block has.
  static const double s_invalidHandle;  // -1.0

  /// The value of a parameter of the block that \p object names, a handle or a
  /// path.
  /// RETURNS: a new array; null for a null or unknown object, an unknown
  /// parameter, and while no model is open.
  /// OWNERSHIP: the caller's.
  static mxArray* getMxSlData(mxArray* object, const KyCXString& parameter);

  /// Not called by the library: makes \p tree the open model; null for none.
  /// OWNERSHIP: the host's; \p tree outlives its use.
  static void setTree(const HX_SimulinkTree* tree);
};

#endif  // PLATFORM_MATLAB_HX_SIMULINKINTERFACE_H
