// The lock file: its form, its faults, and what runs do to it.
#include "SafeNames/HX_NameLock.h"

#include <string>
#include <vector>

#include "SafeNames/HX_ShownFaults.h"
#include "support/HX_TestFixture.h"

namespace {

using Lock = HX_NameLock;

class NameLockTest : public HX_TestFixture {};

const std::string kHeader = "hx_names_lock 1\n";

std::string written(const Lock& lock) {
  std::string text;
  EXPECT_TRUE(lock.write([&](const char* piece, std::size_t length) {
    text.append(piece, length);
  }));
  return text;
}

// "gain gain_b gain file": item, name, wanted name, scope; '+' for external.
Lock::Entry entry(const std::vector<const char*>& fields) {
  Lock::Entry made;
  made.item = fields[0];
  made.name = fields[1];
  made.wanted = fields[2];
  made.scope = fields[3];
  made.isExternal = fields.size() > 4;
  return made;
}

struct FormCase {
  const char* why;
  std::string lines;  // behind the header
};

const FormCase kFormCases[] = {
    {"empty", ""},
    {"all fields", "gain\tgain_b\tgain\tfile\te\t-\n"},
    {"retired, with former names",
     "a\tx\tx\tf\ti\t0\nb\ty\tx\tf\ti\t-\ty1\tf\te3\ty2\tg\ti0\n"},
    {"escapes", "a\\tb\\nc\\rd\\\\\tx\tx\t\\\\\\t\ti\t-\n"},
    {"first characters of markers",
     "\\##\tx\tx\tf\ti\t-\n"
     "\\<<<<<<< a\ty\ty\tf\ti\t-\n\\=\tz\tz\tf\ti\t-\n"
     "\\>\tu\tu\tf\ti\t-\n\\||\tv\tv\tf\ti\t-\n"},
    {"bytes above 127, no scope", "\xC3\xA4\tx\tx\t\ti\t12\n"},
    {"one name in two scopes", "a\tx\tx\tf\ti\t-\nb\tx\tx\tg\ti\t-\n"},
};

TEST_F(NameLockTest, WritesWhatItReads) {
  for (const FormCase& row : kFormCases) {
    SCOPED_TRACE(row.why);
    const std::string text = kHeader + row.lines;
    Lock lock;
    HX_TextFaults faults;
    EXPECT_TRUE(lock.read(text.data(), text.size(), faults))
        << HX_ShownFaults(faults);
    EXPECT_EQ(text, written(lock));
  }
}

TEST_F(NameLockTest, ReadsLinesOfOtherSystems) {
  const std::string text =
      "\xEF\xBB\xBFhx_names_lock 1\r\na\tx\tx\tf\ti\t-\r\n";
  Lock lock;
  HX_TextFaults faults;
  ASSERT_TRUE(lock.read(text.data(), text.size(), faults));
  EXPECT_EQ(kHeader + "a\tx\tx\tf\ti\t-\n", written(lock));
}

struct FaultCase {
  const char* why;
  std::string text;
  const char* faults;
};

const std::string kLine = "b\tx\tx\tf\ti\t-\n";
const FaultCase kFaultCases[] = {
    {"nothing", "",
     "1: expected 'hx_names_lock 1', found ''; 1: the last line has no end"},
    {"another version", "hx_names_lock 2\n",
     "1: expected 'hx_names_lock 1', found 'hx_names_lock 2'"},
    {"an item twice", kHeader + kLine + "b\ty\ty\tf\ti\t-\n",
     "3: the item 'b' stands in line 2 already"},
    {"a line twice", kHeader + kLine + kLine,
     "3: the item 'b' stands in line 2 already; "
     "3: the name 'x' of scope 'f' stands in line 2 already"},
    {"a name twice", kHeader + kLine + "c\tx\ty\tf\te\t3\n",
     "3: the name 'x' of scope 'f' stands in line 2 already"},
    {"a former name twice", kHeader + kLine + "c\ty\ty\tf\ti\t-\tx\tf\ti0\n",
     "3: the name 'x' of scope 'f' stands in line 2 already"},
    {"conflict markers",
     kHeader + "<<<<<<< HEAD\n" + kLine + "=======\n>>>>>>> topic\n|||||||\n",
     "2: conflict marker of a merge: '<<<<<<< HEAD'; "
     "4: conflict marker of a merge: '======='; "
     "5: conflict marker of a merge: '>>>>>>> topic'; "
     "6: conflict marker of a merge: '|||||||'"},
    {"out of order", kHeader + kLine + "a\ty\ty\tf\ti\t-\n",
     "3: out of order: 'a'"},
    {"an empty line", kHeader + "\n",
     "2: expected 6 fields and 3 for each former name, found 1 fields"},
    {"half a former name", kHeader + "b\tx\tx\tf\ti\t-\ty\tf\n",
     "2: expected 6 fields and 3 for each former name, found 8 fields"},
    {"no item", kHeader + "\tx\tx\tf\ti\t-\n", "2: wrong item: ''"},
    {"a wrong escape", kHeader + "b\\x\tx\tx\tf\ti\t-\n",
     "2: wrong item: 'b\\x'"},
    {"half an escape", kHeader + "b\tx\tx\tf\\\ti\t-\n",
     "2: wrong scope: 'f\\'"},
    {"an escape of the first character inside",
     kHeader + "b\\#\tx\tx\tf\ti\t-\n", "2: wrong item: 'b\\#'"},
    {"no C name", kHeader + "b\tx y\tx\tf\ti\t-\n", "2: wrong name: 'x y'"},
    {"no wanted name", kHeader + "b\tx\t\tf\ti\t-\n",
     "2: wrong wanted name: ''"},
    {"a linkage", kHeader + "b\tx\tx\tf\tx\t-\n", "2: wrong linkage: 'x'"},
    {"a negative number", kHeader + "b\tx\tx\tf\ti\t-1\n",
     "2: wrong number of runs: '-1'"},
    {"a number too large", kHeader + "b\tx\tx\tf\ti\t99999999999\n",
     "2: wrong number of runs: '99999999999'"},
    {"a former linkage", kHeader + "b\tx\tx\tf\ti\t-\ty\tf\t3\n",
     "2: wrong former name: 'y'"},
    {"a last line without end", kHeader + "b\tx\tx\tf\ti\t-",
     "2: the last line has no end"},
};

TEST_F(NameLockTest, RefusesDamageWithItsLines) {
  for (const FaultCase& row : kFaultCases) {
    SCOPED_TRACE(row.why);
    Lock lock;
    HX_TextFaults faults;
    EXPECT_FALSE(lock.read(row.text.data(), row.text.size(), faults));
    EXPECT_EQ(row.faults, HX_ShownFaults(faults));
    EXPECT_EQ(0, lock.size());
    EXPECT_EQ(-1, lock.find("b"));
    // The lock stays usable.
    EXPECT_TRUE(lock.note(entry({"b", "x", "x", "f"})));
    EXPECT_EQ(kHeader + kLine, written(lock));
  }
}

// Runs over one lock: what is noted, the end, the lines after it.
struct RunCase {
  const char* why;
  std::vector<std::vector<const char*>> noted;
  int retireRuns;  // -1: prune() as well
  const char* lines;
};

const RunCase kRunCases[] = {
    {"new items",
     {{"b", "y", "x", "f"}, {"a", "x", "x", "f", "+"}},
     0,
     "a\tx\tx\tf\te\t-\nb\ty\tx\tf\ti\t-\n"},
    {"the same again",
     {{"a", "x", "x", "f", "+"}, {"b", "y", "x", "f"}},
     0,
     "a\tx\tx\tf\te\t-\nb\ty\tx\tf\ti\t-\n"},
    {"renamed and gone",
     {{"a", "z", "z", "f"}},
     2,
     "a\tz\tz\tf\ti\t-\tx\tf\te0\nb\ty\tx\tf\ti\t0\n"},
    {"runs are counted",
     {{"a", "z", "z", "f"}},
     2,
     "a\tz\tz\tf\ti\t-\tx\tf\te1\nb\ty\tx\tf\ti\t1\n"},
    {"not without a number of runs",
     {{"a", "z", "z", "f"}},
     0,
     "a\tz\tz\tf\ti\t-\tx\tf\te1\nb\ty\tx\tf\ti\t1\n"},
    {"two runs are over", {{"a", "z", "z", "f"}}, 2, "a\tz\tz\tf\ti\t-\n"},
    {"another scope",
     {{"a", "z", "z", "g"}},
     0,
     "a\tz\tz\tg\ti\t-\tz\tf\ti0\n"},
    {"back to a former name",
     {{"a", "z", "z", "f"}},
     0,
     "a\tz\tz\tf\ti\t-\tz\tg\ti0\n"},
    {"gone", {}, 0, "a\tz\tz\tf\ti\t0\tz\tg\ti0\n"},
    {"back again", {{"a", "z", "z", "f"}}, 0, "a\tz\tz\tf\ti\t-\tz\tg\ti0\n"},
    {"pruned", {}, -1, ""},
    {"new after that", {{"a", "z", "z", "f"}}, 0, "a\tz\tz\tf\ti\t-\n"},
};

TEST_F(NameLockTest, RunsRetireAndRevive) {
  Lock lock;
  for (const RunCase& row : kRunCases) {
    SCOPED_TRACE(row.why);
    lock.beginRun();
    for (const auto& fields : row.noted) EXPECT_TRUE(lock.note(entry(fields)));
    lock.endRun(row.retireRuns < 0 ? 0 : row.retireRuns);
    if (row.retireRuns < 0) lock.prune();
    EXPECT_EQ(kHeader + row.lines, written(lock));
  }
}

TEST_F(NameLockTest, TellsWhatARunDid) {
  const std::string text = kHeader +
                           "gone\tg\tg\tf\ti\t-\nkept\tk\tk\tf\ti\t-\n"
                           "renamed\tr\tr\tf\ti\t-\nrevived\tv\tv\tf\ti\t4\n";
  Lock lock;
  HX_TextFaults faults;
  ASSERT_TRUE(lock.read(text.data(), text.size(), faults));
  lock.beginRun();
  lock.note(entry({"kept", "k", "k", "f"}));
  lock.note(entry({"renamed", "r_a", "r", "f"}));
  lock.note(entry({"revived", "v", "v", "f"}));
  lock.note(entry({"added", "a", "a", "f"}));
  EXPECT_FALSE(lock.note(entry({"", "a", "a", "f"})));
  const std::pair<const char*, Lock::HxEChangeTag> kExpected[] = {
      {"gone", Lock::eGone},
      {"kept", Lock::eKept},
      {"renamed", Lock::eRenamed},
      {"revived", Lock::eRevived},
      {"added", Lock::eAdded}};
  for (const auto& [item, change] : kExpected)
    EXPECT_EQ(change, lock.change(lock.find(item))) << item;
  EXPECT_EQ(5, lock.size());
}

TEST_F(NameLockTest, StaysAsBeforeWithoutMemory) {
  HX_WithoutEachBlock("lock", [] {
    Lock lock;
    HX_TextFaults faults;
    std::string text = kHeader;
    for (int i = 10; i < 40; ++i) {
      const std::string name = "n" + std::to_string(i);
      text += name + "\t" + name + "\tw\tf\ti\t-\tformer" + name + "\tf\ti0\n";
    }
    if (!lock.read(text.data(), text.size(), faults)) {
      EXPECT_EQ(0, lock.size());
      return false;
    }
    lock.beginRun();
    const bool isNoted = lock.note(entry({"n10", "other", "other", "g"}));
    const auto& first = lock.entry(lock.find("n10"));
    EXPECT_EQ(isNoted ? "other" : "n10", first.name);
    const bool isAdded = lock.note(entry({"zz", "zz", "zz", "f"}));
    EXPECT_EQ(isAdded, lock.find("zz") >= 0);
    std::string out;
    const bool isWritten =
        lock.write([&](const char* piece, std::size_t length) {
          out.append(piece, length);
        });
    return isNoted && isAdded && isWritten;
  });
}

}  // namespace
