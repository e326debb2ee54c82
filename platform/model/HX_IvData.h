// The part of the intermediate view that tells the root subsystem identifier.

#ifndef PLATFORM_MODEL_HX_IVDATA_H
#define PLATFORM_MODEL_HX_IVDATA_H

#include "platform/strings/KyCXString.h"

class HX_BcPartitionContext {
 public:
  explicit HX_BcPartitionContext(const KyCXString& id) : m_Id(id) {}
  const KyCXString& getSubsystemIdentifier() const { return m_Id; }

 private:
  KyCXString m_Id;
};

/// The context is not owned; null if the partition has none.
class HX_BdPartition {
 public:
  explicit HX_BdPartition(HX_BcPartitionContext* context)
      : m_pContext(context) {}
  HX_BcPartitionContext* getPartitionContext() const { return m_pContext; }

 private:
  HX_BcPartitionContext* m_pContext;
};

/// The partition is not owned; null before the view is partitioned.
class HxCIvData {
 public:
  explicit HxCIvData(HX_BdPartition* root) : m_pRoot(root) {}
  HX_BdPartition* getIvHxRootPartition() const { return m_pRoot; }

 private:
  HX_BdPartition* m_pRoot;
};

#endif  // PLATFORM_MODEL_HX_IVDATA_H
