// The containers, the numbers of the string class, the message handler and the
// clocks.

#include <climits>
#include <limits>
#include <new>
#include <set>

#include "Control/ERR_Catalogue.h"
#include "platform/containers/dictionary.h"
#include "platform/containers/list.h"
#include "platform/containers/stack.h"
#include "platform/datadictionary/HX_DdTree.h"
#include "platform/matlab/HX_MxArrayConverter.h"
#include "platform/matlab/HX_MxContent.h"
#include "platform/matlab/HX_SimulinkTree.h"
#include "platform/messages/ERR_MessageHandler.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/os/HX_OsClock.h"
#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;

// Read before the static objects of the clock exist, in some link orders.
const std::int64_t kTimeAtLoad = HX_ProcessClock();

using PlatformTest = HX_TestFixture;

TEST_F(PlatformTest, ListItemsSurviveTheirNeighbours) {
  leda::list<int> list;
  EXPECT_FALSE(list.first());
  EXPECT_FALSE(list.last());
  const auto two = list.append(2);
  const auto one = list.insert_before(1, two);
  const auto three = list.append(3);
  list.del_item(two);
  EXPECT_TRUE(list.succ(one) == three);
  EXPECT_TRUE(list.last() == three);
  EXPECT_FALSE(list.succ(three));
  leda::list<int> copy(list);
  EXPECT_EQ(copy.pop(), 1);
  EXPECT_THAT(std::vector<int>(copy.begin(), copy.end()), ElementsAre(3));
  EXPECT_EQ(list[one] + list[three], 4);
}

TEST_F(PlatformTest, DictionaryKeepsEachKeyOnceInOrder) {
  leda::dictionary<KyCXString, int> words;
  EXPECT_FALSE(words.first_item());
  for (const char* word : {"b", "B", "", "ab", "b"})
    words.insert(word, words.size());
  std::string seen;
  for (auto it = words.first_item(); it; it = words.next_item(it))
    seen += std::string(words.key(it).cstring()) + ";";
  EXPECT_EQ(seen, ";B;ab;b;");
  EXPECT_EQ(words.inf(words.lookup("b")), 4);  // the later information
  words.del("none");
  words.del("ab");
  EXPECT_FALSE(words.lookup("ab"));
  EXPECT_EQ(words.size(), 3);
}

TEST_F(PlatformTest, StackAndArrayGiveBackWhatTheyHold) {
  leda::stack<int> stack;
  stack.push(1);
  stack.push(2);
  EXPECT_EQ(stack.top(), 2);
  EXPECT_EQ(stack.pop() * 10 + stack.pop(), 21);
  EXPECT_TRUE(stack.empty());
  leda::array<int> array{1, 2, 3};
  array.resize(2);
  array.resize(4);
  EXPECT_THAT(std::vector<int>(array.begin(), array.end()),
              ElementsAre(1, 2, 0, 0));
  EXPECT_EQ(leda::array<int>().high(), -1);
}

// Name, path and parent of blocks, asked by handle and by path.
TEST_F(PlatformTest, ModelTreeAnswersForEachBlock) {
  const unsigned short kWide[] = {'g', 0x3B1, 0x416};
  const KyCXString wide(kWide, 3);
  HX_SimulinkTree tree;
  const double model = tree.addBlock("m");
  const double sub = tree.addBlock("a/b", model);
  const double gain = tree.addBlock(wide, sub);
  const double unnamed = tree.addBlock("");
  const double orphan = tree.addBlock("m", unnamed);
  const double nan = std::numeric_limits<double>::quiet_NaN();
  const double other = tree.addBlock("n", nan);  // a model
  const struct {
    double handle;
    KyCXString name, path, parent;
  } rows[] = {{model, "m", "m", ""},
              {sub, "a/b", "m/a//b", "m"},
              {gain, wide, KyCXString("m/a//b/") + wide, "m/a//b"},
              {unnamed, "", "", ""},
              {orphan, "m", "/m", ""},
              {other, "n", "n", ""}};
  const HX_MxArrayConverter converter;
  const auto ask = [&](mxArray* object, const char* parameter) {
    mxArray* value = tree.getParameter(object, parameter);
    KyCXString text("none");
    double number = 0.0;
    converter.mxArrayToString(value, text);
    if (converter.mxArrayToDouble(value, number))
      text = KyCXString(static_cast<int>(number), false, true);
    mxDestroyArray(value);
    return text;
  };
  const int liveArrays = HX_LiveMxArrays();
  for (const auto& row : rows) {
    const KyCXString handle(static_cast<int>(row.handle), false, true);
    // As the library asks, by a path in 8 bits, and with all units.
    for (mxArray* object :
         {mxCreateScalarDouble(row.handle), mxCreateString(row.path.cstring()),
          mxCreateText(row.path)}) {
      EXPECT_EQ(ask(object, "Name"), row.name);
      EXPECT_EQ(ask(object, "Parent"), row.parent);
      EXPECT_EQ(ask(object, "Handle"), handle);
      mxDestroyArray(object);
    }
    EXPECT_EQ(tree.getPath(row.handle), row.path);
  }
  for (const double handle : {0.0, 1.5, 7.0, -1.0, nan}) {
    mxArray* object = mxCreateScalarDouble(handle);
    EXPECT_EQ(ask(object, "Name"), "none") << handle;
    mxDestroyArray(object);
  }
  EXPECT_EQ(HX_LiveMxArrays(), liveArrays);
}

TEST_F(PlatformTest, DictionaryTreeListsChildrenOfOneKindInOrder) {
  HX_DdTree& tree = HX_DdTree::instance();
  tree.clear();
  const unsigned long pool = tree.add("/Pool");
  std::vector<unsigned long> components;
  for (const char* name : {"b", "a", "c"}) {
    const std::string path = "/Pool/" + std::string(name);
    components.push_back(tree.add(path, HX_DdTree::kSoftwareComponent));
    tree.add(path + "/below", HX_DdTree::kSoftwareComponent);
  }
  const unsigned long late = tree.add("/Pool/late");
  EXPECT_THAT(tree.children(pool, 0), ElementsAre(late));
  tree.add("/Pool/late", HX_DdTree::kSoftwareComponent);
  components.push_back(late);
  EXPECT_EQ(tree.children(pool, HX_DdTree::kSoftwareComponent), components);
  EXPECT_EQ(tree.find("//DD0/Pool/a"), components[1]);
  tree.clear();
}

TEST_F(PlatformTest, NumbersAreWrittenInTheWidthAsked) {
  EXPECT_EQ(KyCXString(-5, false, true), "-5");
  EXPECT_EQ(KyCXString(INT_MIN, false, false), "-2147483648");
  EXPECT_EQ(KyCXString(42, false, false), "0000000042");
  EXPECT_EQ(KyCXString(-1, true, true), "FFFFFFFF");
  EXPECT_EQ(KyCXString(0xABC, true, false), "00000ABC");
  EXPECT_EQ(KyCXString(0UL, false, true), "0");
  EXPECT_EQ(KyCXString(~0UL, true, false).length(), int{2 * sizeof(long)});
  EXPECT_EQ(KyCXString(1UL, false, false).length(),
            sizeof(long) == 4 ? 10 : 20);
}

// Changes of a text with need of memory: of 100 units below 256, and of a text
// with a larger unit.
using Change = void (*)(KyCXString& text, const KyCXString& wide);
constexpr Change kChanges[] = {
    [](auto& text, auto& wide) { text = wide; },
    [](auto& text, auto&) { text = std::string(200, 'z').c_str(); },
    [](auto& text, auto& wide) { text += wide; },
    [](auto& text, auto&) { text += std::string(200, 'z').c_str(); },
    [](auto& text, auto& wide) { text.appendSub(wide, 1, 98); },
    [](auto& text, auto&) { text.appendUnit(0x3B1); },
    [](auto& text, auto& wide) { text.replace("b", wide); },
    [](auto& text, auto&) { text.replaceWhiteSpace('_', true); },
    [](auto& text, auto&) { text.makeCIdentifier(false); },
    [](auto& text, auto&) { text.trim(true, true); },
    [](auto& text, auto&) { text.toUpper(); },
    [](auto& text, auto&) {
      text.shortenString(90, 2, '_', KyCXString::ePositionMiddle);
    },
    [](auto& text, auto&) {
      leda::array<KyCXString> parts;
      text.split('b', parts);
      text = parts[0];
    }};

TEST_F(PlatformTest, TextsStayAsTheyWereWithoutMemory) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  const KyCXString narrow(("1 " + std::string(96, 'a') + "b ").c_str());
  const unsigned short kUnit = 0x416;
  const KyCXString wide = narrow.head(50) + KyCXString(&kUnit, 1) + narrow;
  int changed = 0;
  int number = 0;
  for (const Change change : kChanges) {
    ++number;
    for (const KyCXString* start : {&narrow, &wide}) {
      KyCXString wanted(*start);
      change(wanted, wide);
      for (int missing = 0;; ++missing) {
        KyCXString text(*start);
        bool isDone = false;
        try {
          const HX_FailingHeap heap(missing, false);
          change(text, wide);
          isDone = true;
        } catch (const std::bad_alloc&) {
        }
        ASSERT_EQ(text, isDone ? wanted : *start)
            << "change " << number << " block " << missing;
        if (isDone) break;
        ++changed;
      }
    }
  }
  EXPECT_GT(changed, 20);
}

TEST_F(PlatformTest, MessagesWithoutMemoryReachStatusAndSink) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  const std::string argument(100, 'x');
  int heard = 0;
  int id = 0;
  handler.setSink([&](const HX_Message& message) {
    ++heard;
    id = message.id;
  });
  const auto recorded = handler.messages().size();
  for (int missing = 0; missing < 2; ++missing) {
    const HX_FailingHeap heap(missing, true);
    ERR_EmitErrorMessage(2, nullptr, 1292, argument.c_str());
  }
  ERR_EmitErrorMessage(0, nullptr, 1292, argument.c_str());
  EXPECT_EQ(heard, 3);
  EXPECT_EQ(id, ERR_FindRow(1292)->id);
  EXPECT_EQ(handler.messages().size(), recorded + 1);
  EXPECT_EQ(ERR_get_errstatus(), 2);
}

TEST_F(PlatformTest, TheSinkHearsOnceAndUnknownRowsHaveNoText) {
  std::vector<std::string> heard;
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  handler.setSink([&](const HX_Message& m) { heard.push_back(m.text); });
  ERR_EmitErrorMessage(5, nullptr, 1292, "x");
  ERR_EmitErrorMessage(4, nullptr, 4711);
  EXPECT_THAT(heard, ElementsAre("INTERNAL: x", ""));
  EXPECT_THAT(messages(), ElementsAre("1292/5 INTERNAL: x", "4711/4 "));
  EXPECT_EQ(ERR_get_errstatus(), 1);
  clearMessages();
  EXPECT_EQ(ERR_get_errstatus(), 0);
  EXPECT_STREQ(HX_MessageHandler::severityName(7), "internal fatal error");
}

TEST_F(PlatformTest, CatalogueIsAscendingWithOneIdPerRow) {
  int number = -1;
  std::set<int> ids;
  for (const ERR_CatalogueRow& row : kErrCatalogue) {
    EXPECT_GT(row.number, number);
    number = row.number;
    EXPECT_EQ(ERR_FindRow(number), &row);
    EXPECT_TRUE(ids.insert(row.id).second) << row.id;
  }
  EXPECT_EQ(ERR_FindRow(number + 1), nullptr);
}

TEST_F(PlatformTest, ClocksFollowTheInstalledSource) {
  std::int64_t first = 0, second = 0;
  const std::int64_t start = HX_ProcessClock();
  EXPECT_EQ(QueryPerformanceCounter(&first), 1);
  EXPECT_EQ(QueryPerformanceCounter(&second), 1);
  EXPECT_LE(first, second);
  EXPECT_LE(0, kTimeAtLoad);
  EXPECT_LE(kTimeAtLoad, start);
  EXPECT_LE(start, HX_ProcessClock());
  HX_ManualClock clock;
  clock.frequency = 0;
  EXPECT_EQ(QueryPerformanceFrequency(&first), 0);
  EXPECT_EQ(QueryPerformanceCounter(&first), 0);
  EXPECT_LE(first, second) << "touched without a counter";
}

}  // namespace
