#include "NameSpace/HX_LimitedNameSpace.h"

#include <iterator>
#include <map>
#include <random>

#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/HxCSymbol.h"
#include "support/HX_TestFixture.h"

namespace {

class LimitedNameSpaceTest : public HX_TestFixture {
 protected:
  LimitedNameSpaceTest() { HxCGlobal::setOptions(&m_Options); }
  ~LimitedNameSpaceTest() override { HxCGlobal::setOptions(nullptr); }

  HX_OptionsExt m_Options;
};

// Plain form of the set: tries every suffix.
struct PlainNames {
  bool derive(KyCXString& s, bool addResult, bool adaptLength) {
    HxCNames naming;
    const KyCXString in = s;
    if (adaptLength) shorten(s);
    const auto base = counters.find(s);
    if (base != counters.end()) {
      int c = base->second;
      for (;; ++c, s = in) {
        naming.appendSuffix(s, c);
        if (adaptLength) shorten(s);
        if (counters.count(s) == 0) break;
      }
      base->second = c;
    }
    if (addResult) counters.emplace(s, 0);
    return base != counters.end();
  }
  static void shorten(KyCXString& s) {
    s.shortenString(HxCSymbol::sm_MaxNameLength, 2, '_',
                    KyCXString::ePositionMiddle);
  }

  std::map<KyCXString, int> counters;
};

struct MixCase {
  const char* why;
  unsigned shortest, longest;  // length of the drawn names
  unsigned characters;         // taken from the front of kUnits
  unsigned switching;  // per mille of steps that switch the limit option
  unsigned removing;   // per cent of steps that remove
};

constexpr unsigned short kUnits[] = {'a', '_', 'z', 'Z', 0x100, 0x101, 0};

const MixCase kMixCases[] = {
    {"few bases, many variants", 1, 2, 2, 0, 5},
    {"variants of variants, much removed", 1, 6, 3, 0, 40},
    {"around the limit", 20, 40, 1, 5, 20},
    {"long names, wide and zero units", 22, 36, 7, 5, 20},
    {"one head under the limit", 31, 200, 1, 0, 2},
};

TEST_F(LimitedNameSpaceTest, AgreesWithTryingEachSuffix) {
  for (const MixCase& row : kMixCases) {
    for (unsigned seed = 1; seed <= 4; ++seed) {
      SCOPED_TRACE(testing::Message() << row.why << ", seed " << seed);
      HX_CountingController memory;
      std::mt19937 random(seed);
      m_Options.setLimitVariableNameLength(seed % 2 == 0);
      HX_LimitedNameSpace names;
      PlainNames plain;
      for (int i = 0; i < 2500; ++i) {
        std::vector<unsigned short> text(
            row.shortest + random() % (row.longest - row.shortest + 1));
        for (auto& unit : text) unit = kUnits[random() % row.characters];
        KyCXString s(text.data(), static_cast<int>(text.size()));
        if (random() % 4 == 0 && !plain.counters.empty())
          s = std::next(plain.counters.begin(),
                        static_cast<long>(random() % plain.counters.size()))
                  ->first;
        if (random() % 4 == 0) PlainNames::shorten(s);
        if (random() % 4 == 0)
          HxCNames().appendSuffix(s, static_cast<int>(random() % 4));
        if (random() % 1000 < row.switching)
          m_Options.setLimitVariableNameLength(random() % 2 == 0);
        if (random() % 500 == 0) {
          const HX_LimitedNameSpace copy(names);
          names = HX_LimitedNameSpace();
          names = copy;
        }
        KyCXString expected = s;
        ASSERT_EQ(names.isDefined(s), plain.counters.count(s) != 0);
        if (random() % 100 < row.removing) {
          names.remove(s);
          plain.counters.erase(s);
          continue;
        }
        if (random() % 16 == 0) {
          names.add(&s);
          plain.counters.emplace(s, 0);
          continue;
        }
        bool derived = false;
        const unsigned operation = random() % 8;
        const bool isDerived =
            plain.derive(expected, operation > 3, operation < 2);
        if (operation > 3)
          names.addUnique(s);
        else if (operation == 3)
          names.deriveUniqueString(&s, derived);
        else if (operation == 2)
          names.deriveUniqueString(&s);
        else if (operation == 1)
          names.deriveUniqueStringAdaptLength(s, derived);
        else
          names.deriveUniqueStringAdaptLength(s);
        ASSERT_EQ(s, expected) << i;
        ASSERT_EQ(derived, isDerived && (operation == 1 || operation == 3))
            << i;
      }
      for (const auto& [text, counter] : plain.counters) names.remove(text);
      EXPECT_EQ(memory.liveBlocks(), 1) << "the table of no names";
      names = HX_LimitedNameSpace();
      EXPECT_EQ(memory.liveBlocks(), 0);
    }
  }
}

// Without notes of the suffixes taken, 200 million lookups.
TEST_F(LimitedNameSpaceTest, ManyNamesCompeteForTheVariantsOfOneHead) {
  constexpr int kCount = 20000;
  m_Options.setLimitVariableNameLength(true);
  HxCNames naming;
  HX_LimitedNameSpace names;
  for (int i = 0; i < kCount; ++i) {
    KyCXString name = KyCXString("the_same_thirty_characters_and_") +
                      KyCXString(i, false, true);
    KyCXString expected = name;
    naming.appendSuffix(expected, i);
    names.add(name);
    names.addUnique(name);
    ASSERT_EQ(name, expected);
  }
}

}  // namespace
