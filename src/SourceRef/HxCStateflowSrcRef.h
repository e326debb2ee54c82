// An object of a chart.

#ifndef SOURCEREF_HXCSTATEFLOWSRCREF_H
#define SOURCEREF_HXCSTATEFLOWSRCREF_H

#include "SourceRef/HxCSrcRef.h"

class SC_Model;

/// OWNERSHIP: the Stateflow model creates and owns Stateflow references; a
/// reference never owns the object. Copies keep the number, clones draw a new
/// number.
class HX_UTILS_API HxCStateflowSrcRef : public HxCSrcRef {
 public:
  /// No object.
  HxCStateflowSrcRef() = default;
  HxCStateflowSrcRef(const HxCStateflowSrcRef&) = default;
  HxCStateflowSrcRef& operator=(const HxCStateflowSrcRef&) = default;
  ~HxCStateflowSrcRef() override;

  const HxCStateflowSrcRef* isStateflow() const override;
  /// Replaces \p text by the name of the object with the path in the chart; by
  /// the empty text without an object.
  void toString(KyCXString& text) const override;

  /// The number of the object in the model; -1 without an object.
  virtual int getSfObjectId() const;
  SC_Model* getSfObject() const { return m_pObject; }

 private:
  friend class SC_Model;

  HxCStateflowSrcRef(SC_Model* object);
  HxCSrcRef* clone() const override;

  SC_Model* m_pObject = nullptr;
};

#endif  // SOURCEREF_HXCSTATEFLOWSRCREF_H
