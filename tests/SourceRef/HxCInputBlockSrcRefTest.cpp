#include "SourceRef/HxCInputBlockSrcRef.h"

#include <random>

#include "platform/matlab/HX_MxContent.h"
#include "platform/matlab/HX_SimulinkTree.h"
#include "platform/model/HX_BlockDataBase.h"
#include "platform/model/HX_InputBlockId.h"
#include "platform/model/HxCGlobal.h"
#include "support/HX_TestFixture.h"

namespace {

// Model that counts reads and spoils a single read.
class FaultyTree : public HX_SimulinkTree {
 public:
  mxArray* getParameter(const mxArray* object,
                        const KyCXString& parameter) const override {
    if (reads++ != spoiledRead)
      return HX_SimulinkTree::getParameter(object, parameter);
    // A structure is no name, no handle and no block.
    return givesNull ? nullptr : mxCreateStructMatrix(1, 1, {});
  }

  mutable int reads = 0;
  int spoiledRead = -1;
  bool givesNull = false;
};

constexpr std::size_t kBlocks = 40;
constexpr std::size_t kNone = kBlocks;  // the parent of a model

class InputBlockTest : public HX_TestFixture {
 protected:
  InputBlockTest() { HX_SimulinkInterface::setTree(&m_Tree); }
  ~InputBlockTest() override {
    HX_SimulinkInterface::setTree(nullptr);
    GLB_SetFullSystemPath("");
  }

  // The text of a block and the number of reads for the text.
  std::string textOf(double handle) {
    HX_BlockDataBase blocks;
    blocks.setSlBlockHandle(7, handle);
    const HX_InputBlockId id(blocks, 7);
    const HxCInputBlockSrcRef ref(id);
    EXPECT_EQ(ref.getBlockHandle(), handle);
    KyCXString text("be\nfore");
    m_Tree.reads = 0;
    const int liveBefore = HX_LiveMxArrays();
    ref.toString(text);
    EXPECT_EQ(HX_LiveMxArrays(), liveBefore);
    return text.cstring() + (" " + std::to_string(m_Tree.reads));
  }

  // The plain form. Each step reads name, system, handle and parent.
  std::string joinedNames(std::size_t block, std::size_t system) {
    std::string names = "be fore";
    std::vector<bool> met(kBlocks);
    int reads = 0;
    for (;;) {
      const int spoiled = m_Tree.spoiledRead - reads;
      reads += 4;
      // An unknown parent fails in the next step only.
      const int noticed = m_Tree.givesNull ? 4 : 3;
      const bool success =
          block != kNone && (spoiled < 0 || spoiled >= noticed);
      if (!success || met[block]) {
        m_Expected.push_back(success ? "isNew" : "success");
        break;
      }
      met[block] = true;
      const std::string name = "b/  " + std::to_string(block);
      names = reads == 4 ? name : name + "/" + names;
      if (block == system) break;
      block = spoiled == 3 ? kNone : m_Parents[block];
    }
    return names + " " + std::to_string(reads);
  }

  FaultyTree m_Tree;
  std::vector<std::size_t> m_Parents;
  std::vector<std::string> m_Expected;  // reports
};

// Every block of a damaged model, in which some parents form loops. In every
// climb a single read fails.
TEST_F(InputBlockTest, TextIsTheJoinedNamesFromTheSystemDown) {
  const unsigned seed = HX_Seed();
  SCOPED_TRACE(seed);
  std::mt19937 random(seed);
  std::vector<double> handles;
  for (std::size_t block = 0; block < kBlocks; ++block) {
    const std::string name = "b/\r\n" + std::to_string(block);
    handles.push_back(m_Tree.addBlock(name.c_str()));
  }
  m_Parents = {kNone, 1};  // a model and the shortest loop
  for (std::size_t block = 2; block < kBlocks; ++block)
    m_Parents.push_back(random() % (block % 4 == 0 ? kBlocks : block));
  for (std::size_t block = 1; block < kBlocks; ++block)
    m_Tree.setParentPath(handles[block],
                         m_Tree.getPath(handles[m_Parents[block]]));

  const auto& reports = recordDebugReports();
  for (std::size_t system = 0; system < kBlocks; ++system) {
    GLB_SetFullSystemPath(m_Tree.getPath(handles[system]));
    for (std::size_t block = 0; block < kBlocks; ++block) {
      m_Tree.spoiledRead = static_cast<int>(random() % 40);
      m_Tree.givesNull = random() % 2 == 0;
      ASSERT_EQ(textOf(handles[block]), joinedNames(block, system))
          << "system " << system << " read " << m_Tree.spoiledRead;
    }
  }
  EXPECT_EQ(reports, m_Expected);
}

}  // namespace
