#include "DependencySorting/HxCDependencySorting.h"

#include <pthread.h>

#include <algorithm>
#include <bit>
#include <deque>
#include <functional>
#include <map>
#include <random>
#include <set>
#include <string>
#include <vector>

#include "DependencySorting/HX_PlainSorting.h"
#include "Trace/HxCTraceFallThrough.h"
#include "platform/containers/dictionary.h"
#include "support/HX_TestFixture.h"

// A variable or a data type with three sorting keys.
class HxCSsNode : public HxCDepSortNode {
 public:
  explicit HxCSsNode(const char* name, bool isVariable = false, int key = 0,
                     int minorKey = 0, int leastKey = 0)
      : keys{key, minorKey, leastKey}, m_Name(name), m_IsVariable(isVariable) {}

  HxCSsNode* isSsNode() override { return m_IsVariable ? this : nullptr; }
  const KyCXString& getName() override { return m_Name; }

  int keys[3];

 private:
  KyCXString m_Name;
  bool m_IsVariable;
};

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class KeyComp : public HxCDepSortComp {
 public:
  explicit KeyComp(int index) : m_Index(index) {}
  int compare(HxCDepSortNode* a, HxCDepSortNode* b) override {
    return static_cast<HxCSsNode*>(a)->keys[m_Index] -
           static_cast<HxCSsNode*>(b)->keys[m_Index];
  }

 private:
  int m_Index;
};

class DependencySortingTest : public HX_TestFixture {
 protected:
  ~DependencySortingTest() override {
    HxCDepSortNode::setComp(nullptr);
    HxCTraceFallThrough::setVerbose(false);
  }

  // Drives the sorter and its plain form alike.
  void add(HxCDepSortNode* node) {
    m_Sorting.add(node);
    m_Plain.add(node);
  }
  void depend(HxCDepSortNode* first, HxCDepSortNode* second) {
    m_Sorting.addDependency(first, second);
    m_Plain.addDependency(first, second);
  }
  void init(int criteria) {
    leda::array<HxCDepSortComp*> list = {&m_Major, &m_Minor, &m_Least};
    list.resize(criteria);
    m_Sorting.setSortingCriteriaAndInit(list);
    m_Plain.setSortingCriteriaAndInit({list.begin(), list.end()});
  }
  void reinit() {
    m_Sorting.reinit();
    m_Plain.reinit();
  }
  // Sorts with both; true if everything that can be seen is the same.
  bool sortsAlike() {
    clearMessages();
    HxCDepSortNode::setComp(nullptr);
    m_Plain.report.clear();
    const bool plainSuccess = m_Plain.sort();
    HxCDepSortComp* plainComp = HxCDepSortNode::getComp();
    HxCDepSortNode::setComp(nullptr);
    const bool success = m_Sorting.sort();
    const leda::array<HxCDepSortNode*> result = m_Sorting.getNodes();

    std::vector<std::string> lines = messages();
    bool same = success == plainSuccess &&
                HxCDepSortNode::getComp() == plainComp &&
                std::ranges::equal(result, m_Plain.result);
    if (!m_Plain.report.empty()) {
      same = same && !lines.empty() && lines.back() == cycle(m_Plain.report);
      lines.resize(lines.empty() ? 0 : lines.size() - 1);
    }
    const auto isIgnored = [](const std::string& line) {
      return line.starts_with(
          "7/3 Internal error. Error code: DependencySorting/"
          "implDependencySorting/HxCDepSortingGraph.cpp_");
    };
    return same && std::ranges::all_of(lines, isIgnored) &&
           lines.size() == static_cast<std::size_t>(m_Plain.ignored);
  }
  static std::string cycle(const std::string& report) {
    return "403/2 Found unresolvable dependencies between the following " +
           report + ". Modify your modeling.";
  }

  // Sorts isolated nodes with these major keys, added in this order.
  bool sortsKeysAlike(const std::vector<int>& keys) {
    std::deque<HxCSsNode> nodes;
    reinit();
    for (int key : keys) {
      const int place = static_cast<int>(nodes.size());
      add(&nodes.emplace_back("n", false, key, place * 7 % 3, place % 2));
    }
    return sortsAlike();
  }

  std::string names() {
    std::string text;
    for (HxCDepSortNode* node : m_Sorting.getNodes())
      text += node == nullptr ? "-" : node->getName().cstring();
    return text;
  }

  KeyComp m_Major{0};
  KeyComp m_Minor{1};
  KeyComp m_Least{2};
  HxCDependencySorting m_Sorting;
  HX_PlainSorting m_Plain;
};

// Calls use with every sequence of the given length over 0 .. values - 1.
void forAllSequences(int length, int values,
                     const std::function<void(const std::vector<int>&)>& use) {
  std::vector<int> digits(static_cast<std::size_t>(length), 0);
  while (true) {
    use(digits);
    auto digit = std::ranges::find_if(digits, [&](int& d) {
      d = (d + 1) % values;
      return d != 0;
    });
    if (digit == digits.end()) return;
  }
}

struct OrderCase {
  const char* why;
  const char* added;         // names in the order of add()
  const char* dependencies;  // pairs of names, the first goes first
  const char* order;
};

const OrderCase kOrderCases[] = {
    {"nothing", "", "", ""},
    {"isolated nodes arrive reversed", "ABC", "", "CBA"},
    {"free together: by name", "BAC", "BCAC", "ABC"},
    {"dependent before isolated", "ZAB", "AB", "ABZ"},
    {"breadth first: D waits for C", "ABCD", "ABBDAC", "ABCD"},
    {"the order of the dependencies is none", "ACB", "ACAB", "ABC"},
    {"a dependency twice", "BA", "ABAB", "AB"},
    {"added twice: the dependency concerns the later copy", "ABA", "AB", "ABA"},
};

TEST_F(DependencySortingTest, DependentNodesComeInOrderBeforeIsolatedOnes) {
  std::map<char, HxCSsNode> nodes;
  for (char c : std::string("ABCDZ"))
    nodes.emplace(c, HxCSsNode(std::string(1, c).c_str()));
  init(0);
  for (const OrderCase& row : kOrderCases) {
    SCOPED_TRACE(row.why);
    reinit();
    for (const char* c = row.added; *c; ++c) add(&nodes.at(*c));
    for (const char* c = row.dependencies; *c; c += 2)
      depend(&nodes.at(c[0]), &nodes.at(c[1]));
    EXPECT_TRUE(sortsAlike());
    EXPECT_EQ(names(), row.order);
    EXPECT_THAT(messages(), IsEmpty());
  }
}

TEST_F(DependencySortingTest, ACycleIsReportedWithAllDependentNodes) {
  HxCSsNode type("T"), variable("V", true), isolated("I"), last("L");
  struct Row {
    std::vector<HxCSsNode*> added;
    const char* report;
  };
  const Row rows[] = {
      {{&isolated, &type, &last, &variable}, "data types : T, L, V"},
      {{&variable, &type, &isolated, &last}, "variables : V, T, L"},
  };
  HxCTraceFallThrough::setVerbose(true);
  for (const Row& row : rows) {
    reinit();
    for (HxCSsNode* node : row.added) add(node);
    depend(&variable, &last);
    depend(&type, &type);
    clearMessages();
    EXPECT_FALSE(m_Sorting.sort());
    EXPECT_THAT(
        messages(),
        ElementsAre(
            cycle(row.report),
            "1272/4 trace fall through - early abortion. [Internal: Module: "
            "'DependencySorting/implDependencySorting/HxCDepSortingGraph', "
            "Line: 501 Reason: cause unknown!]"));
    EXPECT_EQ(names(), "VL-I");
  }
}

// The nodes before the null stay hidden, so the second sort sees fewer.
TEST_F(DependencySortingTest, NullWithoutDependenciesFailsSilently) {
  HxCSsNode a("A"), b("B"), c("C");
  init(2);
  for (HxCSsNode* node : {&b, &c, static_cast<HxCSsNode*>(nullptr), &a})
    add(node);
  depend(&b, &a);
  EXPECT_TRUE(sortsAlike());
  EXPECT_EQ(names(), "---C");
  EXPECT_TRUE(sortsAlike());
  EXPECT_EQ(names(), "---C---");
  EXPECT_FALSE(m_Sorting.sort());
  EXPECT_THAT(messages(), IsEmpty());
  reinit();
  EXPECT_EQ(names(), "---C-------");
  add(&c);
  EXPECT_TRUE(m_Sorting.sort());
  EXPECT_EQ(names(), "C");
}

// Equal digits are equal names and keys: 0 .. k - 1 without gaps give each
// pattern of equals once.
bool isTiePattern(const std::vector<int>& digits) {
  for (int digit : digits) {
    if (digit > 0 && std::ranges::count(digits, digit - 1) == 0) return false;
  }
  return true;
}

// Bit p of a graph is the edge from node p % count to the node 1 + p / count
// further on; the last count bits are the loops, of which one is enough.
TEST_F(DependencySortingTest, AllSmallGraphsSortAsInThePlainForm) {
  const char* const names[] = {"a", "b", "c", "d"};
  init(2);
  std::set<unsigned> cyclic;  // graphs that one pattern has shown to fail
  const auto sortGraphs = [&](const std::vector<int>& digits, int bits) {
    const std::size_t count = digits.size();
    std::deque<HxCSsNode> nodes;
    for (int d : digits) nodes.emplace_back(names[d], d == 0, d / 2, -d);
    for (unsigned graph = 0; graph < 1U << bits; ++graph) {
      const unsigned loops = graph >> (count * count - count);
      if (cyclic.count(graph) != 0 || std::popcount(loops) > 1) continue;
      reinit();
      for (HxCSsNode& node : nodes) add(&node);
      for (std::size_t p = 0; graph >> p != 0; ++p) {
        if ((graph >> p & 1) != 0)
          depend(&nodes[p % count], &nodes[(p + p / count + 1) % count]);
      }
      ASSERT_TRUE(sortsAlike())
          << "graph " << graph << " of " << testing::PrintToString(digits);
      if (!m_Plain.report.empty()) cyclic.insert(graph);
    }
  };
  for (int count = 0; count <= 4; ++count) {
    cyclic.clear();
    forAllSequences(count, count, [&](const std::vector<int>& digits) {
      if (!isTiePattern(digits)) return;
      const int loops = cyclic.empty() ? count : 0;
      sortGraphs(digits, count * (count - 1) + loops);
    });
  }
}

TEST_F(DependencySortingTest, AllSmallBlocksSortAsInThePlainForm) {
  init(3);
  for (int count = 1; count <= 6; ++count) {
    forAllSequences(count, count, [&](const std::vector<int>& keys) {
      if (!isTiePattern(keys)) return;
      ASSERT_TRUE(sortsKeysAlike(keys)) << testing::PrintToString(keys);
    });
  }
}

// All batches of nine nodes under three names.
TEST_F(DependencySortingTest, EqualNamesLieAsASelectionSortLeavesThem) {
  const char* const names[] = {"a", "b", "c"};
  HxCSsNode last("z");
  forAllSequences(9, 3, [&](const std::vector<int>& digits) {
    std::deque<HxCSsNode> nodes;
    reinit();
    for (int d : digits) {
      add(&nodes.emplace_back(names[d]));
      depend(&nodes.back(), &last);
    }
    add(&last);
    ASSERT_TRUE(sortsAlike()) << testing::PrintToString(digits);
  });
}

TEST_F(DependencySortingTest, BadInputSortsAsInThePlainForm) {
  struct Shape {
    const char* why;
    int (*key)(int place, int count);
  };
  const Shape shapes[] = {
      {"rising", [](int i, int) { return i; }},
      {"falling", [](int i, int n) { return n - i; }},
      {"all equal", [](int, int) { return 0; }},
      {"organ pipe", [](int i, int n) { return std::min(i, n - 1 - i); }},
      {"valley", [](int i, int n) { return std::max(i, n - 1 - i); }},
      {"saw", [](int i, int) { return i % 17; }},
      {"shuffled, then rising",
       [](int i, int n) { return 2 * i < n ? i * 379 % n : n + i; }},
      {"rising but for two, equals at the far end",
       [](int i, int n) { return i < 2 ? n - 2 + i : std::max(1, n - 1 - i); }},
      {"shuffled", [](int i, int n) { return i * 379 % n; }},
  };
  init(3);
  for (const Shape& shape : shapes) {
    for (int width : {1, 2, 3, 40}) {
      for (int count : {2, 100, 700}) {
        std::vector<int> keys;
        for (int i = 0; i < count; ++i)
          keys.push_back(shape.key(i, count) / width);
        EXPECT_TRUE(sortsKeysAlike(keys))
            << shape.why << ", " << count << " keys / " << width;
      }
    }
  }
}

// Any sequence of calls, with null, strangers, cycles and repeated sorts.
TEST_F(DependencySortingTest, RandomUseSortsAsInThePlainForm) {
  for (unsigned seed = 1; seed <= 300; ++seed) {
    SCOPED_TRACE("seed " + std::to_string(seed));
    std::mt19937 random(seed);
    const auto below = [&](int n) {
      return static_cast<int>(random() % static_cast<unsigned>(n));
    };
    const bool mayFail = seed % 4 == 0;
    const int count = 1 + below(120), variants = 1 + below(20);
    std::deque<HxCSsNode> nodes;
    const auto pick = [&]() -> HxCDepSortNode* {
      const int i = below(count + (mayFail ? 1 : 0));
      return i == count ? nullptr : &nodes[static_cast<std::size_t>(i)];
    };
    for (int i = 0; i <= count; ++i) {
      nodes.emplace_back(std::to_string(below(variants)).c_str(), below(2) == 0,
                         below(variants), below(3), below(2));
    }
    reinit();
    init(below(4));
    for (int round = 0; round < 4; ++round) {
      for (int i = 0; i < count; ++i) add(&nodes[static_cast<std::size_t>(i)]);
      if (mayFail) add(pick());
      for (int i = below(2 * count); i > 0; --i) {
        HxCDepSortNode* first = pick();
        HxCDepSortNode* second = pick();
        if (mayFail && below(50) == 0) second = &nodes.back();  // not added
        if (!mayFail && first >= second) continue;
        depend(first, second);
      }
      ASSERT_TRUE(sortsAlike()) << "round " << round;
      if (below(2) == 0) reinit();
      if (below(4) == 0) init(below(4));
    }
  }
}

// Sorts in a thread whose stack a recursion over the nodes would burst.
bool sortWithSmallStack(HxCDependencySorting& sorting) {
  pthread_attr_t attributes;
  pthread_attr_init(&attributes);
  EXPECT_EQ(pthread_attr_setstacksize(&attributes, 256 * 1024), 0);
  const auto run = [](void* argument) -> void* {
    return static_cast<HxCDependencySorting*>(argument)->sort() ? argument
                                                                : nullptr;
  };
  pthread_t thread;
  void* result = nullptr;
  EXPECT_EQ(pthread_create(&thread, &attributes, run, &sorting), 0);
  EXPECT_EQ(pthread_join(thread, &result), 0);
  pthread_attr_destroy(&attributes);
  return result != nullptr;
}

// Half a million steps squared would take hours.
TEST_F(DependencySortingTest, LargeBadInputNeedsLittleStackAndTime) {
  init(2);
  for (int width : {1, 2}) {
    std::deque<HxCSsNode> nodes;
    const int count = width == 1 ? 1'000'000 : 200'000;
    m_Sorting.reinit();
    for (int i = 0; i < count; ++i)
      m_Sorting.add(&nodes.emplace_back("", false, i / width, -i));
    EXPECT_TRUE(sortWithSmallStack(m_Sorting));
    const leda::array<HxCDepSortNode*> result = m_Sorting.getNodes();
    ASSERT_EQ(result.size(), count);
    for (int i = 0; i < count; ++i)
      ASSERT_EQ(static_cast<HxCSsNode*>(result[i])->keys[0], i / width);
  }
}

TEST_F(DependencySortingTest, ContainersSortByTheCurrentCriterion) {
  HxCSsNode a("a", false, 1, 9), b("b", false, 2, 3);
  for (KeyComp* comp : {&m_Major, &m_Minor}) {
    HxCDepSortNode::setComp(comp);
    leda::dictionary<HxCDepSortNode*, int> ordered;
    for (HxCSsNode* node : {&b, &a}) ordered.insert(node, 0);
    const bool isAFirst = comp == &m_Major;
    EXPECT_EQ(ordered.key(ordered.first_item()), isAFirst ? &a : &b);
    EXPECT_EQ(leda::compare<HxCDepSortNode*>(&a, &b) < 0, isAFirst);
    EXPECT_EQ(leda::compare<HxCDepSortNode*>(&b, &a) < 0, !isAFirst);
  }
}

TEST_F(DependencySortingTest, WithoutMemoryTheSortFails) {
  HX_CountingController controller;
  {
    HxCDependencySorting sorting;
    EXPECT_EQ(controller.liveBlocks(), 1);
    controller.fail();
    HxCDependencySorting none;
    none.reinit();
    EXPECT_TRUE(sorting.sort());
    EXPECT_FALSE(none.sort());
  }
  EXPECT_EQ(controller.liveBlocks(), 0);
  HX_WithoutEachBlock("sort", [] {
    HxCSsNode first("a"), second("b");
    HxCDependencySorting sorter;
    for (HxCDepSortNode* node : {&first, &second}) sorter.add(node);
    sorter.addDependency(&second, &first);
    return sorter.sort() && sorter.getNodes()[0] == &second;
  });
}

TEST_F(DependencySortingTest, NodesKeepTheOrdinalOfTheCaller) {
  HxCSsNode a("A");
  EXPECT_EQ(a.getOrdNr(), -1);
  a.setOrdNr(7);
  add(&a);
  EXPECT_TRUE(sortsAlike());
  EXPECT_EQ(HxCSsNode(a).getOrdNr(), 7);
}

}  // namespace
