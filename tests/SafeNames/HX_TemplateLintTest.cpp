// Templates without a model, against what the engine says of them.
#include "SafeNames/HX_TemplateLint.h"

#include <algorithm>
#include <random>
#include <string>
#include <vector>

#include "Naming/HX_NamingFixture.h"
#include "SafeNames/HX_ReservedNames.h"

namespace {

using Lint = HX_TemplateLint;
using Reserved = HX_ReservedNames;

class TemplateLintTest : public HX_NamingFixture {
 protected:
  // The numbers of messages 1202 and 1203 of the engine.
  std::vector<int> engineMessages(const std::string& form) {
    clearMessages();
    Id id = identifier(form);
    names.createNameFromForm(id, nullptr, 0, 0, false);
    mayChange = id.getIdentifierChangeable(Id::eActualName);
    actual = id.getCookedName(Id::eActualName);
    std::vector<int> numbers;
    for (const HX_Message& message : HX_MessageHandler::instance().messages())
      if (message.row == 1202 || message.row == 1203)
        numbers.push_back(message.row);
    return numbers;
  }

  bool mayChange = false;
  KyCXString actual;
};

const char* const kPieces[] = {"a",       "_",
                               "str",     "$B",
                               "$S",      "$R",
                               "$M",      "$Q",
                               "$x",      "$V",
                               "$E(a)",   "$E('(')",
                               "$(Task)", "$(Q)",
                               "$$",      "$",
                               ":",       "(",
                               ")",       "$(",
                               "$(Time)", "$T",
                               "$(Type)", "$E",
                               "E1",      "$(Period10ms)",
                               "$X"};

std::string randomForm(std::mt19937& random) {
  std::string form;
  for (auto pieces = 1 + random() % 5; pieces > 0; --pieces)
    form += kPieces[random() % std::size(kPieces)];
  return form;
}

// The engine expands an actual template that repeats the formal one only once,
// so templates of two parts are compared part by part.
TEST_F(TemplateLintTest, GivesTheVerdictsOfTheEngine) {
  std::mt19937 random(HX_Seed());
  for (int i = 0; i < 4000; ++i) {
    std::string form = randomForm(random);
    SCOPED_TRACE(form);
    Lint lint;
    ASSERT_TRUE(lint.read(form.c_str()));
    EXPECT_EQ(1 + std::count(form.begin(), form.end(), ':'), lint.partCount());
    const std::size_t first = form.find(':');
    const bool hasParts = first != std::string::npos;
    const std::string formal = form.substr(0, first);
    const std::string rest = hasParts ? form.substr(first + 1) : formal;
    const std::string second = rest.substr(0, rest.find(':'));
    std::vector<int> formalVerdicts, actualVerdicts;
    for (int m = 0; m < lint.macroCount(); ++m) {
      const Lint::Macro& macro = lint.macro(m);
      EXPECT_EQ(macro.text.cstring(),
                form.substr(static_cast<std::size_t>(macro.position),
                            static_cast<std::size_t>(macro.text.length())));
      if (macro.message != 0)
        (macro.isFormal ? formalVerdicts : actualVerdicts)
            .push_back(macro.message);
    }
    if (hasParts && !formal.empty()) {
      EXPECT_EQ(engineMessages(formal), formalVerdicts);
    }
    if (!second.empty()) {
      EXPECT_EQ(engineMessages(second), actualVerdicts);
    }
    if (formal.empty() || second.empty()) continue;
    engineMessages(form);
    EXPECT_EQ(mayChange, lint.mayChange());
  }
}

struct LengthCase {
  const char* form;
  int fixedLength;
  int longest;
};

const LengthCase kLengthCases[] = {
    {"", 0, 0},
    {"speed", 5, 5},
    {"a$$b", 2, 3},
    {"a$R", 1, 1},
    {"a$Bc", 2, -1},
    {"a$Qc", 4, 4},
    {"$(Period10us)x", 1, 11},
    {"$(Time10us)x", 1, 22},
    {"$(Time)", 0, 25},
    {"long_formal_$B:x$R", 1, 1},
    {"x:yy$B:zzz", 2, -1},
    {"a$(Task", 7, 7},
};

TEST_F(TemplateLintTest, TellsTheLongestResult) {
  for (const LengthCase& row : kLengthCases) {
    SCOPED_TRACE(row.form);
    Lint lint;
    ASSERT_TRUE(lint.read(row.form));
    EXPECT_EQ(row.fixedLength, lint.fixedLength());
    EXPECT_EQ(row.longest, lint.longest());
    EXPECT_EQ(std::string(row.form).find("$(Task") != std::string::npos,
              lint.isUnclosed());
  }
  // The longest values there are.
  Id id("$(Time)");
  names.replaceMultirateTimeName(id, 1e30, 1e30, true);
  EXPECT_LE(id.getCookedName(Id::eFormalName).length(), 25);
}

struct PatternCase {
  const char* form;
  unsigned always;
};

const PatternCase kPatternCases[] = {
    {"str$B", 0},
    {"strx$B", Reserved::ePatternStr},
    {"$Bstr", 0},
    {"$B_t", Reserved::ePatternType},
    {"$B_t:$B", 0},
    {"$B:$B_t$R", Reserved::ePatternType},
    {"_A$B",
     Reserved::ePatternUnderscoreCapital | Reserved::ePatternFileUnderscore},
    {"a  $B", Reserved::ePatternUnderscores},
    {"1$B", Reserved::ePatternFileUnderscore},
    {"$R__x", Reserved::ePatternFirstUnderscores |
                  Reserved::ePatternUnderscores |
                  Reserved::ePatternFileUnderscore},
    {"SIG$B", Reserved::ePatternSignal},
    {"E$B", 0},
    {"ERR_$B", Reserved::ePatternErrno},
    {"$$x", Reserved::ePatternFileUnderscore},
};

TEST_F(TemplateLintTest, TellsPatternsThatEveryResultMatches) {
  for (const PatternCase& row : kPatternCases) {
    SCOPED_TRACE(row.form);
    Lint lint;
    ASSERT_TRUE(lint.read(row.form));
    const unsigned always = lint.alwaysMatching(Reserved::ePatternAll, true);
    EXPECT_EQ(row.always, always);
    // And so do names of the engine.
    for (const char* const block : {"Gain", "a", "1", "_", "T x"}) {
      HX_Block named(block, &ctrl);
      Id id = identifier(row.form, named.getSrcRef());
      names.createNameFromForm(id, nullptr, 0, 0, true);
      id.makeCIdentifier();
      const KyCXString& name = id.getCookedName(Id::eActualName);
      for (unsigned bit = 1; bit <= Reserved::ePatternAll; bit <<= 1) {
        EXPECT_EQ(always & bit, Reserved::matching(name, always & bit, true))
            << block;
      }
    }
    EXPECT_EQ(0u, lint.alwaysMatching(0, true));
  }
}

TEST_F(TemplateLintTest, IsEmptyWithoutMemory) {
  HX_WithoutEachBlock("lint", [] {
    Lint lint;
    const bool isRead = lint.read("$B_$S_$R_x_$M:$A_$B_$C_$D");
    EXPECT_EQ(isRead ? 8 : 0, lint.macroCount());
    EXPECT_EQ(isRead ? 2 : 1, lint.partCount());
    return isRead;
  });
}

}  // namespace
