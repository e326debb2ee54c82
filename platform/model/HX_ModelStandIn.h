// Fills the stand-in of the block model: constructors, setters and data of the
// model classes. A host with a model of its own needs none of them; the headers
// of the classes show the calls of the library alone.
//
//   HX_Block model("cruise_control");
//   HX_Block controller("Controller", &model);
//   controller.setSubsystem("a", 1);
//   HX_Block gain("Speed Gain", &controller);   // in subsystem a1 as well

#ifndef PLATFORM_MODEL_HX_MODELSTANDIN_H
#define PLATFORM_MODEL_HX_MODELSTANDIN_H

#include <map>
#include <string>

#include "platform/HX_PlatformExport.h"
#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/strings/KyCXString.h"

class HX_Block;
class HX_DataType;
class HX_DataTypeServer;
class HX_OptionsExt;
class HX_SlBlockHandlesDB;
class HxCIvData;
class SC_State;

/// Base of HX_Block. The parent is not owned and outlives the block.
class HX_BlockStandIn {
 public:
  /// Reads as a negative number: the block lies in no numbered subsystem.
  static constexpr unsigned int kNoSubsystem = 0xFFFFFFFF;

  /// A block of \p name, without a path, below \p parent; a null \p parent
  /// makes a model.
  explicit HX_BlockStandIn(const KyCXString& name, HX_Block* parent = nullptr)
      : m_Name(name), m_pParent(parent) {}

  /// Makes the block a subsystem that all blocks below belong to.
  void setSubsystem(const KyCXString& id, unsigned int number) {
    m_SubsystemId = id;
    m_SubsystemNumber = number;
    m_IsSubsystem = true;
  }
  /// A block inside a masked library block may be named through the parent.
  void setNamedThroughParent(bool named) { m_NamedThroughParent = named; }

 protected:
  KyCXString m_Name;
  HX_Block* m_pParent;
  KyCXString m_SubsystemId;
  unsigned int m_SubsystemNumber = kNoSubsystem;
  bool m_IsSubsystem = false;
  bool m_NamedThroughParent = false;
};

/// Base of SC_Model. Block and chart state are not owned.
class SC_ModelStandIn {
 public:
  /// \param id  unique in the whole model
  /// \param number  counts the objects of one chart
  SC_ModelStandIn(int id, int number, const KyCXString& name)
      : m_Id(id), m_Number(number), m_Name(name), m_SFName(name) {}

  /// Sets the name with the path in the chart; at first the name alone.
  void setSFName(const KyCXString& name) { m_SFName = name; }
  /// Sets the names of the states around the object, joined for C names.
  void setHierarchy(const KyCXString& text) { m_Hierarchy = text; }
  /// Sets the block around the chart.
  void setContainingBlock(HX_Block* block) { m_pBlock = block; }

 protected:
  friend class SC_ModelAccess;
  friend class SC_ModelAccessStandIn;

  int m_Id;
  int m_Number;
  KyCXString m_Name;
  KyCXString m_SFName;
  KyCXString m_Hierarchy;
  HX_Block* m_pBlock = nullptr;
  SC_State* m_pChartState = nullptr;
};

/// Base of SC_ModelAccess.
class SC_ModelAccessStandIn {
 public:
  /// Sets the state that stands for the chart of \p object.
  static void setChartState(SC_ModelStandIn* object, SC_State* state) {
    object->m_pChartState = state;
  }
};

/// Base of HxCSymbol. The data type is not owned.
class HX_SymbolStandIn {
 public:
  /// \param kind  a HxCSymbol::HxESymbolKindTag, or a number of the host
  HX_SymbolStandIn(const KyCXString& name, int kind,
                   HX_DataType* dataType = nullptr)
      : m_Name(name), m_Kind(kind), m_pDataType(dataType) {}

  /// Sets the text for the macro $X.
  void setDollarX(const char* text) { m_DollarX = text; }

 protected:
  KyCXString m_Name;
  int m_Kind;
  HX_DataType* m_pDataType;
  std::string m_DollarX;
};

/// Base of HX_Options.
class HX_OptionsStandIn {
 public:
  /// Sets what the options of the same names answer.
  void setLimitVariableNameLength(bool limit) { m_LimitNames = limit; }
  void setHxSystemID(const KyCXString& id) { m_SystemId = id; }

 protected:
  bool m_LimitNames = false;
  KyCXString m_SystemId;
};

/// Base of the tables of block handles. Keys are copied, blocks not owned.
template <class Key>
class HX_HandlesStandIn {
 public:
  /// Enters a block, or gives the block a different handle.
  void setSlBlockHandle(Key key, double handle) { m_Handles[key] = handle; }

 protected:
  double find(Key key) const {
    const auto found = m_Handles.find(key);
    return found == m_Handles.end() ? HX_SimulinkInterface::s_invalidHandle
                                    : found->second;
  }

 private:
  std::map<Key, double> m_Handles;
};

/// Base of HxCGlobal: sets the entries.
///
/// OWNERSHIP: the host's; all that is set outlives the use. Null sets the
/// default again: default options, an empty table of handles, and null for the
/// intermediate view and the data types.
class HX_PLATFORM_API HX_GlobalStandIn {
 public:
  static void setOptions(HX_OptionsExt* options);
  static void setSlBlockHandlesDB(HX_SlBlockHandlesDB* handles);
  static void setIvData(HxCIvData* ivData);
  static void setDataTypeServer(HX_DataTypeServer* server);
};

/// Set the names that the functions without "Set" return; empty at first.
HX_PLATFORM_API void GLB_SetModelName(const KyCXString& name);
HX_PLATFORM_API void GLB_SetSubsystemName(const KyCXString& name);
HX_PLATFORM_API void GLB_SetFullSystemPath(const KyCXString& path);

#endif  // PLATFORM_MODEL_HX_MODELSTANDIN_H
