#include "SourceRef/HxCSrcRefSet.h"

#include <algorithm>
#include <array>
#include <map>
#include <memory>
#include <random>

#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCInputBlockSrcRef.h"
#include "SourceRef/HxCInternalSrcRef.h"
#include "SourceRef/HxCSrcRefCompare.h"
#include "SourceRef/HxCSrcRefServer.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_BlockDataBase.h"
#include "platform/model/HX_InputBlockId.h"
#include "support/HX_TestFixture.h"

namespace {

using SrcRefs = std::vector<const HxCSrcRef*>;
using IteratorPtr = std::unique_ptr<HX_Iterator<const HxCSrcRef*>>;

using SrcRefSetTest = HX_TestFixture;

// Compares all answers of a set with the plain form.
void expectHolds(const HxCSrcRefSet& set, const SrcRefs& expected) {
  ASSERT_EQ(set.getSrcRefCnt(), static_cast<int>(expected.size()));
  EXPECT_EQ(set.getASrcRef(), expected.empty() ? nullptr : expected.front());
  SrcRefs visited;
  set.forEach([&](const HxCSrcRef* ref) { visited.push_back(ref); });
  EXPECT_EQ(visited, expected);
  const IteratorPtr it(set.createIterator());
  for (int pass = 0; pass < 2; ++pass) {
    SrcRefs walked;
    for (; !it->isDone(); it->next()) walked.push_back(it->currentItem());
    EXPECT_EQ(walked, expected);
    it->next();
    EXPECT_TRUE(it->isDone());
    EXPECT_THAT([&] { it->currentItem(); }, testing::Throws<int>(-1));
    it->first();
  }
}

// In every second step one of the next three blocks is missing. A refused step
// changes nothing; a set of at most one reference asks for no block.
TEST_F(SrcRefSetTest, RandomWalkAgreesWithAPlainVector) {
  HX_CountingController memory;
  const unsigned seed = HX_Seed();
  SCOPED_TRACE(seed);
  std::mt19937 random(seed);
  const std::array<HxCSrcRef, 5> refs;
  std::array<HxCSrcRefSet, 3> sets;
  std::array<SrcRefs, 3> plains;
  for (int step = 0; step < 2'000; ++step) {
    const std::size_t to = random() % sets.size();
    const std::size_t from = random() % sets.size();
    const std::size_t ref = random() % (refs.size() + 1);
    const HxCSrcRef* const srcRef = ref < refs.size() ? &refs[ref] : nullptr;
    const std::size_t action = random() % 7;
    SrcRefs added;
    if (action > 0) added = action < 3 ? plains[from] : SrcRefs{srcRef};

    const int asked = memory.allocated();
    const int missing =
        random() % 2 == 0 ? INT_MAX : asked + static_cast<int>(random() % 3);
    memory.failAt(missing, false);
    if (action == 0)
      sets[to].clear();
    else if (action == 1)
      sets[to] = sets[from];
    else if (action == 2)
      sets[to].addSrcRef(sets[from]);
    else
      sets[to].addSrcRef(srcRef);
    memory.failAt(INT_MAX, false);

    SrcRefs plain = plains[to];
    if (action < 2) plain.clear();
    for (const HxCSrcRef* r : added)
      if (r != nullptr && std::count(plain.begin(), plain.end(), r) == 0)
        plain.push_back(r);
    if (plain.size() < 2) {
      EXPECT_EQ(memory.allocated(), asked);
    }
    if (memory.allocated() <= missing) plains[to] = plain;
    expectHolds(sets[to], plains[to]);
    expectHolds(HxCSrcRefSet(sets[from]), plains[from]);
    ASSERT_FALSE(HasFailure()) << "step " << step;
  }
}

TEST_F(SrcRefSetTest, WhatIsHandedOutIsOwnedOrNullWithoutMemory) {
  HX_WithoutEachBlock("collect references", [] {
    const HX_Block block("b");
    HxCSrcRefServer server;
    HxCSrcRefSet set(block.getSrcRef());
    for (int i = 0; i < 6; ++i) set.addSrcRef(server.getSrcRef());
    const HxCSrcRefSet copy(set);
    const std::unique_ptr<HxCSrcRef> clone(HxCDdSrcRef(1).clone());
    const IteratorPtr it(set.createIterator());
    return set.getSrcRefCnt() == 7 && copy.getSrcRefCnt() == 7 && clone && it;
  });
}

TEST_F(SrcRefSetTest, ReferencesOfTheServerOutliveItsShutdown) {
  HX_CountingController memory;
  {
    HxCSrcRefServer server;
    EXPECT_TRUE(server.boot());
    HxCInternalSrcRef* const first = server.getSrcRef();
    HxCInternalSrcRef* const second = server.getSrcRef();
    first->setLocation("x.cpp", 12);
    const int held = memory.liveBlocks();
    EXPECT_TRUE(server.shutdown());
    EXPECT_EQ(memory.liveBlocks(), held);
    EXPECT_EQ(first->getLine(), 12);
    EXPECT_EQ(second->getLine(), -1);
  }
  EXPECT_EQ(memory.liveBlocks(), 0);
}

}  // namespace
