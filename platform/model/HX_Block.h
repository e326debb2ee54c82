// A block of the model, in the tree of its subsystems.
//
//   HX_Block model("cruise_control");
//   HX_Block controller("Controller", &model);
//   controller.setSubsystem("a", 1);
//   HX_Block gain("Speed Gain", &controller);   // in subsystem a1 as well

#ifndef PLATFORM_MODEL_HX_BLOCK_H
#define PLATFORM_MODEL_HX_BLOCK_H

#include <memory>

#include "SourceRef/HxCBlockSrcRef.h"
#include "platform/strings/KyCXString.h"

class HX_StateflowBlock;

/// Owns its source reference; the parent is not owned and outlives the block.
class HX_Block {
 public:
  /// Reads as a negative number: the block lies in no numbered subsystem.
  static constexpr unsigned int kNoSubsystem = 0xFFFFFFFF;

  /// A block of \p name, its own without a path, below \p parent; null for the
  /// model itself.
  explicit HX_Block(const KyCXString& name, HX_Block* parent = nullptr)
      : m_Name(name), m_pParent(parent) {}
  HX_Block(const HX_Block&) = delete;
  HX_Block& operator=(const HX_Block&) = delete;
  virtual ~HX_Block() = default;

  /// As given to the constructor.
  const KyCXString& getName() const { return m_Name; }
  HX_Block* getParent() const { return m_pParent; }

  /// Makes this block a subsystem that the blocks below it belong to.
  void setSubsystem(const KyCXString& id, unsigned int number) {
    m_SubsystemId = id;
    m_SubsystemNumber = number;
    m_IsSubsystem = true;
  }
  /// The identifier of the subsystem that the block is or lies in; never null,
  /// empty outside all subsystems.
  const KyCXString* getSubsystemId() const {
    return &subsystem()->m_SubsystemId;
  }
  unsigned int getSubsystemNumber() const {
    return subsystem()->m_SubsystemNumber;
  }

  /// Replaces \p path by the names from the root to this block, with '/'
  /// between them.
  /// \param withoutRoot  leaves the root's name out
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

  /// The reference to this block, owned by it; the same on every call.
  const HxCBlockSrcRef* getSrcRef() const {
    if (!m_pSrcRef)
      m_pSrcRef.reset(new HxCBlockSrcRef(const_cast<HX_Block*>(this)));
    return m_pSrcRef.get();
  }
  /// A second reference to the block of \p srcRef, with a number of its own;
  /// owned by the caller. Null if there is no memory.
  static HxCBlockSrcRef* dupSrcRef(const HxCBlockSrcRef& srcRef) {
    return new HxCBlockSrcRef(srcRef);
  }

  /// A block inside a masked library block may be named through its parent.
  void setNamedThroughParent(bool named) { m_NamedThroughParent = named; }
  /// This block if it is named through its parent, else null.
  virtual HX_Block* isNamedThroughParent() {
    return m_NamedThroughParent && m_pParent != nullptr ? this : nullptr;
  }
  /// This block as a chart block, else null.
  virtual HX_StateflowBlock* isStateflowBlock() { return nullptr; }

 private:
  const HX_Block* subsystem() const {
    const HX_Block* block = this;
    while (!block->m_IsSubsystem && block->m_pParent != nullptr)
      block = block->m_pParent;
    return block;
  }

  KyCXString m_Name;
  HX_Block* m_pParent;
  KyCXString m_SubsystemId;
  unsigned int m_SubsystemNumber = kNoSubsystem;
  bool m_IsSubsystem = false;
  bool m_NamedThroughParent = false;
  mutable std::unique_ptr<HxCBlockSrcRef> m_pSrcRef;  // made on demand
};

#endif  // PLATFORM_MODEL_HX_BLOCK_H
