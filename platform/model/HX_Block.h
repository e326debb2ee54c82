// A block of the model, in the tree of subsystems.
//
// How a host fills the stand-in: HX_ModelStandIn.h.

#ifndef PLATFORM_MODEL_HX_BLOCK_H
#define PLATFORM_MODEL_HX_BLOCK_H

#include <memory>

#include "SourceRef/HxCBlockSrcRef.h"
#include "platform/model/HX_ModelStandIn.h"
#include "platform/strings/KyCXString.h"

class HX_StateflowBlock;

/// Owns one source reference to itself.
class HX_Block : public HX_BlockStandIn {
 public:
  using HX_BlockStandIn::HX_BlockStandIn;
  HX_Block(const HX_Block&) = delete;
  HX_Block& operator=(const HX_Block&) = delete;
  virtual ~HX_Block() = default;

  /// The name without a path.
  const KyCXString& getName() const { return m_Name; }
  /// Null for a model.
  HX_Block* getParent() const { return m_pParent; }

  /// The identifier of the subsystem that the block is or lies in; never null,
  /// empty outside all subsystems.
  const KyCXString* getSubsystemId() const {
    return &subsystem()->m_SubsystemId;
  }
  /// The number of the same subsystem; negative as an int outside all.
  unsigned int getSubsystemNumber() const {
    return subsystem()->m_SubsystemNumber;
  }

  /// Replaces \p path by the names from the root to the block, with '/'
  /// between the names.
  /// \param withoutRoot  leaves the name of the root out
  /// \param doubleSlashes  doubles each '/' inside a name
  void getFullPathName(KyCXString& path, bool withoutRoot,
                       bool doubleSlashes) const {
    KyCXString name(m_Name);
    if (doubleSlashes) name.replace("/", "//");
    if (m_pParent == nullptr) {
      path = withoutRoot ? KyCXString() : name;
      return;
    }
    m_pParent->getFullPathName(path, withoutRoot, doubleSlashes);
    if (!path.isEmpty()) path += '/';
    path += name;
  }

  /// The reference to the block; the same on every call. Null without memory.
  /// OWNERSHIP: the block's.
  const HxCBlockSrcRef* getSrcRef() const {
    if (!m_pSrcRef)
      m_pSrcRef.reset(new HxCBlockSrcRef(const_cast<HX_Block*>(this)));
    return m_pSrcRef.get();
  }
  /// A second reference to the block of \p srcRef, with a number of its own.
  /// Null without memory.
  /// OWNERSHIP: the caller's.
  static HxCBlockSrcRef* dupSrcRef(const HxCBlockSrcRef& srcRef) {
    return new HxCBlockSrcRef(srcRef);
  }

  /// The block if its name comes from the parent, else null.
  virtual HX_Block* isNamedThroughParent() {
    return m_NamedThroughParent && m_pParent != nullptr ? this : nullptr;
  }
  /// The block as a chart block, else null.
  virtual HX_StateflowBlock* isStateflowBlock() { return nullptr; }

 private:
  const HX_Block* subsystem() const {
    const HX_Block* block = this;
    while (!block->m_IsSubsystem && block->m_pParent != nullptr)
      block = block->m_pParent;
    return block;
  }

  mutable std::unique_ptr<HxCBlockSrcRef> m_pSrcRef;  // made on demand
};

#endif  // PLATFORM_MODEL_HX_BLOCK_H
