// An order declared after the container, and the order of references
// where the container is included first: both must be used.
#include "platform/containers/dictionary.h"

// An instance before any overload is in sight.
struct HX_LateKey;
using HX_LateDictionary = leda::dictionary<const HX_LateKey*, int>;

#include <gtest/gtest.h>

#include "SourceRef/HxCSrcRef.h"

struct HX_LateKey {
  int rank;
};

namespace leda {

// Downwards by rank.
int compare(const HX_LateKey* const& a, const HX_LateKey* const& b) {
  return b->rank - a->rank;
}

// Not meant for the keys below, although an int converts to a double.
int compare(const double&, const double&) { return 0; }

}  // namespace leda

namespace {

TEST(IncludeOrderTest, AnOrderDeclaredLateIsUsed) {
  const HX_LateKey keys[] = {{1}, {3}, {2}};
  HX_LateDictionary ranks;
  for (const HX_LateKey& key : keys) ranks.insert(&key, key.rank);
  std::string seen;
  for (auto it = ranks.first_item(); it; it = ranks.next_item(it))
    seen += std::to_string(ranks.inf(it));
  EXPECT_EQ(seen, "321");

  leda::dictionary<int, int> numbers;
  for (const int number : {2, 1, 2}) numbers.insert(number, number);
  EXPECT_EQ(numbers.size(), 2);
}

}  // namespace
