// The part of the intermediate view that tells the root subsystem identifier.

#ifndef PLATFORM_MODEL_HX_IVDATA_H
#define PLATFORM_MODEL_HX_IVDATA_H

#include "platform/strings/KyCXString.h"

/// What holds for a whole partition.
class HX_BcPartitionContext {
 public:
  /// \param id  the identifier of the subsystem, the value of $I
  explicit HX_BcPartitionContext(const KyCXString& id) : m_Id(id) {}
  /// The identifier of the subsystem.
  const KyCXString& getSubsystemIdentifier() const { return m_Id; }

 private:
  KyCXString m_Id;
};

/// The context is not owned; null if the partition has none.
class HX_BdPartition {
 public:
  /// \param context  may be null
  explicit HX_BdPartition(HX_BcPartitionContext* context)
      : m_pContext(context) {}
  /// Null for a partition without a context.
  HX_BcPartitionContext* getPartitionContext() const { return m_pContext; }

 private:
  HX_BcPartitionContext* m_pContext;
};

/// The partition is not owned; null before the view is partitioned.
class HxCIvData {
 public:
  /// \param root  may be null
  explicit HxCIvData(HX_BdPartition* root) : m_pRoot(root) {}
  /// Null before the view is partitioned.
  HX_BdPartition* getIvHxRootPartition() const { return m_pRoot; }

 private:
  HX_BdPartition* m_pRoot;
};

#endif  // PLATFORM_MODEL_HX_IVDATA_H
