#include "SourceRef/HxCSrcRef.h"

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

using SrcRefPtr = std::unique_ptr<HxCSrcRef>;

std::string textOf(const HxCSrcRef& ref, const char* before = "abc") {
  KyCXString text(before);
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

template <class T>
HxCSrcRef* copyOf(const T& ref) {
  return new T(ref);
}
HxCSrcRef* copyOf(const HxCBlockSrcRef& ref) {
  return HX_Block::dupSrcRef(ref);
}

// What a clone has of its original: all, all but the number, the number only.
enum class CloneHas { eAll, eNewId, eIdOnly };

template <class T>
void expectRules(const T& original, T& other, const char* kinds,
                 const char* text, CloneHas has, bool copyKeepsId = true) {
  SCOPED_TRACE(kinds);
  const int id = original.getSrcRefId();
  const auto expectLooks = [&](const HxCSrcRef& ref, bool isPlain, int refId) {
    EXPECT_EQ(kindsOf(ref), isPlain ? "s" : kinds);
    EXPECT_EQ(textOf(ref), isPlain ? "abcUnknown source" : text);
    EXPECT_EQ(ref.getSrcRefId(), refId);
  };
  expectLooks(original, false, id);
  const int next = HxCSrcRef().getSrcRefId() + 1;
  expectLooks(*SrcRefPtr(copyOf(original)), false, copyKeepsId ? id : next);
  const int afterCopy = HxCSrcRef().getSrcRefId() + 1;
  EXPECT_EQ(afterCopy, next + (copyKeepsId ? 1 : 2));
  const HxCSrcRef& base = original;
  expectLooks(*SrcRefPtr(base.clone()), has == CloneHas::eIdOnly,
              has == CloneHas::eNewId ? afterCopy : id);
  other = original;
  expectLooks(other, false, id);
}

class SrcRefTest : public HX_TestFixture {
 protected:
  SrcRefTest() { HxCGlobal::setSlBlockHandlesDB(&m_Handles); }
  ~SrcRefTest() override {
    HxCGlobal::setSlBlockHandlesDB(nullptr);
    HX_DdTree::instance().clear();
  }

  HxCBlockSrcRef& blockRef(const HX_Block& block) {
    return const_cast<HxCBlockSrcRef&>(*block.getSrcRef());
  }

  HX_SlBlockHandlesDB m_Handles;
  HX_Block m_Model{"my\tmodel"};
  HX_Block m_Gain{"a/b \n\nc", &m_Model};
  SC_Model m_State{42, 3, "Idle"};
};

TEST_F(SrcRefTest, EachClassHasItsKindTextAndNumberRules) {
  HxCSrcRef plain;
  expectRules(HxCSrcRef(), plain, "s", "abcUnknown source", CloneHas::eAll);
  HxCInternalSrcRef internal;
  expectRules(HxCInternalSrcRef("x.cpp", 12, "bad index"), internal, "si",
              "Internal: Module: 'x.cpp', Line: 12 Reason: bad index",
              CloneHas::eIdOnly);
  HxCDdSrcRef dd;
  expectRules(HxCDdSrcRef(HX_DdTree::instance().add("//DD0/Pool/Ctrl/speed")),
              dd, "sd", "//DD0/Pool/Ctrl/speed", CloneHas::eAll);
  m_State.setSFName("Chart/Idle");
  HxCStateflowSrcRef state;
  expectRules(*m_State.getStateflowSrcRef(), state, "sc", "Chart/Idle",
              CloneHas::eNewId);
  HX_BlockDataBase blocks;
  const HX_InputBlockId id(blocks, 7), otherId(blocks, 8);
  HxCInputBlockSrcRef input(otherId);
  expectRules(HxCInputBlockSrcRef(id), input, "sn", "abc", CloneHas::eNewId);
  const HX_Block other("other");
  expectRules(*m_Gain.getSrcRef(), blockRef(other), "sb", "my model/a/b   c",
              CloneHas::eNewId, false);
}

TEST_F(SrcRefTest, ABlockReferenceMayLoseItsBlock) {
  m_Handles.setSlBlockHandle(&m_Gain, 17.25);
  HxCBlockSrcRef& ref = blockRef(m_Gain);
  EXPECT_EQ(ref.getBlockHandle(), 17.25);
  ref.setBlock(nullptr);
  EXPECT_EQ(ref.getBlockHandle(), HX_SimulinkInterface::s_invalidHandle);
  EXPECT_EQ(textOf(ref), "");
  const int next = HxCSrcRef().getSrcRefId() + 1;
  const SrcRefPtr clone(static_cast<const HxCSrcRef&>(ref).clone());
  EXPECT_EQ(kindsOf(*clone) + textOf(*clone), "sabcUnknown source");
  EXPECT_EQ(clone->getSrcRefId(), next);
}

TEST_F(SrcRefTest, InternalReferencesTellWhatIsKnown) {
  HxCInternalSrcRef ref;
  const int id = ref.getSrcRefId();
  EXPECT_EQ(textOf(ref),
            "Internal: Module: 'file unknown!', Line: -1 Reason: cause "
            "unknown!");
  EXPECT_EQ(textOf(HxCInternalSrcRef("", 0)),
            "Internal: Module: '', Line: 0 Reason: cause unknown!");
  ref.setLocation("y.cpp", std::numeric_limits<int>::min());
  ref.setCause("");
  EXPECT_EQ(textOf(ref),
            "Internal: Module: 'y.cpp', Line: -2147483648 Reason: ");
  ref.setFile("z.cpp");
  ref.setLine(std::numeric_limits<int>::max());
  EXPECT_EQ(textOf(ref),
            "Internal: Module: 'z.cpp', Line: 2147483647 Reason: ");
  EXPECT_EQ(ref.getSrcRefId(), id);
}

TEST_F(SrcRefTest, DdReferencesShowPathScriptObjectOrHandle) {
  const std::string script = "//DD0/CGTmpData/hxscript_Ctrl/3/Gain_Var";
  const unsigned long handle = HX_DdTree::instance().add(script.c_str());
  const unsigned long largest = std::numeric_limits<unsigned long>::max();
  for (const unsigned long each : {handle, 4711UL, 0UL, largest}) {
    const HxCDdSrcRef ref(each);
    const std::string plain = "Handle: " + std::to_string(each);
    KyCXString path("abc");
    ref.getDdPath(path);
    EXPECT_EQ(path.cstring(), each == handle ? script : plain);
    EXPECT_EQ(textOf(ref), each == handle
                               ? "User script object Gain_Var of block Ctrl"
                               : plain);
    EXPECT_EQ(ref.getDdHandle(), each);
  }
  EXPECT_EQ(HxCDdSrcRef().getDdHandle(), 0U);
}

TEST_F(SrcRefTest, StateflowReferencesAskTheirObject) {
  EXPECT_EQ(m_State.getStateflowSrcRef()->getSfObjectId(), 42);
  EXPECT_EQ(m_State.getStateflowSrcRef()->getSfObject(), &m_State);
  EXPECT_EQ(HxCStateflowSrcRef().getSfObjectId(), -1);
  EXPECT_EQ(textOf(HxCStateflowSrcRef()), "");
}

class RecordingDump : public HX_Dump {
 public:
  void openObject(const HX_Dumpable* object,
                  const KyCXString& className) override {
    calls += std::string("open ") + className.cstring();
    EXPECT_EQ(object, expected);
  }
  void writeEntry(const KyCXString& label, const KyCXString& value,
                  int level) override {
    calls += std::string("|") + label.cstring() + value.cstring() + "|" +
             std::to_string(level);
  }
  void closeObject(const HX_Dumpable* object) override {
    calls += "|close";
    EXPECT_EQ(object, expected);
  }

  const HX_Dumpable* expected = nullptr;
  std::string calls;
};

TEST_F(SrcRefTest, DumpWritesOneSectionWithTheText) {
  HxCInternalSrcRef ref("x.cpp", 1, "c");
  RecordingDump dump;
  dump.expected = &ref;
  for (bool flag : {false, true})
    EXPECT_EQ(static_cast<HxCSrcRef&>(ref).dump(&dump, flag), &dump);
  const std::string once =
      "open HxCSrcRef|Source:Internal: Module: 'x.cpp', Line: 1 Reason: "
      "c|0|close";
  EXPECT_EQ(dump.calls, once + once);
}

TEST_F(SrcRefTest, PointersCompareByAddressAndStreamNothing) {
  const HxCSrcRef refs[2];
  const HxCSrcRef* const ordered[] = {nullptr, &refs[0], &refs[1]};
  for (int a = 0; a < 3; ++a)
    for (int b = 0; b < 3; ++b)
      EXPECT_EQ(leda::compare(ordered[a], ordered[b]), (a > b) - (a < b));
  std::stringstream stream;
  stream << ordered[1] << ordered[0] << "end";
  EXPECT_EQ(stream.str(), "end");
  EXPECT_EQ(&(stream >> ordered[1]), &stream);
  EXPECT_EQ(stream.get(), 'e');
}

}  // namespace
