// Two sets of names: rows with reasons, and substitutions applied in turn.
#include "SafeNames/HX_NameDiff.h"

#include <map>
#include <random>
#include <string>
#include <vector>

#include "support/HX_TestFixture.h"

namespace {

using Diff = HX_NameDiff;

class NameDiffTest : public HX_TestFixture {};

struct RowCase {
  const char* why;
  Diff::Record before;  // no item: not in the set
  Diff::Record after;
  Diff::HxEChangeTag change;
  Diff::HxEReasonTag reason;
};

const RowCase kRowCases[] = {
    {"kept",
     {"i", "a", "w", "t", "p", "c"},
     {"i", "a", "x", "u", "q", "d"},
     Diff::eKept,
     Diff::eNoReason},
    {"added", {}, {"i", "a"}, Diff::eAdded, Diff::eNoReason},
    {"removed", {"i", "a"}, {}, Diff::eRemoved, Diff::eNoReason},
    {"template first",
     {"i", "a", "w", "t", "p", ""},
     {"i", "b", "x", "u", "q", "c"},
     Diff::eRenamed,
     Diff::eTemplate},
    {"then the place",
     {"i", "a", "w", "t", "p", ""},
     {"i", "b", "x", "t", "q", "c"},
     Diff::eRenamed,
     Diff::ePlace},
    {"then the wanted name",
     {"i", "a", "w", "t", "p", ""},
     {"i", "b", "x", "t", "p", "c"},
     Diff::eRenamed,
     Diff::eWanted},
    {"unknown facts give no reason",
     {"i", "a", "", "t", "", ""},
     {"i", "b", "x", "", "p", "c"},
     Diff::eRenamed,
     Diff::eChanges},
    {"a conflict is gone",
     {"i", "a_a", "a", "", "", "c"},
     {"i", "a", "a"},
     Diff::eRenamed,
     Diff::eUnchanged},
    {"nothing known", {"i", "a"}, {"i", "b"}, Diff::eRenamed, Diff::eNoReason},
};

TEST_F(NameDiffTest, TellsEachItemWithItsReason) {
  for (const RowCase& row : kRowCases) {
    SCOPED_TRACE(row.why);
    Diff diff;
    if (!row.before.item.empty()) diff.add(Diff::eOld, row.before);
    if (!row.after.item.empty()) diff.add(Diff::eNew, row.after);
    ASSERT_TRUE(diff.compare());
    ASSERT_EQ(1, diff.rowCount());
    EXPECT_EQ(row.change, diff.row(0).change);
    EXPECT_EQ(row.reason, diff.row(0).reason);
    EXPECT_EQ(row.before.name, diff.row(0).before.name);
    EXPECT_EQ(row.after.changes, diff.row(0).after.changes);
    EXPECT_EQ(1, diff.count(row.change));
  }
}

TEST_F(NameDiffTest, RowsStandByItemAndTheLastRecordCounts) {
  Diff diff;
  for (const char* item : {"b", "c", "b", "a"})
    diff.add(Diff::eOld, {item, item});
  diff.add(Diff::eOld, {"c", "last"});
  for (const char* item : {"d", "b"}) diff.add(Diff::eNew, {item, item});
  ASSERT_TRUE(diff.compare());
  std::string shown;
  for (int i = 0; i < diff.rowCount(); ++i)
    shown += std::string(diff.row(i).before.item) + "/" +
             std::string(diff.row(i).after.item) + " ";
  EXPECT_EQ("a/ b/b c/ /d ", shown);
  EXPECT_EQ("last", diff.row(2).before.name);
  EXPECT_EQ(2, diff.count(Diff::eRemoved));
}

// Random renamings over few names: chains, cycles, names that share a target.
TEST_F(NameDiffTest, SubstitutionsGiveTheNewNames) {
  std::mt19937 random(HX_Seed());
  for (int round = 0; round < 300; ++round) {
    SCOPED_TRACE(round);
    Diff diff;
    std::map<std::string, std::string> wanted;
    const auto names = 2 + random() % 8;
    for (unsigned i = 0; i < names; ++i) {
      const std::string name = i == 0 ? "hx_swap_1" : "n" + std::to_string(i);
      const std::string to = "n" + std::to_string(random() % names);
      if (!diff.add(Diff::eOld, {name, name}) ||
          !diff.add(Diff::eNew, {name, to}))
        FAIL();
      wanted[name] = to;
    }
    diff.add(Diff::eOld, {"zz", "n1"});  // n1 in another scope
    diff.add(Diff::eNew, {"zz", round % 2 == 0 ? "other" : wanted["n1"]});
    ASSERT_TRUE(diff.compare());
    const bool isAmbiguous = round % 2 == 0;
    ASSERT_EQ(isAmbiguous ? 1 : 0, diff.ambiguousCount());
    if (isAmbiguous) {
      EXPECT_EQ("n1", diff.ambiguous(0));
      wanted["n1"] = "n1";
    }
    for (const auto& [name, to] : wanted) {
      std::string text = name;
      for (int i = 0; i < diff.substitutionCount(); ++i)
        if (text == diff.substitution(i).from) text = diff.substitution(i).to;
      EXPECT_EQ(to, text) << name;
    }
  }
}

TEST_F(NameDiffTest, GivesNoRowsWithoutMemory) {
  HX_WithoutEachBlock("name diff", [] {
    Diff diff;
    for (int i = 0; i < 6; ++i) {
      const std::string old = "n" + std::to_string(i);
      const std::string now = "n" + std::to_string((i + 1) % 6);
      if (!diff.add(Diff::eOld, {old, old}) ||
          !diff.add(Diff::eNew, {old, now}))
        return false;
    }
    const bool isDone = diff.compare();
    EXPECT_EQ(isDone ? 6 : 0, diff.rowCount());
    EXPECT_EQ(isDone ? 7 : 0, diff.substitutionCount());
    return isDone;
  });
}

}  // namespace
