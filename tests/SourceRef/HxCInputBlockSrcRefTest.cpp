#include "SourceRef/HxCInputBlockSrcRef.h"

#include <algorithm>
#include <cmath>
#include <random>

#include "platform/matlab/HX_MxArray.h"
#include "platform/matlab/HX_SimulinkTree.h"
#include "platform/model/HX_BlockDataBase.h"
#include "platform/model/HX_InputBlockId.h"
#include "platform/model/HxCGlobal.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

// Counts the reads and spoils one of them.
class FaultyTree : public HX_SimulinkTree {
 public:
  mxArray* getParameter(const mxArray* object,
                        const KyCXString& parameter) const override {
    if (reads++ != spoiledRead)
      return HX_SimulinkTree::getParameter(object, parameter);
    if (givesNull) return nullptr;
    // Of the wrong kind, or a handle that no block has.
    return parameter == "Handle" ? mxCreateString("x")
                                 : mxCreateScalarDouble(1e9);
  }

  mutable int reads = 0;
  int spoiledRead = -1;
  bool givesNull = false;
};

class InputBlockTest : public HX_TestFixture {
 protected:
  InputBlockTest() { HX_SimulinkInterface::setTree(&m_Tree); }
  ~InputBlockTest() override {
    HX_SimulinkInterface::setTree(nullptr);
    GLB_SetFullSystemPath("");
    EXPECT_EQ(HX_LiveMxArrays(), m_LiveBefore);
  }

  std::string textOf(double handle, const char* before = "be\nfore") {
    HX_BlockDataBase blocks;
    blocks.setSlBlockHandle(7, handle);
    const HX_InputBlockId id(blocks, 7);
    const HxCInputBlockSrcRef ref(id);
    EXPECT_TRUE(ref.getBlockHandle() == handle || std::isnan(handle));
    KyCXString text(before);
    m_Tree.reads = 0;
    ref.toString(text);
    EXPECT_EQ(HX_LiveMxArrays(), m_LiveBefore);
    return text.cstring();
  }

  FaultyTree m_Tree;
  const int m_LiveBefore = HX_LiveMxArrays();
};

TEST_F(InputBlockTest, TextReachesFromTheGeneratedSystemToTheBlock) {
  const auto& reports = recordDebugReports();
  const double model = m_Tree.addBlock("model");
  const double sys = m_Tree.addBlock("controller", model);
  const double sub = m_Tree.addBlock("Sub\r\nsystem/1", sys);
  const double gain = m_Tree.addBlock("Gain\t1", sub);
  GLB_SetFullSystemPath("model/controller");
  EXPECT_EQ(textOf(gain), "controller/Sub  system/1/Gain 1");
  EXPECT_EQ(textOf(sys), "controller");
  EXPECT_EQ(m_Tree.reads, 4);
  GLB_SetFullSystemPath("model/controller/Sub\r\nsystem//1");
  EXPECT_EQ(textOf(gain), "Sub  system/1/Gain 1");
  EXPECT_THAT(reports, IsEmpty());
  EXPECT_EQ(textOf(sys), "model/controller");  // outside: up to its model
  EXPECT_THAT(reports, ElementsAre("success"));
}

// Every block of random trees below and beside every generated system.
TEST_F(InputBlockTest, RandomTreesGiveTheJoinedNames) {
  const unsigned seed = std::random_device()();
  SCOPED_TRACE(seed);
  std::mt19937 random(seed);
  std::vector<double> handles;
  std::vector<std::vector<std::string>> chains;  // names, model first
  for (std::size_t block = 0; block < 25; ++block) {
    const std::string name = "b" + std::to_string(block);
    // Two models, then mostly deep nesting.
    const std::size_t parent = block < 2 ? 0 : block - 1 - random() % 4 % block;
    chains.push_back(block < 2 ? decltype(chains)::value_type()
                               : chains[parent]);
    chains[block].push_back(name);
    handles.push_back(block < 2
                          ? m_Tree.addBlock(name.c_str())
                          : m_Tree.addBlock(name.c_str(), handles[parent]));
  }
  for (std::size_t system = 0; system < handles.size(); ++system) {
    GLB_SetFullSystemPath(m_Tree.getPath(handles[system]));
    for (std::size_t block = 0; block < handles.size(); ++block) {
      std::string expected;
      for (const std::string& name : chains[block])
        expected = (expected.empty() || name == chains[system].back()
                        ? ""
                        : expected + "/") +
                   name;
      ASSERT_EQ(textOf(handles[block]), expected) << system;
    }
  }
}

TEST_F(InputBlockTest, AnySpoiledReadEndsTheClimbThere) {
  const auto& reports = recordDebugReports();
  const double model = m_Tree.addBlock("m");
  const double sub = m_Tree.addBlock("s", model);
  const double gain = m_Tree.addBlock("g", sub);
  GLB_SetFullSystemPath("m");
  const char* const texts[] = {"be fore", "g", "s/g", "m/s/g"};
  for (int read = 0; read < 24; ++read) {
    SCOPED_TRACE(read);
    m_Tree.givesNull = read >= 12;
    m_Tree.spoiledRead = read % 12;
    // An unknown parent is noticed only by the step that asks it.
    const bool laterNoticed = read % 4 == 3 && !m_Tree.givesNull;
    const int steps = read % 12 / 4 + (laterNoticed ? 1 : 0);
    EXPECT_EQ(textOf(gain), texts[steps]);
    EXPECT_EQ(m_Tree.reads, std::min(4 * (steps + 1), 12));
  }
  // All but the wrong parent of the model, which nobody asks.
  EXPECT_EQ(reports, std::vector<std::string>(23, "success"));
}

TEST_F(InputBlockTest, UnreadableBlocksAndSystemsKeepTheText) {
  const double model = m_Tree.addBlock("m");
  GLB_SetFullSystemPath("m");
  EXPECT_EQ(textOf(-1), "be fore");
  EXPECT_EQ(textOf(99), "be fore");
  EXPECT_EQ(textOf(std::nan("")), "be fore");
  for (const char* system : {"", "elsewhere", "m/", "M"}) {
    GLB_SetFullSystemPath(system);
    EXPECT_EQ(textOf(model, ""), "") << system;
  }
  HX_SimulinkInterface::setTree(nullptr);
  EXPECT_EQ(textOf(model), "be fore");
}

TEST_F(InputBlockTest, ALoopOfParentsShowsEachBlockOnce) {
  const double model = m_Tree.addBlock("m");
  const double a = m_Tree.addBlock("a", model);
  const double b = m_Tree.addBlock("b", a);
  const double c = m_Tree.addBlock("c", b);
  GLB_SetFullSystemPath("m");
  const auto& reports = recordDebugReports();
  m_Tree.setParentPath(a, m_Tree.getPath(b));  // a and b, c below them
  EXPECT_EQ(textOf(b), "a/b");
  EXPECT_EQ(textOf(a), "b/a");
  EXPECT_EQ(textOf(c), "a/b/c");
  m_Tree.setParentPath(c, m_Tree.getPath(c));
  EXPECT_EQ(textOf(c), "c");
  EXPECT_EQ(reports, std::vector<std::string>(4, "isNew"));
}

}  // namespace
