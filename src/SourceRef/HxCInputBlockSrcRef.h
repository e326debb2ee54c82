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

/// OWNERSHIP: the model reader creates and owns input block references. The
/// identifier is not owned and must outlive the reference, copies and clones.
/// Copies keep the number.
class HX_UTILS_API HxCInputBlockSrcRef : public HxCSrcRef {
 public:
  /// A reference to the block that \p id names.
  HxCInputBlockSrcRef(const HX_InputBlockId& id);
  HxCInputBlockSrcRef(const HxCInputBlockSrcRef&) = default;
  HxCInputBlockSrcRef& operator=(const HxCInputBlockSrcRef&) = default;
  ~HxCInputBlockSrcRef() override;

  const HxCInputBlockSrcRef* isInputBlock() const override;

  /// Replaces \p text by the names from the generated system down to the block,
  /// both included, with '/' between names and blanks for white space.
  ///
  /// Climbs from the block through the parents. A block outside the generated
  /// system gives the names from its model down. The climb ends early, with the
  /// names found so far:
  ///   - at an object that cannot be read: failed debug check "success";
  ///   - at an object met before, in a damaged model whose parents form a loop:
  ///     failed debug check "isNew".
  /// If the first step fails, \p text changes only in white space.
  /// COST: four parameters of the model per level, read on each call.
  void toString(KyCXString& text) const override;

  /// A reference to the same block with a new number.
  HxCSrcRef* clone() const override;

  /// The handle of the block in the model.
  double getBlockHandle() const;

 private:
  /// One step of the climb.
  /// \param[out] name  name of \p object; empty if the name cannot be read
  /// \param[out] parent  array that names the parent, or null
  /// \param[out] atRoot  \p object is the generated system
  /// OWNERSHIP: the caller owns \p parent, also if the result is false.
  /// RETURNS: false if a parameter could not be read.
  bool getBlockName(mxArray* object, KyCXString& name, mxArray*& parent,
                    bool& atRoot) const;

  const HX_InputBlockId* m_pInputBlock;
};

#endif  // SOURCEREF_HXCINPUTBLOCKSRCREF_H
