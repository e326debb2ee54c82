// A small model in place of the simulation tool's: named blocks in a tree.
//
//   HX_SimulinkTree tree;
//   const double model = tree.addBlock("cruise");
//   const double gain = tree.addBlock("Gain 1", model);
//   HX_SimulinkInterface::setTree(&tree);   // "cruise/Gain 1" is known now

#ifndef PLATFORM_MATLAB_HX_SIMULINKTREE_H
#define PLATFORM_MATLAB_HX_SIMULINKTREE_H

#include <map>

#include "platform/HX_PlatformExport.h"
#include "platform/matlab/HX_MxArray.h"
#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/strings/KyCXString.h"

/// Handles count from 1.0. A path is the names from the model down to the block
/// with '/' between them; a '/' inside a name is doubled.
class HX_PLATFORM_API HX_SimulinkTree {
 public:
  HX_SimulinkTree() = default;
  HX_SimulinkTree(const HX_SimulinkTree&) = default;
  HX_SimulinkTree& operator=(const HX_SimulinkTree&) = default;
  virtual ~HX_SimulinkTree();

  /// Adds a block, or a model if there is no block \p parent. Names differ
  /// among the blocks of one parent. \return the new block's handle
  double addBlock(const KyCXString& name,
                  double parent = HX_SimulinkInterface::s_invalidHandle);

  /// The path of a block; empty for an unknown handle.
  KyCXString getPath(double handle) const;

  /// Makes a block name \p path as its parent, as a damaged model does. Its
  /// own path stays.
  void setParentPath(double handle, const KyCXString& path);

  /// The value of a parameter of \p object, a handle or a path: the texts
  /// "Name" and "Parent" (the parent's path, empty for a model), and the double
  /// "Handle". A new array, owned by the caller; null for an unknown object or
  /// parameter.
  virtual mxArray* getParameter(const mxArray* object,
                                const KyCXString& parameter) const;

 private:
  struct Block {
    KyCXString name;
    KyCXString path;
    KyCXString parentPath;
  };

  double findHandle(const mxArray* object) const;

  std::map<double, Block> m_Blocks;        // by handle
  std::map<KyCXString, double> m_Handles;  // by path
};

#endif  // PLATFORM_MATLAB_HX_SIMULINKTREE_H
