// A memory controller that refuses some of the blocks.

#ifndef NAMESPACE_HX_FAILINGCONTROLLER_H
#define NAMESPACE_HX_FAILINGCONTROLLER_H

#include <random>

#include "support/HX_TestFixture.h"

class HX_FailingController : public HX_CountingController {
 public:
  /// Refuses \p percent of the blocks, chosen at random.
  void setPercent(unsigned percent, unsigned seed) {
    m_Percent = percent;
    m_Random.seed(seed);
  }

  void* allocMemBlock(unsigned long size) override {
    if (m_Random() % 100 < m_Percent) return nullptr;
    return HX_CountingController::allocMemBlock(size);
  }

 private:
  unsigned m_Percent = 0;
  std::mt19937 m_Random;
};

#endif  // NAMESPACE_HX_FAILINGCONTROLLER_H
