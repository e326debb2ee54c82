// Runs every check over the corpus and over random changes of the corpus.
#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>
#include <set>
#include <vector>

#include "fuzz/HX_Fuzz.h"
#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_TestFixture.h"

namespace {

namespace fs = std::filesystem;
using Random = std::mt19937;
using Corpus = std::vector<std::string>;

struct CheckRow {
  const char* corpus;
  void (*check)(HX_Bytes&);
};

const CheckRow kChecks[] = {
#ifdef HX_FUZZ_HAS_HOST
    {"document", HX_CheckDocument},
#endif
    {"environment", HX_CheckEnvironment},
    {"messages", HX_CheckMessages},
    {"names", HX_CheckNames},
    {"parser", HX_CheckParser},
    {"sorter", HX_CheckSorter},
    {"string", HX_CheckString},
};

void expectHolds(const CheckRow& row, const std::string& input) {
  HX_MessageHandler::instance().setSink({});
  HX_Bytes bytes(input);
  try {
    row.check(bytes);
  } catch (const std::exception& error) {
    ADD_FAILURE() << error.what()
                  << "\ninput: " << testing::PrintToString(input);
  }
}

Corpus readCorpus(const char* name) {
  const fs::directory_iterator files(fs::path(HX_FUZZ_FOLDER) / "corpus" /
                                     name);
  const std::set<fs::path> sorted(files, fs::directory_iterator());
  Corpus corpus;
  for (const fs::path& path : sorted) {
    std::ifstream file(path, std::ios::binary);
    corpus.emplace_back(std::istreambuf_iterator<char>(file),
                        std::istreambuf_iterator<char>());
  }
  EXPECT_FALSE(corpus.empty());
  return corpus;
}

// Replaces, removes or inserts one to four bytes or ranges of the corpus.
std::string changed(const Corpus& corpus, Random& random) {
  std::string input = corpus[random() % corpus.size()];
  for (auto changes = 1 + random() % 4; changes > 0; --changes) {
    const std::string& other = corpus[random() % corpus.size()];
    std::string part =
        other.substr(random() % (other.size() + 1), random() % 20);
    if (random() % 2 == 0) part = static_cast<char>(random());
    input.replace(random() % (input.size() + 1),
                  random() % 2 == 0 ? part.size() : random() % 3, part);
  }
  return input;
}

TEST(FuzzTest, ChecksHoldForTheCorpusAndForRandomChangesOfIt) {
  const unsigned seed = HX_Seed();
  SCOPED_TRACE(testing::Message() << "seed " << seed);
  for (const CheckRow& row : kChecks) {
    SCOPED_TRACE(row.corpus);
    const Corpus corpus = readCorpus(row.corpus);
    for (const std::string& input : corpus) expectHolds(row, input);
    Random random(seed);
    for (int i = 0; i < 150 && !testing::Test::HasFailure(); ++i)
      expectHolds(row, changed(corpus, random));
  }
}

}  // namespace
