#include "SourceRef/HxCSrcRef.h"

#include <functional>
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

using testing::ElementsAre;
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

struct ClassRow {
  const char* name;
  const HxCSrcRef* original;
  std::function<HxCSrcRef*()> copy;
  std::function<const HxCSrcRef*()> assignToOther;
  const char* kinds;
  const char* text;  // after toString() on "abc"
  bool copyKeepsId;
  bool cloneKeepsId;
  const char* cloneKinds;
  const char* cloneText;
};

template <class T>
ClassRow row(const char* name, const T& original, T& other, const char* kinds,
             const char* text, bool cloneKeepsId, const char* cloneKinds,
             const char* cloneText) {
  return {name,
          &original,
          [&] { return new T(original); },
          [&] { return &(other = original); },
          kinds,
          text,
          true,
          cloneKeepsId,
          cloneKinds,
          cloneText};
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
  const HxCSrcRef plain;
  HxCSrcRef otherPlain;
  const HxCInternalSrcRef internal("x.cpp", 12, "bad index");
  HxCInternalSrcRef otherInternal;
  const HxCDdSrcRef dd(HX_DdTree::instance().add("//DD0/Pool/Ctrl/speed"));
  HxCDdSrcRef otherDd;
  m_State.setSFName("Chart/Idle");
  HxCStateflowSrcRef otherState;
  HX_BlockDataBase blocks;
  const HX_InputBlockId id(blocks, 7);
  const HX_InputBlockId otherId(blocks, 8);
  const HxCInputBlockSrcRef input(id);
  HxCInputBlockSrcRef otherInput(otherId);
  const HX_Block other("other");
  const HxCBlockSrcRef& block = blockRef(m_Gain);

  const char* const internalText =
      "Internal: Module: 'x.cpp', Line: 12 Reason: bad index";
  const ClassRow rows[] = {
      row("plain", plain, otherPlain, "s", "abcUnknown source", true, "s",
          "abcUnknown source"),
      row("internal", internal, otherInternal, "si", internalText, true, "s",
          "abcUnknown source"),
      row("data dictionary", dd, otherDd, "sd", "//DD0/Pool/Ctrl/speed", true,
          "sd", "//DD0/Pool/Ctrl/speed"),
      row("Stateflow", *m_State.getStateflowSrcRef(), otherState, "sc",
          "Chart/Idle", false, "sc", "Chart/Idle"),
      row("input block", input, otherInput, "sn", "abc", false, "sn", "abc"),
      {"block", &block, [&] { return HX_Block::dupSrcRef(block); },
       [&] { return &(blockRef(other) = block); }, "sb", "my model/a/b   c",
       false, false, "sb", "my model/a/b   c"},
  };
  for (const ClassRow& r : rows) {
    SCOPED_TRACE(r.name);
    const int id1 = r.original->getSrcRefId();
    EXPECT_EQ(kindsOf(*r.original), r.kinds);
    EXPECT_EQ(textOf(*r.original), r.text);

    const int next = HxCSrcRef().getSrcRefId() + 1;
    const SrcRefPtr copy(r.copy());
    EXPECT_EQ(copy->getSrcRefId(), r.copyKeepsId ? id1 : next);
    EXPECT_EQ(kindsOf(*copy), r.kinds);
    EXPECT_EQ(textOf(*copy), r.text);

    const int afterCopy = HxCSrcRef().getSrcRefId() + 1;
    EXPECT_EQ(afterCopy, next + (r.copyKeepsId ? 1 : 2));
    const SrcRefPtr clone(r.original->clone());
    EXPECT_EQ(clone->getSrcRefId(), r.cloneKeepsId ? id1 : afterCopy);
    EXPECT_EQ(kindsOf(*clone), r.cloneKinds);
    EXPECT_EQ(textOf(*clone), r.cloneText);

    const HxCSrcRef* assigned = r.assignToOther();
    EXPECT_NE(assigned, r.original);
    EXPECT_EQ(assigned->getSrcRefId(), id1);
    EXPECT_EQ(textOf(*assigned), r.text);
  }
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
  EXPECT_EQ(kindsOf(*clone), "s");
  EXPECT_EQ(textOf(*clone), "abcUnknown source");
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
  const unsigned long script =
      HX_DdTree::instance().add("//DD0/CGTmpData/hxscript_Ctrl/3/Gain_Var");
  const unsigned long largest = std::numeric_limits<unsigned long>::max();
  const struct {
    unsigned long handle;
    std::string path;
    std::string text;
  } rows[] = {
      {script, "//DD0/CGTmpData/hxscript_Ctrl/3/Gain_Var",
       "User script object Gain_Var of block Ctrl"},
      {4711, "Handle: 4711", "Handle: 4711"},
      {0, "Handle: 0", "Handle: 0"},
      {largest, "Handle: " + std::to_string(largest),
       "Handle: " + std::to_string(largest)},
  };
  for (const auto& r : rows) {
    const HxCDdSrcRef ref(r.handle);
    KyCXString path("abc");
    ref.getDdPath(path);
    EXPECT_EQ(path.cstring(), r.path);
    EXPECT_EQ(textOf(ref), r.text);
    EXPECT_EQ(ref.getDdHandle(), r.handle);
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
    calls.push_back(std::string("open ") + className.cstring());
    EXPECT_EQ(object, expected);
  }
  void writeEntry(const KyCXString& label, const KyCXString& value,
                  int level) override {
    calls.push_back(std::string(label.cstring()) + value.cstring() + "|" +
                    std::to_string(level));
  }
  void closeObject(const HX_Dumpable* object) override {
    calls.push_back("close");
    EXPECT_EQ(object, expected);
  }

  const HX_Dumpable* expected = nullptr;
  std::vector<std::string> calls;
};

TEST_F(SrcRefTest, DumpWritesOneSectionWithTheText) {
  HxCInternalSrcRef ref("x.cpp", 1, "c");
  for (bool flag : {false, true}) {
    RecordingDump dump;
    dump.expected = &ref;
    HxCSrcRef& base = ref;
    EXPECT_EQ(base.dump(&dump, flag), &dump);
    EXPECT_THAT(dump.calls,
                ElementsAre("open HxCSrcRef",
                            "Source:Internal: Module: 'x.cpp', Line: 1 "
                            "Reason: c|0",
                            "close"));
  }
}

TEST_F(SrcRefTest, PointersCompareByAddressAndStreamNothing) {
  const HxCSrcRef refs[2];
  const HxCSrcRef* const a = &refs[0];
  const HxCSrcRef* const b = &refs[1];
  const HxCSrcRef* const none = nullptr;
  EXPECT_EQ(leda::compare(a, b), -1);
  EXPECT_EQ(leda::compare(b, a), 1);
  EXPECT_EQ(leda::compare(a, a), 0);
  EXPECT_EQ(leda::compare(none, a), -1);
  std::stringstream stream;
  stream << a << none << "end";
  EXPECT_EQ(stream.str(), "end");
  EXPECT_EQ(&(stream >> a), &stream);
  EXPECT_EQ(stream.get(), 'e');
}

}  // namespace
