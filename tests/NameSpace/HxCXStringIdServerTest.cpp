#include "NameSpace/HxCXStringIdServer.h"

#include <algorithm>
#include <climits>
#include <map>
#include <random>

#include "NameSpace/HX_FailingController.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::StartsWith;

class StringIdServerTest : public HX_TestFixture {
 protected:
  ~StringIdServerTest() override { m_Ids.shutdown(); }

  HxCXStringIdServer m_Ids;
};

// Plain form: a list per sum, searched from the front.
struct PlainServer {
  int getId(const KyCXString& s) {
    if (s.isEmpty()) return 0;
    const std::string text = s.cstring();
    int sum = 0;
    for (char c : text) sum += static_cast<signed char>(c);
    auto& bucket = buckets[sum & 1023];
    const auto found = std::find(bucket.begin(), bucket.end(), text);
    const auto arrival = static_cast<int>(found - bucket.begin());
    if (found == bucket.end()) bucket.push_back(text);
    return (sum & 1023) + 1024 * arrival;
  }

  std::map<int, std::vector<std::string>> buckets;
};

TEST_F(StringIdServerTest, AgreesWithPlainBuckets) {
  for (unsigned seed = 1; seed <= 6; ++seed) {
    SCOPED_TRACE(seed);
    std::mt19937 random(seed);
    PlainServer plain;
    HX_FailingController memory;
    m_Ids.boot();
    memory.setPercent(seed == 6 ? 90 : 0, seed);
    std::map<int, const char*> texts;
    // Few characters make many equal sums; 0 ends the 8-bit form early, and
    // both wide units share an 8-bit form.
    const unsigned short units[] = {'a', 'b', 'c', 0xFF, 0x80, 0, 0x100, 0x101};
    for (int i = 0; i < 4000; ++i) {
      std::vector<unsigned short> text(random() % (seed % 2 == 0 ? 6 : 50));
      for (auto& unit : text) unit = units[random() % (2 + seed)];
      const KyCXString s(text.data(), static_cast<int>(text.size()));
      int id = 0;
      if (!m_Ids.findOrAdd(s, id)) continue;  // no memory
      ASSERT_EQ(id, plain.getId(s)) << s.cstring();
      if (!s.isEmpty()) texts.emplace(id, m_Ids.getString(id));
    }
    for (const auto& [bucket, arrivals] : plain.buckets)
      for (std::size_t i = 0; i < arrivals.size(); ++i)
        EXPECT_EQ(texts.at(bucket + 1024 * static_cast<int>(i)), arrivals[i]);
    for (int id = -3000; id < 200000; ++id)
      ASSERT_EQ(m_Ids.getString(id), texts.count(id) ? texts[id] : nullptr);
    EXPECT_EQ(m_Ids.getString(INT_MIN), nullptr);
    EXPECT_EQ(m_Ids.getString(INT_MAX), nullptr);
    m_Ids.shutdown();
  }
}

TEST_F(StringIdServerTest, BootsAndShutsDownRepeatedlyAndReturnsAllMemory) {
  HX_CountingController memory;
  EXPECT_TRUE(m_Ids.shutdown());
  EXPECT_TRUE(m_Ids.boot());
  m_Ids.getId("ab");
  EXPECT_EQ(m_Ids.getId("ba"), 1219);
  int id = 5;
  EXPECT_TRUE(m_Ids.findOrAdd("", id));
  EXPECT_EQ(id, 0);
  EXPECT_TRUE(m_Ids.boot());
  HxCXStringIdServer copy(m_Ids);
  EXPECT_EQ(copy.getId("ba"), 1219);
  EXPECT_TRUE(m_Ids.shutdown());
  EXPECT_TRUE(m_Ids.shutdown());
  EXPECT_EQ(memory.liveBlocks(), 0);
  EXPECT_TRUE(m_Ids.boot());
  EXPECT_EQ(m_Ids.getId("ba"), 195);
  EXPECT_TRUE(m_Ids.shutdown());
}

TEST_F(StringIdServerTest, DownServerAssertsAndGivesNothing) {
  int id = 5;
  EXPECT_EQ(m_Ids.getId("a"), 0);
  EXPECT_EQ(m_Ids.getString(97), nullptr);
  EXPECT_FALSE(m_Ids.findOrAdd("a", id));
  m_Ids.boot();
  EXPECT_EQ(m_Ids.getId(nullptr), 0);
  EXPECT_EQ(id, 5);
  EXPECT_EQ(messages().size(), 4U);
  EXPECT_THAT(messages(), testing::Each(StartsWith("7/3 ")));
}

}  // namespace
