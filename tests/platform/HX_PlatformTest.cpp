// The containers, the message handler and the clocks.

#include "Control/ERR_Catalogue.h"
#include "platform/containers/dictionary.h"
#include "platform/containers/list.h"
#include "platform/containers/stack.h"
#include "platform/messages/ERR_MessageHandler.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/os/HX_OsClock.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;

// Read before the clock's own file is set up, if the linker puts that later.
const std::int64_t kTimeAtLoad = HX_ProcessClock();

class PlatformTest : public HX_TestFixture {};

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

TEST_F(PlatformTest, StatusIsTheHighestClassAndTheSinkHearsOnce) {
  int heard = 0;
  HX_MessageHandler::instance().setSink([&heard](const HX_Message& message) {
    EXPECT_EQ(message.text, "INTERNAL: x");
    ++heard;
  });
  const int expected[][2] = {{0, 0}, {4, 0}, {5, 1}, {0, 1}, {2, 2},
                             {1, 2}, {7, 3}, {6, 3}, {3, 3}};
  for (const auto& [severity, status] : expected) {
    ERR_EmitErrorMessage(severity, nullptr, 1292, "x");
    EXPECT_EQ(ERR_get_errstatus(), status) << severity;
  }
  EXPECT_EQ(heard, 9);
  clearMessages();
  EXPECT_EQ(ERR_get_errstatus(), 0);
  HX_MessageHandler::instance().setSink({});
  ERR_EmitErrorMessage(1, nullptr, 4711);
  EXPECT_THAT(messages(), ElementsAre("4711/1 "));
  EXPECT_STREQ(HX_MessageHandler::severityName(7), "internal fatal error");
}

TEST_F(PlatformTest, CatalogueIsAscendingWithOneIdPerRow) {
  int number = -1;
  std::vector<int> ids;
  for (const ERR_CatalogueRow& row : kErrCatalogue) {
    EXPECT_GT(row.number, number);
    number = row.number;
    EXPECT_EQ(ERR_FindRow(number), &row);
    EXPECT_THAT(ids, testing::Not(testing::Contains(row.id)));
    ids.push_back(row.id);
  }
  EXPECT_EQ(ERR_FindRow(number + 1), nullptr);
}

TEST_F(PlatformTest, ClocksFollowTheInstalledSource) {
  std::int64_t first = 0;
  std::int64_t second = 0;
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
