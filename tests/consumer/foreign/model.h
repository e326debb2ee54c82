// A block model from elsewhere: one tree of parts, and only the questions that
// the library asks.

#ifndef FOREIGN_MODEL_H
#define FOREIGN_MODEL_H

#include "SourceRef/HxCBlockSrcRef.h"
#include "SourceRef/HxCStateflowSrcRef.h"
#include "text.h"

class HX_DataType;
class HX_DataTypeServer;
class SC_State;
struct SC_Chart;

// A block with the identifier of the subsystem that contains the block.
class HX_Block {
 public:
  HX_Block(const char* name, const char* subsystem)
      : m_Name(name), m_Subsystem(subsystem) {}

  const KyCXString& getName() const { return m_Name; }
  HX_Block* getParent() { return nullptr; }
  const KyCXString* getSubsystemId() const { return &m_Subsystem; }
  unsigned int getSubsystemNumber() const { return 1; }
  void getFullPathName(KyCXString& path, bool, bool) const { path = m_Name; }
  const HxCBlockSrcRef* getSrcRef() const { return &m_Reference; }
  HX_Block* isNamedThroughParent() { return nullptr; }
  class HX_StateflowBlock* isStateflowBlock() {
    return nullptr;
  }

 private:
  KyCXString m_Name;
  KyCXString m_Subsystem;
  HxCBlockSrcRef m_Reference{this};
};

struct HX_StateflowBlock : HX_Block {
  SC_State* getChartState() const { return nullptr; }
};

struct HX_BdBlock {
  const KyCXString& getRawName() const { return rawName; }
  const HxCSrcRef* getSrcRef() const { return nullptr; }
  KyCXString rawName;
};

class SC_Model {
 public:
  int getId() const { return 1; }
  const char* getName() const { return "object"; }
  const KyCXString& getSFName() const { return m_Name; }
  const KyCXString& getHierarchy() const { return m_Name; }
  int getObjectNumber() const { return 1; }
  HX_Block* getContainingBlock() const { return nullptr; }
  const HxCStateflowSrcRef* getStateflowSrcRef() const { return &m_Reference; }

 private:
  KyCXString m_Name = "object";
  HxCStateflowSrcRef m_Reference{this};
};

struct SC_Chart {
  const KyCXString& getSubsystemId() const { return subsystemId; }
  KyCXString subsystemId;
};

class SC_State : public SC_Model {
 public:
  SC_Chart* getChart() const { return nullptr; }
};

struct SC_ModelAccess {
  static SC_State* getChartState(SC_Model*) { return nullptr; }
};

class HxCSymbol {
 public:
  static constexpr int sm_MaxNameLength = 31;
  enum HxESymbolKindTag { eVariable = 1, eConstant = 2, eFunction = 3 };

  const KyCXString& getName() const { return m_Name; }
  int getKind() const { return eVariable; }
  HX_DataType* getDataType() const { return nullptr; }
  char* getDollarX() { return m_DollarX; }

 private:
  KyCXString m_Name;
  char m_DollarX[1] = "";
};

struct HX_BcPartitionContext {
  const KyCXString& getSubsystemIdentifier() const { return id; }
  KyCXString id;
};
struct HX_BdPartition {
  HX_BcPartitionContext* getPartitionContext() const { return nullptr; }
};
struct HxCIvData {
  HX_BdPartition* getIvHxRootPartition() const { return nullptr; }
};

class HX_Options {
 public:
  bool getLimitVariableNameLength() const { return true; }
  const KyCXString& getHxSystemID() const { return m_SystemId; }

 private:
  KyCXString m_SystemId;
};
struct HX_OptionsExt : HX_Options {};

struct HX_SlBlockHandlesDB {
  double getSlBlockHandle(const HX_Block*) const { return 1.0; }
};
struct HX_BlockDataBase {
  double getSlBlockHandle(int) const { return 1.0; }
};
struct HX_InputBlockId {
  int getBlockId() const { return 1; }
  HX_BlockDataBase& getBlockDataBase() const { return blocks; }
  HX_BlockDataBase& blocks;
};

struct HxCGlobal {
  static HX_OptionsExt* getOptions() { return &s_options; }
  static HX_SlBlockHandlesDB* getSlBlockHandlesDB() { return &s_handles; }
  static HxCIvData* getIvData() { return nullptr; }
  static HX_DataTypeServer* getDataTypeServer() { return nullptr; }

  static inline HX_OptionsExt s_options;
  static inline HX_SlBlockHandlesDB s_handles;
};

inline const KyCXString s_modelName("foreign");
inline const KyCXString& GLB_GetModelName() { return s_modelName; }
inline const KyCXString& GLB_GetSubsystemName() { return s_modelName; }
inline const KyCXString& GLB_GetFullSystemPath() { return s_modelName; }

#endif  // FOREIGN_MODEL_H
