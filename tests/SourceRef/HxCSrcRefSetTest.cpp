#include "SourceRef/HxCSrcRefSet.h"

#include <algorithm>
#include <array>
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
#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

namespace {

using SrcRefs = std::vector<const HxCSrcRef*>;
using IteratorPtr = std::unique_ptr<HX_Iterator<const HxCSrcRef*>>;

int thrownBy(const HX_Iterator<const HxCSrcRef*>& it) try {
  it.currentItem();
  return 0;
} catch (int thrown) {
  return thrown;
}

// Compares all that a set tells with the plain form.
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
    EXPECT_EQ(thrownBy(*it), -1);
    it->first();
  }
}

class SrcRefSetTest : public HX_TestFixture {
 protected:
  ~SrcRefSetTest() override { HX_DdTree::instance().clear(); }
};

TEST_F(SrcRefSetTest, RandomWalkAgreesWithAPlainVector) {
  const unsigned seed = std::random_device()();
  SCOPED_TRACE(seed);
  std::mt19937 random(seed);
  const std::array<HxCSrcRef, 5> refs;
  std::array<HxCSrcRefSet, 3> sets;
  std::array<SrcRefs, 3> plains;
  for (int step = 0; step < 2'000; ++step) {
    const std::size_t to = random() % sets.size();
    const std::size_t from = random() % sets.size();
    const std::size_t ref = random() % (refs.size() + 1);
    const HxCSrcRef* srcRef = ref < refs.size() ? &refs[ref] : nullptr;
    const unsigned action = random() % 8;
    SrcRefs added{srcRef};
    if (action == 0) {
      sets[to].clear();
      added.clear();
    } else if (action == 1) {
      sets[to] = srcRef;
    } else if (action == 2) {
      sets[to] = sets[from];
      added = plains[from];
    } else if (action == 3) {
      sets[to].addSrcRef(sets[from]);
      added = plains[from];
    } else {
      sets[to].addSrcRef(srcRef);
    }
    SrcRefs& plain = plains[to];
    if (action < 3) plain.clear();
    for (const HxCSrcRef* r : added)
      if (r != nullptr && std::count(plain.begin(), plain.end(), r) == 0)
        plain.push_back(r);
    expectHolds(sets[to], plain);
    expectHolds(HxCSrcRefSet(sets[from]), plains[from]);
    ASSERT_FALSE(HasFailure()) << "step " << step;
  }
}

TEST_F(SrcRefSetTest, OneReferenceNeedsNoMemoryTheSecondDoes) {
  const HxCSrcRef a;
  const HxCSrcRef b;
  HX_CountingController controller;
  const int before = HX_HeapBlocks();
  HxCSrcRefSet set;
  for (const HxCSrcRef* ref : {static_cast<const HxCSrcRef*>(nullptr), &a, &a})
    set.addSrcRef(ref);
  HxCSrcRefSet copy(set);
  copy.addSrcRef(set);
  copy = set;
  copy = HxCSrcRefSet();
  copy.addSrcRef(set);
  int visits = 0;
  copy.forEach([&](const HxCSrcRef*) { ++visits; });
  EXPECT_EQ(visits, 1);
  EXPECT_EQ(HX_HeapBlocks(), before);
  EXPECT_EQ(controller.allocated(), 0);
  copy.addSrcRef(&b);
  EXPECT_GT(HX_HeapBlocks(), before);
  delete copy.createIterator();
  EXPECT_EQ(controller.allocated(), 1);  // an iterator is the library's own
  EXPECT_EQ(controller.liveBlocks(), 0);
  controller.fail();
  EXPECT_EQ(copy.createIterator(), nullptr);
}

TEST_F(SrcRefSetTest, ServerOwnsEachReferenceItHandsOut) {
  HX_CountingController controller;
  {
    HxCSrcRefServer server;
    EXPECT_TRUE(server.boot());
    for (int count = 0; count < 3; ++count) {
      HxCInternalSrcRef* ref = server.getSrcRef();
      ref->setLocation("a file name that needs memory of its own.cpp", 1);
    }
    EXPECT_TRUE(server.shutdown());
    EXPECT_EQ(controller.liveBlocks(), 3);
  }
  EXPECT_EQ(controller.liveBlocks(), 0);
  HX_WithoutEachBlock("collect references", [] {
    const HX_Block block("b");
    HxCSrcRefServer references;
    HxCSrcRefSet set(block.getSrcRef());
    for (int i = 0; i < 3; ++i) set.addSrcRef(references.getSrcRef());
    const std::unique_ptr<HxCSrcRef> clone(HxCDdSrcRef(1).clone());
    return set.getSrcRefCnt() == 4 && clone;
  });
}

TEST_F(SrcRefSetTest, ServerSortsTheReferencesOfASet) {
  const HX_Block block("b");
  const HxCSrcRef* const b = block.getSrcRef();
  HX_BlockDataBase blocks;
  const HX_InputBlockId id(blocks, 1);
  const HxCInputBlockSrcRef input(id);
  const HxCDdSrcRef dd1(1);
  const HxCDdSrcRef dd2(2);
  const HxCInternalSrcRef internal;
  const HxCSrcRef plain;
  const struct {
    SrcRefs refs;
    std::array<const HxCSrcRef*, 3> found;  // block, dd, other
  } rows[] = {
      {{}, {nullptr, nullptr, nullptr}},
      {{b, &dd1, &internal}, {b, &dd1, &internal}},
      {{&dd1, &dd2, &internal, &plain}, {nullptr, &dd2, &plain}},
      {{b, &input}, {&input, nullptr, nullptr}},
      {{&input, &dd2, b, &dd1}, {b, &dd1, nullptr}},
  };
  for (const auto& row : rows) {
    HxCSrcRefSet set;
    for (const HxCSrcRef* ref : row.refs) set.addSrcRef(ref);
    const HxCSrcRefSet* const given = row.refs.empty() ? nullptr : &set;
    for (unsigned wanted = 0; wanted < 8; ++wanted) {
      std::array<const HxCSrcRef*, 3> found{&plain, &plain, &plain};
      std::array<const HxCSrcRef*, 3> expected = found;
      const auto place = [&](unsigned i) -> const HxCSrcRef** {
        if ((wanted >> i & 1) == 0) return nullptr;
        expected[i] = row.found[i];
        return &found[i];
      };
      EXPECT_EQ(HxCSrcRefServer::getSpecificSrcRefFromSet(given, place(0),
                                                          place(1), place(2)),
                0);
      EXPECT_EQ(found, expected);
    }
  }
}

// The references of the comparison table, by letter.
TEST_F(SrcRefSetTest, ComparisonsOfAllPairs) {
  HX_DdTree& tree = HX_DdTree::instance();
  const HxCDdSrcRef x(tree.add("//DD0/Pool/CGTmpData/x"));
  const HxCDdSrcRef y(tree.add("//DD0/Pool/CGTmpData/y"));
  const HxCDdSrcRef v(tree.add("//DD0/Pool/cgtmpdata/v"));
  const HxCDdSrcRef w(tree.add("//DD0/Pool/w"));
  const HxCDdSrcRef sameAsW(w.getDdHandle());
  const HxCSrcRef plain;
  const struct {
    const HxCSrcRef* a;
    const HxCSrcRef* b;
    const char* holds;  // d both, D different, u user script, n not from one
    int which;          // 7: not written
  } rows[] = {
      {&x, &y, "dDu", 7},        {&x, &x, "du", 7},
      {&x, &w, "dD", 7},         {&w, &x, "dD", 7},
      {&v, &w, "dDn", 7},        {&w, &sameAsW, "d", 7},
      {&w, nullptr, "", 0},      {nullptr, &w, "", 1},
      {&x, &plain, "", 0},       {&plain, &x, "", 1},
      {&plain, &plain, "", -1},  {nullptr, nullptr, "", -1},
      {nullptr, &plain, "", -1},
  };
  const HxCSrcRefCompare compare;
  for (const auto& row : rows) {
    SCOPED_TRACE(&row - rows);
    std::string holds;
    if (compare.bothFromDD(row.a, row.b)) holds += 'd';
    if (compare.bothFromDDButDifferent(row.a, row.b)) holds += 'D';
    if (compare.bothFromUserScript(row.a, row.b)) holds += 'u';
    if (compare.differentDdSrcRefNotFromUserScript(row.a, row.b)) holds += 'n';
    EXPECT_EQ(holds, row.holds);
    int which = 7;
    EXPECT_EQ(compare.onlyOneFromDD(row.a, row.b, which),
              row.which == 0 || row.which == 1);
    EXPECT_EQ(which, row.which);
  }
}

}  // namespace
