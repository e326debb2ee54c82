#include "SourceRef/HxCSrcRef.h"

#include <cstdint>
#include <limits>
#include <memory>
#include <sstream>

#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCInputBlockSrcRef.h"
#include "SourceRef/HxCInternalSrcRef.h"
#include "SourceRef/HxCSrcRefCompare.h"
#include "SourceRef/HxCStateflowSrcRef.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/dump/HX_Dump.h"
#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/matlab/HX_SimulinkTree.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_BlockDataBase.h"
#include "platform/model/HX_InputBlockId.h"
#include "platform/model/HX_SlBlockHandlesDB.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/SC_Model.h"
#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

namespace {

// The first reference of the program.
const int kFirstNumber = HxCSrcRef().getSrcRefId();

class SrcRefTest : public HX_TestFixture {
 protected:
  ~SrcRefTest() override { HX_DdTree::instance().clear(); }
};

// tests/plain compares kinds, texts, copies and assignments.
TEST_F(SrcRefTest, NumbersCountFromZero) {
  EXPECT_EQ(kFirstNumber, 0);
  const int next = HxCSrcRef().getSrcRefId() + 1;
  EXPECT_EQ(HxCInternalSrcRef().getSrcRefId(), next);
}

// The dump() for const objects writes nothing: a call must not compile.
template <class T>
constexpr bool kIsDumped = requires(T& ref, HX_Dump* dump) {
  ref.dump(dump, true);
};
static_assert(kIsDumped<HxCSrcRef> && !kIsDumped<const HxCSrcRef> &&
              kIsDumped<HxCDdSrcRef> && !kIsDumped<const HxCDdSrcRef>);

// References with texts longer than a string holds inside: every copy asks for
// memory.
struct LongModel {
  LongModel() {
    state.setSFName(text);
    HX_SimulinkInterface::setTree(&tree);
    GLB_SetFullSystemPath(text);
    blocks.setSlBlockHandle(7, tree.addBlock(text.cstring()));
    for (int i = 0; i < 5; ++i) refs[i]->toString(texts[i]);
  }
  ~LongModel() {
    HX_SimulinkInterface::setTree(nullptr);
    GLB_SetFullSystemPath("");
  }

  const KyCXString text = std::string(300, 'x').c_str();
  HX_Block block{text};
  SC_Model state{1, 3, "Idle"};
  HxCInternalSrcRef place{text, 1, text};
  HX_SimulinkTree tree;
  HX_BlockDataBase blocks;
  HX_InputBlockId id{blocks, 7};
  HxCInputBlockSrcRef input = id;
  HxCDdSrcRef script =
      HX_DdTree::instance().add("//DD0/CGTmpData/" + std::string(300, 'x'));
  HxCDdSrcRef object =
      HX_DdTree::instance().add("//DD0/Pool/" + std::string(300, 'x'));
  const HxCSrcRef* refs[5] = {block.getSrcRef(), state.getStateflowSrcRef(),
                              &place, &input, &object};
  KyCXString texts[5];
};
const LongModel* s_Model = nullptr;
bool s_IsHalfDone = false;

bool formsTexts() {
  bool done = true;
  for (int i = 0; i < 5; ++i) {
    KyCXString text("before");
    s_Model->refs[i]->toString(text);
    const bool isFormed = text == s_Model->texts[i];
    if (!isFormed && text != "before") s_IsHalfDone = true;
    done = done && isFormed;
  }
  KyCXString path("before");
  s_Model->object.getDdPath(path);
  return done && path == s_Model->texts[4];
}

bool keepsPlaces() {
  const KyCXString& text = s_Model->text;
  const HxCInternalSrcRef made(text, 1, text), copy(s_Model->place);
  HxCInternalSrcRef assigned("old", 5, "old"), moved(assigned);
  assigned = s_Model->place;
  moved.setLocation(text, 1);
  moved.setCause(text);
  moved.setFile(text);
  bool done = moved.getCause() == text;
  const HxCInternalSrcRef* const refs[] = {&made, &copy, &assigned};
  for (const HxCInternalSrcRef* ref : refs) {
    const bool isDone = ref->getCause() == text;
    if ((ref->getFile() == text) != isDone) s_IsHalfDone = true;
    if (!isDone && ref == &assigned && ref->getLine() != 5) s_IsHalfDone = true;
    done = done && isDone;
  }
  return done && moved.getFile() == text && moved.getLine() == 1;
}

bool comparesOrigins() {
  const HxCSrcRefCompare compare;
  const HxCSrcRef* const script = &s_Model->script;
  const HxCSrcRef* const object = &s_Model->object;
  const HxCDdSrcRef missing = 4711UL;
  const bool isScript = compare.bothFromUserScript(script, script);
  if (compare.bothFromUserScript(script, object) ||
      compare.differentDdSrcRefNotFromUserScript(script, object))
    s_IsHalfDone = true;
  return compare.differentDdSrcRefNotFromUserScript(object, &missing) &&
         isScript;
}

TEST_F(SrcRefTest, WithoutMemoryNothingIsThrownOrHalfDone) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  const LongModel model;
  s_Model = &model;
  HX_WithoutEachHeapBlock("texts", formsTexts);
  EXPECT_FALSE(s_IsHalfDone);
  HX_WithoutEachHeapBlock("places", keepsPlaces);
  EXPECT_FALSE(s_IsHalfDone);
  HX_WithoutEachHeapBlock("origins", comparesOrigins);
  EXPECT_FALSE(s_IsHalfDone);
}

TEST_F(SrcRefTest, PointersCompareByAddressAndStreamNothing) {
  const HxCSrcRef refs[2];
  const HxCSrcRef* const ordered[] = {nullptr, &refs[0], &refs[1]};
  for (int a = 0; a < 3; ++a)
    for (int b = 0; b < 3; ++b)
      EXPECT_EQ(leda::compare(ordered[a], ordered[b]), (a > b) - (a < b));
  std::stringstream stream;
  stream << ordered[1] << "end";
  stream >> ordered[1];
  EXPECT_EQ(stream.get(), 'e');
}

}  // namespace
