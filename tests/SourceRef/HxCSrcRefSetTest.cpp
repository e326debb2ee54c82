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

// References of all kinds, by letter.
class SrcRefKindsTest : public HX_TestFixture {
 protected:
  ~SrcRefKindsTest() override { m_Tree.clear(); }

  HX_DdTree& m_Tree = HX_DdTree::instance();
  const HxCDdSrcRef m_X{m_Tree.add("//DD0/Pool/CGTmpData/x")};
  const HxCDdSrcRef m_Y{m_Tree.add("//DD0/Pool/CGTmpData/y")};
  const HxCDdSrcRef m_V{m_Tree.add("//DD0/Pool/cgtmpdata/v")};
  const HxCDdSrcRef m_W{m_Tree.add("//DD0/Pool/w")};
  const HxCDdSrcRef m_SameAsW{m_W.getDdHandle()};
  const HX_Block m_Block{"b"};
  HX_BlockDataBase m_Blocks;
  const HX_InputBlockId m_Id{m_Blocks, 1};
  const HxCInputBlockSrcRef m_InputBlock{m_Id};
  const HxCInternalSrcRef m_Internal;
  const HxCSrcRef m_Plain;
  const std::map<char, const HxCSrcRef*> m_Refs{
      {'x', &m_X},          {'y', &m_Y},        {'v', &m_V},
      {'w', &m_W},          {'W', &m_SameAsW},  {'b', m_Block.getSrcRef()},
      {'n', &m_InputBlock}, {'i', &m_Internal}, {'p', &m_Plain},
      {'0', nullptr}};
};

TEST_F(SrcRefKindsTest, ServerSortsTheReferencesOfASet) {
  // The references of a set; the results for blocks, for the data dictionary
  // and for the rest.
  const std::string rows[][2] = {{"", "000"},
                                 {"bxi", "bxi"},
                                 {"xwip", "0wp"},
                                 {"bn", "n00"},
                                 {"nwbx", "bx0"}};
  for (const auto& [refs, sorted] : rows) {
    HxCSrcRefSet set;
    for (const char ref : refs) set.addSrcRef(m_Refs.at(ref));
    for (unsigned wanted = 0; wanted < 8; ++wanted) {
      SCOPED_TRACE(testing::Message() << refs << " wanted " << wanted);
      const HxCSrcRef untouched;
      SrcRefs found(3, &untouched);
      const auto place = [&](unsigned i) {
        return (wanted >> i & 1) != 0 ? &found[i] : nullptr;
      };
      EXPECT_EQ(
          HxCSrcRefServer::getSpecificSrcRefFromSet(
              refs.empty() ? nullptr : &set, place(0), place(1), place(2)),
          0);
      for (unsigned i = 0; i < 3; ++i)
        EXPECT_EQ(found[i],
                  place(i) != nullptr ? m_Refs.at(sorted[i]) : &untouched);
    }
  }
}

TEST_F(SrcRefKindsTest, PairsAreCompared) {
  // d both from the data dictionary, D different, u both from user scripts, n
  // none from a user script; o only one, then the number: 7 if not written.
  const std::string rows[][2] = {{"xy", "dDu7"}, {"xx", "du7"},  {"xw", "dD7"},
                                 {"wx", "dD7"},  {"vw", "dDn7"}, {"wW", "d7"},
                                 {"w0", "o0"},   {"0w", "o1"},   {"wp", "o0"},
                                 {"pw", "o1"},   {"pp", "-1"},   {"00", "-1"},
                                 {"0p", "-1"}};
  const HxCSrcRefCompare compare;
  for (const auto& [pair, expected] : rows) {
    const HxCSrcRef* const a = m_Refs.at(pair[0]);
    const HxCSrcRef* const b = m_Refs.at(pair[1]);
    std::string holds;
    if (compare.bothFromDD(a, b)) holds += 'd';
    if (compare.bothFromDDButDifferent(a, b)) holds += 'D';
    if (compare.bothFromUserScript(a, b)) holds += 'u';
    if (compare.differentDdSrcRefNotFromUserScript(a, b)) holds += 'n';
    int which = 7;
    if (compare.onlyOneFromDD(a, b, which)) holds += 'o';
    EXPECT_EQ(holds + std::to_string(which), expected) << pair;
  }
}

}  // namespace
