// Names that differ early, against the comparison of all pairs.
#include "SafeNames/HX_SignificantNames.h"

#include <cctype>
#include <random>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "SourceRef/HxCInternalSrcRef.h"
#include "support/HX_TestFixture.h"

namespace {

using Names = HX_SignificantNames;

class SignificantNamesTest : public HX_TestFixture {};

struct Rule {
  int count;
  bool folds;

  std::string partOf(const std::string& name) const {
    std::string part =
        count > 0 ? name.substr(0, static_cast<std::size_t>(count)) : name;
    for (char& c : part)
      if (folds) c = static_cast<char>(std::tolower(c));
    return part;
  }
};
constexpr Rule kRules[] = {{0, false}, {0, true}, {1, false}, {3, true},
                           {4, false}, {6, true}, {8, false}, {63, false}};

// Few letters, so that names agree often.
std::string randomName(std::mt19937& random) {
  std::string name;
  const auto length = 1 + random() % 9;
  for (auto i = length; i > 0; --i) name += "abAB_"[random() % 5];
  return name;
}

TEST_F(SignificantNamesTest, ReportsThePairsThatAComparisonOfAllFinds) {
  std::mt19937 random(HX_Seed());
  const HxCInternalSrcRef places[2] = {HxCInternalSrcRef("a", 1),
                                       HxCInternalSrcRef("b", 2)};
  for (const Rule& rule : kRules) {
    SCOPED_TRACE(std::to_string(rule.count) + (rule.folds ? " folded" : ""));
    Names names(rule.count, rule.folds);
    std::vector<std::pair<std::string, const HxCSrcRef*>> added;
    for (int i = 0; i < 300; ++i) {
      const std::string name = randomName(random);
      const HxCSrcRef* const place = &places[random() % 2];
      const auto* earlier = added.data();
      const auto* const end = earlier + added.size();
      while (earlier != end && rule.partOf(earlier->first) != rule.partOf(name))
        ++earlier;
      Names::Clash clash;
      const KyCXString text(name.c_str());
      ASSERT_EQ(earlier == end ? Names::eAdded : Names::eClash,
                names.add(text, place, clash))
          << name;
      if (earlier == end) {
        added.emplace_back(name, place);
        continue;
      }
      EXPECT_EQ(earlier->first, clash.first);
      EXPECT_EQ(name, clash.second);
      EXPECT_EQ(earlier->second, clash.firstPlace);
      EXPECT_EQ(place, clash.secondPlace);
    }
    EXPECT_EQ(static_cast<int>(added.size()), names.size());
  }
}

TEST_F(SignificantNamesTest, VariantsDifferEarlyAndFreeNamesStay) {
  std::mt19937 random(HX_Seed());
  for (const Rule& rule : kRules) {
    SCOPED_TRACE(std::to_string(rule.count) + (rule.folds ? " folded" : ""));
    Names names(rule.count, rule.folds);
    std::set<std::string> parts;
    for (int i = 0; i < 300; ++i) {
      const std::string wanted = randomName(random);
      KyCXString name(wanted.c_str());
      Names::Clash clash;
      const bool isFree = parts.count(rule.partOf(wanted)) == 0;
      const auto outcome = names.addUnique(name, nullptr, clash);
      if (outcome == Names::eNoVariant) {
        EXPECT_FALSE(isFree);
        EXPECT_EQ(wanted, name.cstring());
        EXPECT_TRUE(rule.count == 1 || rule.count == 3);
        continue;
      }
      ASSERT_EQ(Names::eAdded, outcome) << wanted;
      EXPECT_EQ(isFree, wanted == name.cstring());
      EXPECT_EQ(isFree, clash.first == nullptr);
      EXPECT_TRUE(parts.insert(rule.partOf(name.cstring())).second)
          << name.cstring();
      if (!isFree && rule.count > 0) {
        EXPECT_LE(name.length(), rule.count);
      }
    }
  }
}

struct VariantCase {
  int count;
  bool folds;
  const char* present;
  const char* wanted;
  const char* entered;  // null: no variant is left
};

const VariantCase kVariantCases[] = {
    {6, false, "engine_speed", "engine_load", "engi_a"},
    {6, false, "engine_speed", "enginE_load", "enginE_load"},
    {6, true, "engine_speed", "enGinE_load", "enGi_a"},
    {6, false, "abc", "abc", "abc_a"},
    {6, false, "abcd", "abcd", "abcd_a"},
    {6, false, "abcde", "abcde", "abcd_a"},
    {2, false, "ab", "ab", nullptr},
    {3, false, "abc", "abcd", "a_a"},
    {0, false, "abcdef", "abcdef", "abcdef_a"},
};

TEST_F(SignificantNamesTest, VariantStandsInTheFirstCharacters) {
  for (const VariantCase& row : kVariantCases) {
    SCOPED_TRACE(row.wanted);
    Names names(row.count, row.folds);
    Names::Clash clash;
    names.add(row.present, nullptr, clash);
    KyCXString name(row.wanted);
    EXPECT_EQ(row.entered != nullptr ? Names::eAdded : Names::eNoVariant,
              names.addUnique(name, nullptr, clash));
    EXPECT_STREQ(row.entered != nullptr ? row.entered : row.wanted,
                 name.cstring());
  }
}

TEST_F(SignificantNamesTest, LeavesASetWholeWithoutMemory) {
  HX_WithoutEachBlock("significant names", [] {
    Names names(6, true);
    bool isDone = true;
    for (int i = 0; isDone && i < 40; ++i) {
      KyCXString name("Engine_speed");
      Names::Clash clash;
      const int before = names.size();
      isDone = names.addUnique(name, nullptr, clash) == Names::eAdded;
      EXPECT_EQ(before + (isDone ? 1 : 0), names.size());
      EXPECT_EQ(isDone && i != 0,
                std::string("Engine_speed") != name.cstring());
    }
    return isDone;
  });
}

}  // namespace
