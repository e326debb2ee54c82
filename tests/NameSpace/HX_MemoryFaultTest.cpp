// Name spaces without block 0, 1, 2, ... of the controller or of the heap.
#include <cstdlib>

#include "Control/HX_Memory.h"
#include "NameSpace/HX_LimitedNameSpace.h"
#include "NameSpace/HxCXStringIdServer.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

namespace {

class MemoryFaultTest : public HX_TestFixture {};

// A job returns whether all steps succeeded, and checks the results of every
// step: after a failure the objects stay usable.

bool internsNames() {
  HxCXStringIdServer ids;
  bool done = ids.boot() && ids.isUp();
  for (int i = 0; ids.isUp() && i < 40; ++i) {
    const KyCXString text(i, false, true);
    int id = -1;
    const bool found = ids.findOrAdd(text, id);
    if (found) {
      EXPECT_EQ(text, ids.getString(id));
      EXPECT_EQ(ids.getId(text), id);
    }
    done &= found;
  }
  ids.shutdown();
  return done;
}

bool derivesNames() {
  HX_OptionsExt options;
  HxCGlobal::setOptions(&options);
  HX_LimitedNameSpace names;
  bool done = true;
  for (int i = 0; i < 40; ++i) {
    options.setLimitVariableNameLength(i % 2 != 0);
    KyCXString name(i % 4 < 2 ? "a_name_that_is_longer_than_the_limit" : "x");
    names.addUnique(name);
    done &= names.isDefined(name);
  }
  HX_LimitedNameSpace copy(names);
  KyCXString first("x");
  done &= copy.isDefined(first);
  HxCGlobal::setOptions(nullptr);
  return done;
}

// Names longer than the inline buffer of a text, with the limit on and off. A
// step that fails changes neither the set nor the argument.
bool derivesLongNames() {
  static HX_OptionsExt s_Options;
  static KyCXString s_Wanted(
      "a_wanted_name_that_is_longer_than_the_inline_buffer_of_a_text");
  HxCGlobal::setOptions(&s_Options);
  HX_LimitedNameSpace names;
  const auto enter = [&names] {
    KyCXString name(s_Wanted);
    const bool wasTaken = names.isDefined(name);
    names.addUnique(name);
    const bool isSame = name == s_Wanted;
    if (!isSame && !(wasTaken && names.isDefined(name))) std::abort();
    return wasTaken ? !isSame : names.isDefined(name);
  };
  bool done = true;
  for (int i = 0; i < 12; ++i) {
    s_Options.setLimitVariableNameLength(i % 3 != 0);
    done &= HX_WithinMemory(false, enter);
  }
  HX_LimitedNameSpace copy;
  copy = names;
  const bool isCopied = copy.isDefined(s_Wanted);
  done &= isCopied;
  copy = HX_LimitedNameSpace();
  if (copy.isDefined(s_Wanted) && !isCopied) std::abort();
  names.remove(s_Wanted);
  if (names.isDefined(s_Wanted)) std::abort();
  bool derived = true;
  names.deriveUniqueString(s_Wanted, derived);
  if (derived) std::abort();
  HxCGlobal::setOptions(nullptr);
  return done;
}

TEST_F(MemoryFaultTest, EachBlockMayBeMissing) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  HX_WithoutEachBlock("intern names", internsNames);
  HX_WithoutEachBlock("derive names", derivesNames);
  HX_WithoutEachBlock("derive long names", derivesLongNames);
  HX_WithoutEachHeapBlock("derive long names", derivesLongNames);
}

TEST_F(MemoryFaultTest, EveryBlockComesFromTheController) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  HX_CountingController memory;
  const int before = HX_HeapBlocks();
  internsNames();
  derivesNames();
  EXPECT_EQ(HX_HeapBlocks(), before);
}

}  // namespace
