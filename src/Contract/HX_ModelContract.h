// What the library calls of a host's model: blocks, charts, data types, symbols
// and what is known of the whole model.
//
// The library reads the model and never changes it. Null is an answer of every
// pointer unless a comment says otherwise.

#ifndef CONTRACT_HX_MODELCONTRACT_H
#define CONTRACT_HX_MODELCONTRACT_H

#include <concepts>

/// HX_Block. getSubsystemId() is never null; getFullPathName() replaces the
/// path, its flags leave the root out and double each '/' inside a name.
template <class Block, class Text, class SrcRef>
concept HX_BlockContract = requires(Block block, const Block constant,
                                    Text path, bool flag) {
  { constant.getName() } -> std::convertible_to<const Text&>;
  { block.getParent() } -> std::convertible_to<const Block*>;
  { constant.getSubsystemId() } -> std::convertible_to<const Text*>;
  { constant.getSubsystemNumber() } -> std::convertible_to<unsigned int>;
  { constant.getSrcRef() } -> std::convertible_to<const SrcRef*>;
  constant.getFullPathName(path, flag, flag);
  { block.isNamedThroughParent() == nullptr } -> std::same_as<bool>;
  block.isStateflowBlock()->getChartState()->getStateflowSrcRef();
};

/// HX_BdBlock, a block of the intermediate view.
template <class Block, class Text, class SrcRef>
concept HX_IvBlockContract = requires(const Block block) {
  { block.getRawName() } -> std::convertible_to<const Text&>;
  { block.getSrcRef() } -> std::convertible_to<const SrcRef*>;
};

/// SC_Model, an object of a chart.
template <class Object, class Text, class SrcRef>
concept HX_ChartObjectContract = requires(const Object object) {
  { object.getId() } -> std::convertible_to<int>;
  { object.getObjectNumber() } -> std::convertible_to<int>;
  { object.getName() } -> std::convertible_to<const char*>;
  { object.getSFName() } -> std::convertible_to<const Text&>;
  { object.getHierarchy() } -> std::convertible_to<const Text&>;
  { object.getStateflowSrcRef() } -> std::convertible_to<const SrcRef*>;
  object.getContainingBlock()->getName();
};

/// SC_State below SC_ModelAccess. The chart of a state is not null.
template <class Access, class Object, class Text>
concept HX_ChartContract = requires(Object* object) {
  {
    Access::getChartState(object)->getChart()->getSubsystemId()
    } -> std::convertible_to<const Text&>;
};

/// HxCSymbol. getDollarX() is a zero-terminated text and never null.
template <class Symbol, class Text, class Type>
concept HX_SymbolContract = requires(Symbol symbol, const Symbol constant) {
  { Symbol::sm_MaxNameLength } -> std::convertible_to<int>;
  { Symbol::eFunction } -> std::convertible_to<int>;
  { constant.getName() } -> std::convertible_to<const Text&>;
  { constant.getKind() } -> std::convertible_to<int>;
  { constant.getDataType() } -> std::convertible_to<const Type*>;
  { symbol.getDollarX() } -> std::convertible_to<const char*>;
};

/// HxCGlobal. Options and block handles are never null once the host runs.
template <class Global, class Text, class Block>
concept HX_GlobalContract = requires(const Block* block) {
  {
    Global::getOptions()->getLimitVariableNameLength()
    } -> std::convertible_to<bool>;
  { Global::getOptions()->getHxSystemID() } -> std::convertible_to<const Text&>;
  {
    Global::getSlBlockHandlesDB()->getSlBlockHandle(block)
    } -> std::convertible_to<double>;
  {
    Global::getIvData()
        ->getIvHxRootPartition()
        ->getPartitionContext()
        ->getSubsystemIdentifier()
    } -> std::convertible_to<const Text&>;
  Global::getDataTypeServer()->getBaseServer()->getBitfieldBaseType();
};

/// HX_InputBlockId, a block as the model reader knows the block.
template <class Id>
concept HX_InputBlockContract = requires(const Id id) {
  {
    id.getBlockDataBase().getSlBlockHandle(id.getBlockId())
    } -> std::convertible_to<double>;
};

/// HX_DataType and HX_BaseTypeProperties, whose getCut() is never null.
template <class Type, class Text, class SrcRef>
concept HX_DataTypeContract = requires(Type type, const Type constant) {
  { constant.getSrcRef() } -> std::convertible_to<const SrcRef*>;
  { constant.getNameInCode() } -> std::convertible_to<const Text&>;
  { type.isUnnamedStruct() } -> std::convertible_to<bool>;
  { type.isUnnamedEnum() } -> std::convertible_to<bool>;
  { type.getNameObject() == nullptr } -> std::same_as<bool>;
  { type.isBitfield() } -> std::convertible_to<bool>;
  { type.isDerived() } -> std::convertible_to<bool>;
  { type.getDerivedFrom() } -> std::convertible_to<Type*>;
  { type.isBaseType() } -> std::convertible_to<bool>;
  { type.is64BitInteger() } -> std::convertible_to<bool>;
  { type.getUnderlyingType() } -> std::convertible_to<Type*>;
  { *type.getBaseTypeProperties()->getCut() } -> std::convertible_to<Text>;
  { type.getNumericalType()->isSigned() } -> std::convertible_to<bool>;
};

/// HX_NumericalType: the range of the values is closed.
template <class Type>
concept HX_NumericalTypeContract = requires(const Type type) {
  { type.getMaximum() } -> std::convertible_to<double>;
  { type.getMinimum() } -> std::convertible_to<double>;
  { type.getBitWidth() } -> std::convertible_to<int>;
  { type.isSigned() } -> std::convertible_to<bool>;
};

/// HX_DataTypeServer: getAsScalar() gives the element type of an array.
template <class Server, class Type, class SrcRef>
concept HX_DataTypeServerContract = requires(Server server, Type* type,
                                             const SrcRef* srcRef) {
  { server.getAsScalar(type, srcRef) } -> std::convertible_to<Type*>;
  server.getBaseServer()->getBitfieldBaseType();
};

#endif  // CONTRACT_HX_MODELCONTRACT_H
