// Every check over its corpus and over random changes of it.
#include <gtest/gtest.h>

#include <cctype>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <random>
#include <vector>

#include "fuzz/HX_Fuzz.h"
#include "platform/messages/HX_MessageHandler.h"

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

// In the order of their names.
std::map<fs::path, std::string> readCorpus(const char* name) {
  std::map<fs::path, std::string> corpus;
  for (const auto& entry :
       fs::directory_iterator(fs::path(HX_FUZZ_FOLDER) / "corpus" / name)) {
    std::ifstream file(entry.path(), std::ios::binary);
    corpus[entry.path()] = {std::istreambuf_iterator<char>(file), {}};
  }
  EXPECT_FALSE(corpus.empty());
  return corpus;
}

// One to four bytes or ranges replaced, taken out or put in from elsewhere.
std::string changed(const Corpus& corpus, Random& random) {
  std::string input = corpus[random() % corpus.size()];
  for (std::size_t changes = 1 + random() % 4; changes > 0; --changes) {
    const std::string& other = corpus[random() % corpus.size()];
    const std::size_t at = random() % (input.size() + 1);
    const std::size_t from = random() % (other.size() + 1);
    const std::size_t length = random() % 20;
    const std::string part = random() % 2 == 0
                                 ? std::string(1, static_cast<char>(random()))
                                 : other.substr(from, length);
    input.replace(at, random() % 2 == 0 ? part.size() : length % 3, part);
  }
  return input;
}

TEST(FuzzTest, ChecksHoldForTheCorpus) {
  for (const CheckRow& row : kChecks) {
    for (const auto& [file, input] : readCorpus(row.corpus)) {
      SCOPED_TRACE(file);
      expectHolds(row, input);
    }
  }
}

TEST(FuzzTest, ChecksHoldForRandomChanges) {
  const unsigned seed = std::random_device()();
  SCOPED_TRACE(testing::Message() << "seed " << seed);
  for (const CheckRow& row : kChecks) {
    SCOPED_TRACE(row.corpus);
    Random random(seed);
    Corpus corpus;
    for (auto& [file, input] : readCorpus(row.corpus)) corpus.push_back(input);
    for (int i = 0; i < 150 && !testing::Test::HasFailure(); ++i)
      expectHolds(row, changed(corpus, random));
  }
}

}  // namespace
