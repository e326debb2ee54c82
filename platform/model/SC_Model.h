// An object of a chart: a state, a transition, a datum, an event.

#ifndef PLATFORM_MODEL_SC_MODEL_H
#define PLATFORM_MODEL_SC_MODEL_H

#include <memory>

#include "SourceRef/HxCStateflowSrcRef.h"
#include "platform/strings/KyCXString.h"

class HX_Block;
class SC_State;

/// Owns its source reference; block and chart state are not owned.
class SC_Model {
 public:
  /// \param id  unique in the whole model
  /// \param number  counts the objects of one chart
  SC_Model(int id, int number, const KyCXString& name)
      : m_Id(id), m_Number(number), m_Name(name), m_SFName(name) {}
  SC_Model(const SC_Model&) = delete;
  SC_Model& operator=(const SC_Model&) = delete;
  virtual ~SC_Model() = default;

  /// As given to the constructor.
  int getId() const { return m_Id; }
  const char* getName() const { return m_Name.cstring(); }
  /// The name with its path in the chart, as a user reads it.
  const KyCXString& getSFName() const { return m_SFName; }
  void setSFName(const KyCXString& name) { m_SFName = name; }
  /// The names of the states around the object, joined for use in C names.
  const KyCXString& getHierarchy() const { return m_Hierarchy; }
  void setHierarchy(const KyCXString& text) { m_Hierarchy = text; }

  /// The number in its chart, as given to the constructor.
  virtual int getObjectNumber() const { return m_Number; }

  /// The block that contains the object.
  virtual HX_Block* getContainingBlock() const { return m_pBlock; }
  void setContainingBlock(HX_Block* block) { m_pBlock = block; }

  /// The reference to this object, owned by it; the same on every call.
  const HxCStateflowSrcRef* getStateflowSrcRef() const {
    if (!m_pSrcRef)
      m_pSrcRef.reset(new HxCStateflowSrcRef(const_cast<SC_Model*>(this)));
    return m_pSrcRef.get();
  }

 private:
  friend class SC_ModelAccess;

  int m_Id;
  int m_Number;
  KyCXString m_Name;
  KyCXString m_SFName;
  KyCXString m_Hierarchy;
  HX_Block* m_pBlock = nullptr;
  SC_State* m_pChartState = nullptr;
  mutable std::unique_ptr<HxCStateflowSrcRef> m_pSrcRef;  // made on demand
};

/// Reaches from an object to the chart around it.
class SC_ModelAccess {
 public:
  /// The state that stands for the object's chart; null if there is none.
  static SC_State* getChartState(SC_Model* object) {
    return object->m_pChartState;
  }
  static void setChartState(SC_Model* object, SC_State* state) {
    object->m_pChartState = state;
  }
};

#endif  // PLATFORM_MODEL_SC_MODEL_H
