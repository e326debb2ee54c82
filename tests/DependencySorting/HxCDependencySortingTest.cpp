#include "DependencySorting/HxCDependencySorting.h"

#include <pthread.h>

#include <algorithm>
#include <cstdlib>
#include <deque>
#include <map>
#include <random>
#include <utility>

#include "Control/HX_Memory.h"
#include "DependencySorting/HxCDepSortComp.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "Trace/HxCTraceFallThrough.h"
#include "platform/containers/dictionary.h"
#include "platform/strings/KyCXString.h"
#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

// A variable or a data type with three sorting keys.
class HxCSsNode : public HxCDepSortNode {
 public:
  explicit HxCSsNode(const std::string& text, bool isVariable = false,
                     int key = 0, int minorKey = 0, int leastKey = 0)
      : keys{key, minorKey, leastKey}, name(text.c_str()), isSs(isVariable) {}

  HxCSsNode* isSsNode() override { return isSs ? this : nullptr; }
  const KyCXString& getName() override { return name; }

  int keys[3];
  KyCXString name;
  bool isSs;
};

namespace {

using Node = HxCDepSortNode*;

// Plain form of the order: quadratic, recursive and short.
struct PlainSorting {
  struct Vertex {
    Node node;
    std::vector<Vertex*> out = {};
    int in = 0;
    bool hidden = false;
  };
  using Batch = std::vector<Vertex*>;

  static std::string nameOf(const Vertex* vertex) {
    return vertex->node == nullptr ? "" : vertex->node->getName().cstring();
  }

  bool sort() {
    std::map<Node, Vertex*> vertexOf;
    for (Node node : nodes) vertexOf[node] = &graph.emplace_back(Vertex{node});
    messages.clear();
    for (auto [first, second] : std::exchange(dependencies, {})) {
      if (vertexOf.count(first) * vertexOf.count(second) == 0) {
        messages.push_back(testing::StartsWith(
            "7/3 Internal error. Error code: DependencySorting/"
            "implDependencySorting/HxCDepSortingGraph.cpp_"));
        continue;
      }
      vertexOf[first]->out.push_back(vertexOf[second]);
      ++vertexOf[second]->in;
    }
    Batch rest;
    for (Vertex& v : graph) {
      if (!v.hidden) rest.push_back(&v);
    }
    int free = static_cast<int>(rest.size());
    result.resize(free);
    for (Vertex* v : rest) {
      if (v->in != 0 || !v->out.empty()) continue;
      if (v->node == nullptr) return false;
      result[--free] = v->node;
      v->hidden = true;
    }
    sortByCriteria(free, result.size() - 1, 0);
    std::erase_if(rest, [](const Vertex* v) { return v->hidden; });
    if (!sortTopologically(rest)) return false;
    for (Vertex& v : graph) v.hidden = false;
    return true;
  }

  bool sortTopologically(const Batch& all) {
    std::map<Vertex*, int> waitsFor;
    Batch queue, batch;
    for (Vertex* v : all) {
      if ((waitsFor[v] = v->in) == 0) batch.push_back(v);
    }
    for (std::size_t k = 0;; ++k) {
      for (auto i = batch.begin(); i != batch.end(); ++i)
        std::iter_swap(i, std::ranges::min_element(i, batch.end(), {}, nameOf));
      queue.insert(queue.end(), batch.begin(), batch.end());
      batch.clear();
      if (k == queue.size()) break;
      result[static_cast<int>(k)] = queue[k]->node;
      for (Vertex* target : queue[k]->out) {
        if (--waitsFor[target] == 0) batch.push_back(target);
      }
    }
    if (queue.size() == all.size()) return true;
    const bool isVariable = all[0]->node && all[0]->node->isSsNode();
    std::string kindAndNames = isVariable ? "variables : " : "data types : ";
    for (const Vertex* v : all)
      kindAndNames += (v == all[0] ? "" : ", ") + nameOf(v);
    messages.push_back(
        "403/2 Found unresolvable dependencies between the following " +
        kindAndNames + ". Modify your modeling.");
    return false;
  }

  void sortByCriteria(int low, int high, std::size_t level) {
    if (level == criteria.size() || low >= high) return;
    HxCDepSortComp* comp = criteria[level];
    HxCDepSortNode::setComp(comp);
    quicksort(low, high, comp);
    for (int first = low, i = low; i <= high; ++i) {
      if (i < high && comp->compare(result[i], result[i + 1]) == 0) continue;
      sortByCriteria(first, i, level + 1);
      first = i + 1;
    }
  }

  void quicksort(int low, int high, HxCDepSortComp* comp) {
    if (high <= low) return;
    int i = low, j = high - 1;
    while (true) {
      while (i < high && comp->compare(result[i], result[high]) < 0) ++i;
      while (j >= low && comp->compare(result[j], result[high]) > 0) --j;
      if (i >= j) break;
      std::swap(result[i++], result[j--]);
    }
    std::swap(result[i], result[high]);
    quicksort(low, i - 1, comp);
    quicksort(i + 1, high, comp);
  }

  std::vector<HxCDepSortComp*> criteria = {};
  std::vector<Node> nodes = {};
  std::vector<std::pair<Node, Node>> dependencies = {};
  std::deque<Vertex> graph = {};
  leda::array<Node> result = {};
  std::vector<testing::Matcher<std::string>> messages = {};  // of the last sort
};

struct KeyComp : HxCDepSortComp {
  explicit KeyComp(int level) : index(level) {}
  int compare(Node a, Node b) override {
    return static_cast<HxCSsNode*>(a)->keys[index] -
           static_cast<HxCSsNode*>(b)->keys[index];
  }
  int index;
};

class DependencySortingTest : public HX_TestFixture {
 protected:
  ~DependencySortingTest() override {
    HxCDepSortNode::setComp(nullptr);
    HxCTraceFallThrough::setVerbose(false);
  }

  // Drives the sorter and its plain form alike.
  void add(Node node) {
    m_Sorting.add(node);
    m_Plain.nodes.push_back(node);
  }
  void depend(Node first, Node second) {
    m_Sorting.addDependency(first, second);
    m_Plain.dependencies.emplace_back(first, second);
  }
  void init(int criteria) {
    leda::array<HxCDepSortComp*> list = {&m_Comps[0], &m_Comps[1], &m_Comps[2]};
    list.resize(criteria);
    m_Sorting.setSortingCriteriaAndInit(list);
    m_Plain.criteria.assign(list.begin(), list.end());
    m_Plain.nodes.clear();
    m_Plain.dependencies.clear();
  }
  void reinit() {
    m_Sorting.reinit();
    m_Plain = {.criteria = m_Plain.criteria, .result = m_Plain.result};
  }
  // Sorts with sorter and plain form, expects the same result, the same current
  // criterion, nodes and messages.
  void expectSortsAlike() {
    const auto sortWith = [](auto& sorting) {
      HxCDepSortNode::setComp(nullptr);
      const bool success = sorting.sort();
      return std::pair(success, HxCDepSortNode::getComp());
    };
    clearMessages();
    EXPECT_EQ(sortWith(m_Sorting), sortWith(m_Plain));
    // By the order of add(); -1 for nodes left from before reinit().
    const auto numbersOf = [&](const leda::array<Node>& nodes) {
      std::vector<std::ptrdiff_t> numbers;
      for (Node node : nodes) {
        const auto found = std::ranges::find(m_Plain.nodes, node);
        const bool isKnown = found != m_Plain.nodes.end();
        numbers.push_back(isKnown ? found - m_Plain.nodes.begin() : -1);
      }
      return numbers;
    };
    const leda::array<Node> sorted = m_Sorting.getNodes();
    EXPECT_EQ(numbersOf(sorted), numbersOf(m_Plain.result));
    EXPECT_TRUE(std::ranges::equal(sorted, m_Plain.result));
    EXPECT_THAT(messages(), testing::ElementsAreArray(m_Plain.messages));
  }
  KeyComp m_Comps[3] = {KeyComp(0), KeyComp(1), KeyComp(2)};
  HxCDependencySorting m_Sorting;
  PlainSorting m_Plain;
};

TEST_F(DependencySortingTest, DependentNodesComeInOrderBeforeIsolatedOnes) {
  const struct {
    const char* why;
    const char* added;         // names in the order of add(); '-' is null
    const char* dependencies;  // pairs of names, the first goes first
    const char* report;        // of a cycle
    const char* order;         // '-' for places that were left alone
  } rows[] = {
      {"nothing", "", "", "", ""},
      {"isolated nodes arrive reversed", "ABC", "", "", "CBA"},
      {"free together: by name", "BAC", "BCAC", "", "ABC"},
      {"dependent before isolated", "ZAB", "AB", "", "ABZ"},
      {"breadth first: D waits for C", "ABCD", "ABBDAC", "", "ABCD"},
      {"the order of dependencies is none", "ACB", "ACAB", "", "ABC"},
      {"a dependency twice", "BA", "ABAB", "", "AB"},
      {"added twice: it concerns the later copy", "ABA", "AB", "", "ABA"},
      {"null fails silently", "BC-A", "BA", "", "---C"},
      {"a cycle", "IBDv", "vDBB", "data types : B, D, v", "vD-I"},
      {"of a variable first", "vBID", "vDBB", "variables : v, B, D", "vD-I"}};
  std::map<char, HxCSsNode> nodes;
  for (char c : std::string("ABCDIZv"))
    nodes.emplace(c, HxCSsNode(std::string(1, c), c == 'v'));
  const auto find = [&](char c) { return c == '-' ? nullptr : &nodes.at(c); };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.why);
    reinit();
    expectSortsAlike();  // no nodes; forgets the result before
    for (const char* c = row.added; *c; ++c) add(find(*c));
    for (const char* c = row.dependencies; *c; c += 2)
      depend(find(c[0]), find(c[1]));
    expectSortsAlike();
    std::string order;
    for (Node node : m_Sorting.getNodes())
      order += node == nullptr ? "-" : node->getName().cstring();
    EXPECT_EQ(order, row.order);
    EXPECT_THAT(testing::PrintToString(messages()),
                testing::HasSubstr(row.report));
  }
  HxCTraceFallThrough::setVerbose(true);
  EXPECT_FALSE(m_Sorting.sort());
  EXPECT_EQ(messages().back(),
            "1272/4 trace fall through - early abortion. [Internal: Module: "
            "'DependencySorting/implDependencySorting/HxCDepSortingGraph', "
            "Line: 501 Reason: cause unknown!]");
}

TEST_F(DependencySortingTest, IsolatedNodesSortAsInThePlainForm) {
  const std::pair<const char*, int (*)(int place, int count)> shapes[] = {
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
      {"shuffled", [](int i, int n) { return i * 379 % n; }}};
  const std::pair<int, int> sizes[] = {{1, 2},   {1, 100}, {1, 700}, {2, 100},
                                       {2, 700}, {3, 100}, {3, 700}, {40, 700}};
  init(3);
  for (const auto& [why, key] : shapes) {
    for (const auto& [width, count] : sizes) {
      std::deque<HxCSsNode> nodes;
      reinit();
      for (int i = 0; i < count; ++i)
        add(&nodes.emplace_back("n", false, key(i, count) / width, i * 7 % 3,
                                i % 2));
      SCOPED_TRACE(testing::Message()
                   << why << ", " << count << " keys / " << width);
      expectSortsAlike();
      if (HasFailure()) return;
    }
  }
}

// Any sequence of calls, with null, strangers, cycles and repeated sorts. Most
// graphs are small, so most small patterns of edges and equals occur.
TEST_F(DependencySortingTest, RandomUseSortsAsInThePlainForm) {
  for (unsigned seed = 1; seed <= 3000; ++seed) {
    SCOPED_TRACE("seed " + std::to_string(seed));
    std::mt19937 random(seed);
    const auto below = [&](int n) {
      return static_cast<int>(random() % static_cast<unsigned>(n));
    };
    const bool mayFail = seed % 4 == 0;
    const int count = 1 + below(seed % 10 == 0 ? 120 : 7);
    const int variants = 1 + below(seed % 3 == 0 ? 20 : 4);
    std::vector<HxCSsNode> nodes;  // the last one is a stranger
    nodes.reserve(121);            // the most, so that they stay in place
    for (int i = 0; i <= count; ++i)
      nodes.emplace_back(std::to_string(below(variants)), below(2) == 0,
                         below(variants), below(3), below(2));
    const auto pick = [&]() -> Node {
      const int i = below(count + (mayFail ? 1 : 0));
      return i == count ? nullptr : nodes.data() + i;
    };
    reinit();
    init(below(4));
    for (int round = 0; round < 4; ++round) {
      for (int i = 0; i < count; ++i) add(nodes.data() + i);
      if (mayFail) add(below(2) == 0 ? nullptr : pick());
      for (int i = below(2 * count); i > 0; --i) {
        Node first = pick(), second = pick();
        if (seed % 20 == 0 && below(2) == 0) first = &nodes[0];  // frees many
        if (mayFail && below(50) == 0) second = &nodes.back();
        if (mayFail || first < second) depend(first, second);
      }
      if (below(6) != 0) {
        SCOPED_TRACE(testing::Message() << "round " << round);
        expectSortsAlike();
        if (HasFailure()) return;
      }
      if (below(2) == 0) reinit();
      if (below(4) == 0) init(below(4));
    }
  }
}

// Rising but for one node: every step of the plain form splits off one node, so
// the plain form would take hours and burst the stack of this thread.
TEST_F(DependencySortingTest, LargeBadInputNeedsLittleStackAndTime) {
  constexpr int kCount = 200'000;
  init(2);
  pthread_attr_t attributes;
  pthread_attr_init(&attributes);
  ASSERT_EQ(pthread_attr_setstacksize(&attributes, 256 * 1024), 0);
  const auto run = [](void* sorting) -> void* {
    return static_cast<HxCDependencySorting*>(sorting)->sort() ? sorting
                                                               : nullptr;
  };
  for (int width : {1, 2}) {
    std::deque<HxCSsNode> nodes;
    m_Sorting.reinit();
    for (int i = kCount; i > 0; --i)
      m_Sorting.add(&nodes.emplace_back("", false, i % kCount / width, -i));
    pthread_t thread;
    void* result = nullptr;
    ASSERT_EQ(pthread_create(&thread, &attributes, run, &m_Sorting), 0);
    ASSERT_EQ(pthread_join(thread, &result), 0);
    EXPECT_EQ(result, &m_Sorting);
    const leda::array<Node> sorted = m_Sorting.getNodes();
    ASSERT_EQ(sorted.size(), kCount);
    for (int i = 0; i < kCount; ++i)
      ASSERT_EQ(static_cast<HxCSsNode*>(sorted[i])->keys[0], i / width);
  }
  pthread_attr_destroy(&attributes);
}

TEST_F(DependencySortingTest, ContainersSortByTheCurrentCriterion) {
  HxCSsNode a("a", false, 1, 9), b("b", false, 2, 3);
  a.setOrdNr(7);
  EXPECT_EQ(HxCSsNode(a).getOrdNr() + b.getOrdNr(), 6);
  for (KeyComp& comp : m_Comps) {
    HxCDepSortNode::setComp(&comp);
    EXPECT_EQ(leda::compare<Node>(&a, &b),
              a.keys[comp.index] - b.keys[comp.index]);
    leda::dictionary<Node, int> ordered;
    for (Node node : {&b, &a}) ordered.insert(node, 0);
    EXPECT_EQ(ordered.key(ordered.first_item()), comp.index == 0 ? &a : &b);
  }
}

// Answers from a list, then always the last answer; accepts known nodes only.
struct ListedAnswers : HxCDepSortComp {
  int compare(Node a, Node b) override {
    for (Node node : {a, b})
      if (std::ranges::find(known, node) == known.end()) {
        ADD_FAILURE() << "compares what is no node";
        return 0;
      }
    return answers[std::min(calls++, answers.size() - 1)];
  }
  std::vector<Node> known = {};
  std::vector<int> answers = {};
  std::size_t calls = 0;
};

TEST_F(DependencySortingTest, AnyAnswersOfACriterionGiveSomeOrder) {
  std::deque<HxCSsNode> nodes;
  ListedAnswers comp;
  const auto sortsSomehow = [&](unsigned count) {
    while (nodes.size() < count) nodes.emplace_back("n");
    comp.known.clear();
    comp.calls = 0;
    m_Sorting.setSortingCriteriaAndInit({&comp, &comp});
    m_Sorting.reinit();
    for (unsigned i = 0; i < count; ++i) {
      comp.known.push_back(&nodes[i]);
      m_Sorting.add(&nodes[i]);
    }
    const bool sorted = m_Sorting.sort();
    return sorted &&
           std::ranges::is_permutation(m_Sorting.getNodes(), comp.known);
  };
  // Each list of seven answers of three nodes.
  for (int list = 0; list < 3 * 3 * 3 * 3 * 3 * 3 * 3; ++list) {
    comp.answers.clear();
    for (int rest = list, i = 0; i < 7; ++i, rest /= 3)
      comp.answers.push_back(rest % 3 - 1);
    ASSERT_TRUE(sortsSomehow(3)) << list;
  }
  std::mt19937 random(HX_Seed());
  for (unsigned count = 4; count < 100; ++count) {
    comp.answers.resize(1 + random() % (20 * count));
    for (int& answer : comp.answers)
      answer = static_cast<int>(random() % 3) - 1;
    ASSERT_TRUE(sortsSomehow(count)) << count;
  }
}

// Nodes of all kinds: a star with equal names, groups of equals, few criteria.
// No assertions of GoogleTest, because assertions ask for memory.
bool sortsMixedNodes() {
  constexpr int kCount = 60;
  static std::vector<HxCSsNode> s_Nodes = [] {
    std::vector<HxCSsNode> nodes;
    for (int i = 0; i < kCount; ++i)
      nodes.emplace_back(std::to_string(i % 5), false, i * 7 % 3, i % 2);
    return nodes;
  }();
  static std::vector<Node> s_Expected;
  KeyComp first(0), second(1);
  HxCDependencySorting sorter;
  const bool hasCriteria = HX_WithinMemory([&] {
    sorter.setSortingCriteriaAndInit({&first, &second});
  });
  if (!hasCriteria) return false;
  for (HxCSsNode& node : s_Nodes) sorter.add(&node);
  for (int i = 1; i < kCount / 2; ++i)
    sorter.addDependency(&s_Nodes[0], &s_Nodes[static_cast<std::size_t>(i)]);
  // A sort without memory may be repeated.
  const bool done = sorter.sort();
  if (!done && !sorter.sort()) return false;
  return HX_WithinMemory(false, [&] {
    const leda::array<Node> result = sorter.getNodes();
    if (result.size() == 0) return false;
    if (s_Expected.empty() && done)
      s_Expected.assign(result.begin(), result.end());
    if (!s_Expected.empty() && !std::ranges::equal(result, s_Expected))
      std::abort();
    return done;
  });
}

TEST_F(DependencySortingTest, BlocksComeFromTheController) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  HX_CountingController memory;
  HxCDependencySorting sorting;
  std::vector<HxCSsNode> nodes(40, HxCSsNode("n"));
  for (const bool isFirst : {true, false}) {
    sorting.reinit();
    for (HxCSsNode& node : nodes) sorting.add(&node);
    for (int i = 1; i < 20; ++i)
      sorting.addDependency(&nodes[0], &nodes[static_cast<std::size_t>(i)]);
    const int before = HX_HeapBlocks();
    EXPECT_TRUE(sorting.sort());
    EXPECT_EQ(HX_HeapBlocks() - before, isFirst ? 1 : 0) << "the result array";
  }
  EXPECT_GT(memory.liveBlocks(), 0);
}

TEST_F(DependencySortingTest, WithoutMemoryTheSortFails) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  ASSERT_TRUE(sortsMixedNodes());
  HX_WithoutEachBlock("sort", sortsMixedNodes);
  HX_WithoutEachHeapBlock("sort", sortsMixedNodes);
  HX_WithoutEachBlock("report a cycle", [] {
    HxCSsNode first("a"), second("b");
    HxCDependencySorting sorter;
    sorter.reinit();
    for (HxCDepSortNode* node : {&first, &second}) sorter.add(node);
    sorter.addDependency(&second, &first);
    const bool sorted = sorter.sort() && sorter.getNodes()[0] == &second;
    sorter.addDependency(&first, &second);
    sorter.sort();
    return sorted;
  });
}

}  // namespace
