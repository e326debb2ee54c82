// Name spaces without each of the blocks that they ask for.
#include "NameSpace/HX_LimitedNameSpace.h"
#include "NameSpace/HxCXStringIdServer.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "support/HX_TestFixture.h"

namespace {

class MemoryFaultTest : public HX_TestFixture {};

// Each job tells whether all of it succeeded, and checks what it got on the
// way: a job that fails stays usable.

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

TEST_F(MemoryFaultTest, EachBlockMayBeMissing) {
  HX_WithoutEachBlock("intern names", internsNames);
  HX_WithoutEachBlock("derive names", derivesNames);
}

}  // namespace
