// An object of a chart.

#ifndef SOURCEREF_HXCSTATEFLOWSRCREF_H
#define SOURCEREF_HXCSTATEFLOWSRCREF_H

#include "SourceRef/HxCSrcRef.h"

class SC_Model;

/// Created and owned by the Stateflow model; the object is not owned. Copies
/// keep the number, clones take a new one.
class HX_UTILS_API HxCStateflowSrcRef : public HxCSrcRef {
 public:
  /// No object.
  HxCStateflowSrcRef() = default;
  HxCStateflowSrcRef(const HxCStateflowSrcRef&) = default;
  HxCStateflowSrcRef& operator=(const HxCStateflowSrcRef&) = default;
  ~HxCStateflowSrcRef() override;

  const HxCStateflowSrcRef* isStateflow() const override;
  /// The object's name with its path in the chart; empty without an object.
  void toString(KyCXString& text) const override;

  /// The object's number in the model; -1 without an object.
  virtual int getSfObjectId() const;
  SC_Model* getSfObject() const { return m_pObject; }

 private:
  friend class SC_Model;

  explicit HxCStateflowSrcRef(SC_Model* object);
  HxCSrcRef* clone() const override;

  SC_Model* m_pObject = nullptr;
};

#endif  // SOURCEREF_HXCSTATEFLOWSRCREF_H
