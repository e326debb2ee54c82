// A block that the model reader has read from the model.
//
//   HX_InputBlockId id(blocks, 7);
//   HxCInputBlockSrcRef ref(id);
//   KyCXString text;
//   ref.toString(text);   // "controller/Subsystem/Gain 1"

#ifndef SOURCEREF_HXCINPUTBLOCKSRCREF_H
#define SOURCEREF_HXCINPUTBLOCKSRCREF_H

#include "SourceRef/HxCSrcRef.h"
#include "platform/matlab/HX_MxArray.h"

class HX_InputBlockId;

/// Created and owned by the model reader. The identifier is not owned; it must
/// outlive the reference, its copies and its clones. Copies keep the number.
class HX_UTILS_API HxCInputBlockSrcRef : public HxCSrcRef {
 public:
  /// A reference to the block that \p id names.
  explicit HxCInputBlockSrcRef(const HX_InputBlockId& id);
  HxCInputBlockSrcRef(const HxCInputBlockSrcRef&) = default;
  HxCInputBlockSrcRef& operator=(const HxCInputBlockSrcRef&) = default;
  ~HxCInputBlockSrcRef() override;

  const HxCInputBlockSrcRef* isInputBlock() const override;

  /// The names from the generated system down to the block, both included, with
  /// '/' between them and a blank for each white space character.
  ///
  /// The path is read from the model on each call, four parameters per level. A
  /// block outside the generated system shows the names from its model down.
  /// The climb ends, with the names found so far, at an object that cannot be
  /// read (a failed debug check "success") or that was met before, as in a
  /// damaged model whose parents form a loop (a failed debug check "isNew").
  /// If already the block itself or the generated system cannot be read, \p
  /// text keeps its characters but for the white space.
  void toString(KyCXString& text) const override;

  /// A reference to the same block with a number of its own.
  HxCSrcRef* clone() const override;

  /// The block's handle in the model.
  double getBlockHandle() const;

 private:
  // One step of the climb: reads \p object's name and handle, and whether it is
  // the generated system. The caller owns \p parent, the array that names the
  // parent, whatever the result; false if something could not be read.
  bool getBlockName(mxArray* object, KyCXString& name, double& handle,
                    mxArray*& parent, bool& atRoot) const;

  const HX_InputBlockId* m_pInputBlock;
};

#endif  // SOURCEREF_HXCINPUTBLOCKSRCREF_H
