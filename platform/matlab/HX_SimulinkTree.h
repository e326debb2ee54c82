// A small model in place of the simulation tool's: named blocks in a tree.
//
//   HX_SimulinkTree tree;
//   const double model = tree.addBlock("cruise");
//   const double gain = tree.addBlock("Gain 1", model);
//   HX_SimulinkInterface::setTree(&tree);   // "cruise/Gain 1" is known now

#ifndef PLATFORM_MATLAB_HX_SIMULINKTREE_H
#define PLATFORM_MATLAB_HX_SIMULINKTREE_H

#include <map>
#include <vector>

#include "platform/HX_PlatformExport.h"
#include "platform/matlab/HX_MxArray.h"
#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/strings/KyCXString.h"

/// Handles count from 1.0. A path is the names from the model down to the block
/// with '/' between the names; a '/' inside a name is doubled. A model with an
/// empty name has the empty path, and paths below the model begin with '/'.
class HX_PLATFORM_API HX_SimulinkTree {
 public:
  HX_SimulinkTree() = default;
  HX_SimulinkTree(const HX_SimulinkTree&) = default;
  HX_SimulinkTree& operator=(const HX_SimulinkTree&) = default;
  virtual ~HX_SimulinkTree();

  /// Adds a block below \p parent, or a model if \p parent is no block. Names
  /// differ among the blocks of one parent.
  /// RETURNS: the handle of the new block.
  double addBlock(const KyCXString& name,
                  double parent = HX_SimulinkInterface::s_invalidHandle);

  /// RETURNS: the path of a block; empty for an unknown handle.
  KyCXString getPath(double handle) const;

  /// Makes the parameter "Parent" of a block answer \p path, as in a damaged
  /// model. The path of the block stays.
  void setParentPath(double handle, const KyCXString& path);

  /// Parameters of a block, given as a handle or a path:
  ///
  ///   "Name"    text
  ///   "Handle"  double
  ///   "Parent"  text: the path of the parent, empty for a model
  ///
  /// A path of 8-bit characters also names a block whose path has '?' in place
  /// of units above 255.
  /// RETURNS: a new array; null for an unknown block or parameter.
  /// OWNERSHIP: the caller's.
  virtual mxArray* getParameter(const mxArray* object,
                                const KyCXString& parameter) const;

 private:
  struct Block {
    KyCXString name;
    KyCXString path;
    KyCXString parentPath;
  };

  struct TextOrder {
    bool operator()(const KyCXString& a, const KyCXString& b) const {
      return a.compareWith(b) < 0;
    }
  };

  const Block* find(double handle) const;
  double findHandle(const mxArray* object) const;

  std::vector<Block> m_Blocks;  // the block of handle 1.0 first
  // By path and, unless a path says the same, by the 8-bit form of a path.
  std::map<KyCXString, double, TextOrder> m_Handles;
  std::map<KyCXString, double, TextOrder> m_NarrowHandles;
};

#endif  // PLATFORM_MATLAB_HX_SIMULINKTREE_H
