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
#include "support/HX_TestFixture.h"

namespace {

std::string textOf(const HxCSrcRef& ref) {
  KyCXString text("abc");
  ref.toString(text);
  return text.cstring();
}

// A letter for every kind query that answers the reference.
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

// "new " unless the number is that of the original, kinds, text, and the handle
// of an input block.
std::string looks(const HxCSrcRef& ref, const HxCSrcRef& original) {
  std::string result =
      (ref.getSrcRefId() == original.getSrcRefId() ? "" : "new ") +
      kindsOf(ref) + " " + textOf(ref);
  if (const HxCInputBlockSrcRef* block = ref.isInputBlock())
    result += " " + testing::PrintToString(block->getBlockHandle());
  return result;
}

std::string cloneLooks(const HxCSrcRef& original) {
  return looks(*std::unique_ptr<HxCSrcRef>(original.clone()), original);
}

// The first reference of the program.
const int kFirstNumber = HxCSrcRef().getSrcRefId();

// other: overwritten by an assignment.
template <class T>
void expectRules(const T& original, T other, const std::string& own,
                 const std::string& cloned) {
  EXPECT_EQ(looks(original, original), own);
  EXPECT_EQ(looks(T(original), original), own);
  other = original;
  EXPECT_EQ(looks(other, original), own);
  EXPECT_EQ(cloneLooks(original), cloned);
}

const std::string kUnknown = "s abcUnknown source";

class SrcRefTest : public HX_TestFixture {
 protected:
  ~SrcRefTest() override { HX_DdTree::instance().clear(); }
};

TEST_F(SrcRefTest, EachClassHasItsKindTextAndNumberRules) {
  const HxCSrcRef plain;
  EXPECT_EQ(kFirstNumber, 0);
  EXPECT_EQ(HxCSrcRef().getSrcRefId(), plain.getSrcRefId() + 1);
  expectRules(plain, HxCSrcRef(), kUnknown, kUnknown);
  HxCInternalSrcRef internal;
  const HxCInternalSrcRef elsewhere("y.h", 3, "why");
  expectRules(internal, elsewhere,
              "si Internal: Module: 'file unknown!', Line: -1 Reason: cause "
              "unknown!",
              kUnknown);
  internal.setLocation("x.cpp", std::numeric_limits<std::int32_t>::min());
  internal.setCause("bad index");
  expectRules(internal, elsewhere,
              "si Internal: Module: 'x.cpp', Line: -2147483648 Reason: bad "
              "index",
              kUnknown);
  internal.setFile("z.cpp");
  internal.setLine(9);
  EXPECT_EQ(internal.getFile(), KyCXString("z.cpp"));
  EXPECT_EQ(internal.getLine(), 9);
  EXPECT_EQ(internal.getCause(), KyCXString("bad index"));
  EXPECT_EQ(textOf(internal),
            "Internal: Module: 'z.cpp', Line: 9 Reason: bad index");
  const std::string path = "//DD0/Pool/Ctrl/speed";
  const HxCDdSrcRef converted = HX_DdTree::instance().add(path);
  expectRules(converted, HxCDdSrcRef(), "sd " + path, "sd " + path);
  SC_Model state(42, 3, "Idle");
  state.setSFName("Chart/Idle");
  const HxCStateflowSrcRef& stateRef = *state.getStateflowSrcRef();
  expectRules(stateRef, HxCStateflowSrcRef(), "sc Chart/Idle",
              "new sc Chart/Idle");
  EXPECT_EQ(stateRef.getSfObjectId(), 42);
  expectRules(HxCStateflowSrcRef(), stateRef, "sc ", "new sc ");
  EXPECT_EQ(HxCStateflowSrcRef().getSfObjectId(), -1);
  HX_BlockDataBase blocks;
  blocks.setSlBlockHandle(7, 1.5);
  const HX_InputBlockId id(blocks, 7), otherId(blocks, 8);
  const HxCInputBlockSrcRef input = id;
  expectRules(input, HxCInputBlockSrcRef(otherId), "sn abc 1.5",
              "new sn abc 1.5");
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
