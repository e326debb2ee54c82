// An object of a chart: a state, a transition, a datum, an event.

#ifndef PLATFORM_MODEL_SC_MODEL_H
#define PLATFORM_MODEL_SC_MODEL_H

#include <memory>

#include "SourceRef/HxCStateflowSrcRef.h"
#include "platform/model/HX_ModelStandIn.h"
#include "platform/strings/KyCXString.h"

class HX_Block;
class SC_State;

/// Owns one source reference to itself.
class SC_Model : public SC_ModelStandIn {
 public:
  using SC_ModelStandIn::SC_ModelStandIn;
  SC_Model(const SC_Model&) = delete;
  SC_Model& operator=(const SC_Model&) = delete;
  virtual ~SC_Model() = default;

  /// Unique in the whole model.
  int getId() const { return m_Id; }
  /// Zero-terminated, never null.
  const char* getName() const { return m_Name.cstring(); }
  /// The name with the path in the chart, for readers.
  const KyCXString& getSFName() const { return m_SFName; }
  /// The names of the states around the object, joined for C names.
  const KyCXString& getHierarchy() const { return m_Hierarchy; }
  /// Counts the objects of one chart.
  virtual int getObjectNumber() const { return m_Number; }
  /// The block around the chart; null if unknown.
  virtual HX_Block* getContainingBlock() const { return m_pBlock; }

  /// The reference to the object; the same on every call. Null without memory.
  /// OWNERSHIP: the object's.
  const HxCStateflowSrcRef* getStateflowSrcRef() const {
    if (!m_pSrcRef)
      m_pSrcRef.reset(new HxCStateflowSrcRef(const_cast<SC_Model*>(this)));
    return m_pSrcRef.get();
  }

 private:
  mutable std::unique_ptr<HxCStateflowSrcRef> m_pSrcRef;  // made on demand
};

/// Reaches from an object to the chart around the object.
class SC_ModelAccess : public SC_ModelAccessStandIn {
 public:
  /// The state that stands for the chart of \p object; may be null.
  static SC_State* getChartState(SC_Model* object) {
    return object->m_pChartState;
  }
};

#endif  // PLATFORM_MODEL_SC_MODEL_H
