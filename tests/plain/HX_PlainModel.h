// The facts of a model that names and source references depend on. Objects are
// known by their index; kNone is no object.

#ifndef PLAIN_HX_PLAINMODEL_H
#define PLAIN_HX_PLAINMODEL_H

#include "plain/HX_PlainText.h"

namespace plain {

constexpr int kNone = -1;

struct Block {
  Text name;
  int parent = kNone;
  bool isSubsystem = false;
  Text systemId;
  unsigned int number = 0xFFFFFFFF;
  bool isNamedThroughParent = false;
  bool isChart = false;
  int chartState = kNone;  // an object
  double handle = -1;      // -1: not known to the simulation tool
};

struct Object {
  int id = 0;
  int number = 0;
  Text name, sfName, hierarchy;
  int block = kNone;
  int chartState = kNone;  // an object with a chart
  int chart = kNone;       // of a state
};

struct IvBlock {
  Text rawName;
  int ref = kNone;
};

struct Type {
  Text name;
  bool hasCut = false;
  Text cut;
  int unnamed = 0;  // 1 or 2: the first or the second unnamed kind
  bool hasNameObject = false;
  bool isBitfield = false, isDerived = false, isBase = false, is64Bit = false;
  bool isNumerical = false, isSigned = false;
  int origin = kNone, underlying = kNone, element = kNone;  // types
};

struct Symbol {
  Text name;
  int kind = 0;
  Text dollarX;
  int type = kNone;
};

struct DdObject {
  std::string path;
  unsigned long handle = 0;  // from the dictionary
};

struct Component {
  struct Property {
    std::string name, path;
  };
  std::string name;
  std::vector<Property> relatedVariables;
};

/// A block in the tree of the simulation tool.
struct InputBlock {
  Text name;
  int parent = kNone;
  double handle = 0;  // from the tree
};

struct Ref {
  enum Kind { eOther, eInternal, eBlock, eStateflow, eDd, eInput };
  Kind kind = eOther;
  int id = 0;
  Text file, cause;
  int line = 0;
  int target = kNone;  // block, object or input block
  unsigned long handle = 0;
};

struct Model {
  Text modelName, subsystemName;
  int rootDepth = 0;  // 1 view, 2 with partition, 3 with context
  Text contextId, optionsId;
  bool limitsNames = false;
  std::vector<Block> blocks;
  std::vector<Object> objects;
  std::vector<Text> charts;  // subsystem ids
  std::vector<IvBlock> ivBlocks;
  std::vector<Type> types;
  int bitfieldBase = kNone;
  std::vector<Symbol> symbols;
  std::vector<DdObject> dd;
  bool hasComponents = false;
  std::vector<Component> components;
  std::vector<InputBlock> inputs;
  int system = kNone;     // the generated system among the inputs
  std::vector<Ref> refs;  // first of all blocks, then of all objects, more

  std::size_t ownRefs() const { return blocks.size() + objects.size(); }
  int blockRef(int block) const { return block; }
  int objectRef(int object) const {
    return static_cast<int>(blocks.size()) + object;
  }
  /// The subsystem that a block is or lies in; else the outermost block.
  const Block& subsystem(int block) const {
    const Block* found = &at(blocks, block);
    while (!found->isSubsystem && found->parent != kNone)
      found = &at(blocks, found->parent);
    return *found;
  }

  template <class T>
  static const T& at(const std::vector<T>& all, int i) {
    return all.at(static_cast<std::size_t>(i));
  }
};

constexpr unsigned long kUnknownHandle = 4711;

/// Path of a data dictionary object, or the handle.
inline std::string ddPath(const Model& model, unsigned long handle) {
  for (const DdObject& object : model.dd)
    if (object.handle == handle) return object.path;
  return "Handle: " + std::to_string(handle);
}

}  // namespace plain

#endif  // PLAIN_HX_PLAINMODEL_H
