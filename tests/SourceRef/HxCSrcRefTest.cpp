#include "SourceRef/HxCSrcRef.h"

#include <cstdint>
#include <limits>
#include <memory>
#include <sstream>

#include "SourceRef/HxCDdSrcRef.h"
#include "SourceRef/HxCInputBlockSrcRef.h"
#include "SourceRef/HxCInternalSrcRef.h"
#include "SourceRef/HxCStateflowSrcRef.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/dump/HX_Dump.h"
#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_BlockDataBase.h"
#include "platform/model/HX_InputBlockId.h"
#include "platform/model/HX_SlBlockHandlesDB.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/SC_Model.h"
#include "support/HX_TestFixture.h"

namespace {

std::string textOf(const HxCSrcRef& ref) {
  KyCXString text("abc");
  ref.toString(text);
  return text.cstring();
}

// One letter per kind query that names this reference.
std::string kindsOf(const HxCSrcRef& ref) {
  const HxCSrcRef* self = &ref;
  std::string kinds;
  if (ref.isSrcRef() == self) kinds += 's';
  if (ref.isBlock() == self) kinds += 'b';
  if (ref.isStateflow() == self) kinds += 'c';
  if (ref.isModule() != nullptr) kinds += 'm';
  if (ref.isDd() == self) kinds += 'd';
  if (ref.isInternal() == self) kinds += 'i';
  if (ref.isInputBlock() == self) kinds += 'n';
  return kinds;
}

// Whether the number is another than the original's, the kinds and the text.
std::string looks(const HxCSrcRef& ref, const HxCSrcRef& original) {
  return (ref.getSrcRefId() == original.getSrcRefId() ? "" : "new ") +
         kindsOf(ref) + " " + textOf(ref);
}

std::string cloneLooks(const HxCSrcRef& original) {
  return looks(*std::unique_ptr<HxCSrcRef>(original.clone()), original);
}

template <class T>
void expectRules(const T& original, const std::string& own,
                 const std::string& cloned) {
  EXPECT_EQ(looks(original, original), own);
  EXPECT_EQ(looks(T(original), original), own);
  EXPECT_EQ(cloneLooks(original), cloned);
}

const std::string kUnknown = "s abcUnknown source";

class SrcRefTest : public HX_TestFixture {
 protected:
  ~SrcRefTest() override { HX_DdTree::instance().clear(); }
};

TEST_F(SrcRefTest, EachClassHasItsKindTextAndNumberRules) {
  const HxCSrcRef plain;
  EXPECT_EQ(HxCSrcRef().getSrcRefId(), plain.getSrcRefId() + 1);
  expectRules(plain, kUnknown, kUnknown);
  HxCInternalSrcRef internal;
  expectRules(internal,
              "si Internal: Module: 'file unknown!', Line: -1 Reason: cause "
              "unknown!",
              kUnknown);
  internal.setLocation("x.cpp", std::numeric_limits<std::int32_t>::min());
  internal.setCause("bad index");
  expectRules(internal,
              "si Internal: Module: 'x.cpp', Line: -2147483648 Reason: bad "
              "index",
              kUnknown);
  const std::string path = "//DD0/Pool/Ctrl/speed";
  expectRules(HxCDdSrcRef(HX_DdTree::instance().add(path)), "sd " + path,
              "sd " + path);
  SC_Model state(42, 3, "Idle");
  state.setSFName("Chart/Idle");
  const HxCStateflowSrcRef& stateRef = *state.getStateflowSrcRef();
  expectRules(stateRef, "sc Chart/Idle", "new sc Chart/Idle");
  EXPECT_EQ(stateRef.getSfObjectId(), 42);
  expectRules(HxCStateflowSrcRef(), "sc ", "new sc ");
  EXPECT_EQ(HxCStateflowSrcRef().getSfObjectId(), -1);
  HX_BlockDataBase blocks;
  const HX_InputBlockId id(blocks, 7);
  expectRules(HxCInputBlockSrcRef(id), "sn abc", "new sn abc");
}

TEST_F(SrcRefTest, ABlockReferenceMayChangeAndLoseItsBlock) {
  HX_Block model("my\tmodel"), gain("a/b \n\nc", &model);
  const std::string own = "sb my model/a/b   c";
  const HxCBlockSrcRef& ref = *gain.getSrcRef();
  const std::unique_ptr<HxCBlockSrcRef> copy(HX_Block::dupSrcRef(ref));
  EXPECT_EQ(looks(ref, ref), own);
  EXPECT_EQ(looks(*copy, ref), "new " + own);
  EXPECT_EQ(cloneLooks(ref), "new " + own);
  HX_SlBlockHandlesDB handles;
  HxCGlobal::setSlBlockHandlesDB(&handles);
  handles.setSlBlockHandle(&gain, 17.25);
  copy->setBlock(nullptr);
  EXPECT_EQ(copy->getBlockHandle(), HX_SimulinkInterface::s_invalidHandle);
  EXPECT_EQ(looks(*copy, *copy), "sb ");
  EXPECT_EQ(cloneLooks(*copy), "new " + kUnknown);
  *copy = ref;
  EXPECT_EQ(looks(*copy, ref), own);
  EXPECT_EQ(copy->getBlockHandle(), 17.25);
  HxCGlobal::setSlBlockHandlesDB(nullptr);
}

TEST_F(SrcRefTest, DdReferencesShowPathScriptObjectOrHandle) {
  const auto made =
      HX_DdTree::instance().add("//DD0/CGTmpData/hxscript_Ctrl/3/Gain_Var");
  EXPECT_EQ(textOf(HxCDdSrcRef(made)),
            "User script object Gain_Var of block Ctrl");
  EXPECT_EQ(textOf(HxCDdSrcRef()), "Handle: 0");
  for (const unsigned long unknown : {4711UL, HX_DdTree::kInvalidHandle})
    EXPECT_EQ(textOf(HxCDdSrcRef(unknown)),
              "Handle: " + std::to_string(unknown));
}

class MockDump : public HX_Dump {
 public:
  MOCK_METHOD(void, openObject, (const HX_Dumpable*, const KyCXString&),
              (override));
  MOCK_METHOD(void, writeEntry, (const KyCXString&, const KyCXString&, int),
              (override));
  MOCK_METHOD(void, closeObject, (const HX_Dumpable*), (override));
};

TEST_F(SrcRefTest, DumpWritesOneSectionWithTheText) {
  HxCSrcRef ref;
  MockDump dump;
  const testing::InSequence inThisOrder;
  EXPECT_CALL(dump, openObject(&ref, KyCXString("HxCSrcRef")));
  EXPECT_CALL(
      dump, writeEntry(KyCXString("Source:"), KyCXString("Unknown source"), 0));
  EXPECT_CALL(dump, closeObject(&ref));
  EXPECT_EQ(ref.dump(&dump, true), &dump);
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
