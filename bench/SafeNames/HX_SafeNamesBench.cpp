// Safe names against bare expansion, significance and locks of many names. Item
// of work: one name.

#include "SafeNames/HX_SafeNames.h"

#include <benchmark/benchmark.h>

#include <deque>
#include <memory>
#include <sstream>
#include <string>
#include <unordered_map>
#include <unordered_set>
#include <vector>

#include "Naming/HxCCIdentifier.h"
#include "SafeNames/HX_NameLock.h"
#include "SafeNames/HX_ReservedNames.h"
#include "SafeNames/HX_SignificantNames.h"
#include "platform/model/HX_Block.h"

namespace {

// Blocks "Speed Gain 0", "Speed Gain 1", ...; every tenth name is the name of
// the block before, so that every tenth safe name is a variant.
struct Blocks {
  explicit Blocks(std::int64_t count) {
    for (std::int64_t i = 0; i < count; ++i) {
      const std::int64_t number = i % 10 == 9 ? i - 1 : i;
      blocks.emplace_back(("Speed Gain " + std::to_string(number)).c_str());
      items.push_back("item" + std::to_string(i));
    }
  }
  std::deque<HX_Block> blocks;
  std::vector<std::string> items;
};

const Blocks& blocksOf(std::int64_t count) {
  static std::unordered_map<std::int64_t, std::unique_ptr<Blocks>> s_Blocks;
  auto& blocks = s_Blocks[count];
  if (!blocks) blocks = std::make_unique<Blocks>(count);
  return *blocks;
}

HxCCIdentifier identifierOf(const HX_Block& block) {
  static const KyCXString s_Form("S_$B");
  HxCCIdentifier id(s_Form);
  id.setSourceRef(const_cast<HX_Block&>(block).getSrcRef());
  return id;
}

void BM_HxCNames_Expand(benchmark::State& state) {
  const Blocks& model = blocksOf(state.range(0));
  HxCNames names;
  for (auto _ : state) {
    for (const HX_Block& block : model.blocks) {
      HxCCIdentifier id = identifierOf(block);
      names.createNameFromForm(id, nullptr, 0, 0, false);
      benchmark::DoNotOptimize(id);
    }
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_HxCNames_Expand)->Arg(100000)->Arg(1000000);

// Every name of the model; with \p lock the names of the lock.
void formAll(const Blocks& model, HX_NameLock* lock,
             const HX_ReservedNames* reserved) {
  HX_SafeNames safe;
  safe.setReserved(reserved);
  HX_SafeNames::Request request;
  request.scope = safe.addScope("file", nullptr);
  if (lock != nullptr) safe.useLock(lock);
  HX_SafeName name;
  std::size_t at = 0;
  for (const HX_Block& block : model.blocks) {
    HxCCIdentifier id = identifierOf(block);
    if (lock != nullptr) request.item = model.items[at++];
    safe.create(id, nullptr, request, name);
    benchmark::DoNotOptimize(name);
  }
}

void readReserved(HX_ReservedNames& reserved) {
  HX_TextFaults faults;
  std::string words;
  for (int i = 0; i < 2000; ++i) words += "word_" + std::to_string(i) + "\n";
  reserved.readText("words", words.data(), words.size(), faults);
  reserved.setPatterns(HX_ReservedNames::ePatternAll &
                       ~HX_ReservedNames::ePatternUnderscores);
}

// With a profile of 2000 words and nearly all patterns.
void BM_SafeNames_Create(benchmark::State& state) {
  const Blocks& model = blocksOf(state.range(0));
  HX_ReservedNames reserved;
  readReserved(reserved);
  for (auto _ : state) formAll(model, nullptr, &reserved);
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_SafeNames_Create)->Arg(100000)->Arg(1000000);

// The first run with a lock, which notes all names.
void BM_SafeNames_FirstRun(benchmark::State& state) {
  const Blocks& model = blocksOf(state.range(0));
  HX_ReservedNames reserved;
  readReserved(reserved);
  for (auto _ : state) {
    auto lock = std::make_unique<HX_NameLock>();
    formAll(model, lock.get(), &reserved);
    state.PauseTiming();
    lock.reset();
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_SafeNames_FirstRun)->Arg(100000)->Arg(1000000);

std::string lockOf(const Blocks& model) {
  HX_NameLock lock;
  formAll(model, &lock, nullptr);
  lock.endRun(0);
  std::string text;
  lock.write([&](const char* piece, std::size_t length) {
    text.append(piece, length);
  });
  return text;
}

void BM_SafeNames_Replay(benchmark::State& state) {
  const Blocks& model = blocksOf(state.range(0));
  const std::string text = lockOf(model);
  HX_ReservedNames reserved;
  readReserved(reserved);
  for (auto _ : state) {
    state.PauseTiming();
    auto lock = std::make_unique<HX_NameLock>();
    HX_TextFaults faults;
    if (!lock->read(text.data(), text.size(), faults))
      state.SkipWithError("lock refused");
    state.ResumeTiming();
    formAll(model, lock.get(), &reserved);
    state.PauseTiming();
    lock.reset();
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_SafeNames_Replay)->Arg(100000)->Arg(1000000);

void BM_NameLock_Read(benchmark::State& state) {
  const std::string text = lockOf(blocksOf(state.range(0)));
  for (auto _ : state) {
    HX_NameLock lock;
    HX_TextFaults faults;
    if (!lock.read(text.data(), text.size(), faults))
      state.SkipWithError("lock refused");
    benchmark::DoNotOptimize(lock.size());
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_NameLock_Read)->Arg(100000)->Arg(1000000);

// The same file into a map of items, without a check.
void BM_UnorderedMap_ReadLock(benchmark::State& state) {
  struct Entry {
    std::string name, wanted, scope, linkage, runs;
  };
  const std::string text = lockOf(blocksOf(state.range(0)));
  for (auto _ : state) {
    std::unordered_map<std::string, Entry> entries;
    std::istringstream lines(text);
    std::string line;
    std::getline(lines, line);
    while (std::getline(lines, line)) {
      std::istringstream fields(line);
      std::string item;
      Entry entry;
      std::getline(fields, item, '\t');
      for (std::string* field : {&entry.name, &entry.wanted, &entry.scope,
                                 &entry.linkage, &entry.runs})
        std::getline(fields, *field, '\t');
      entries.emplace(item, std::move(entry));
    }
    benchmark::DoNotOptimize(entries.size());
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_UnorderedMap_ReadLock)->Arg(100000)->Arg(1000000);

std::vector<KyCXString> namesOf(std::int64_t count) {
  std::vector<KyCXString> names;
  for (std::int64_t i = 0; i < count; ++i)
    names.emplace_back(
        ("Signal_" + std::to_string(i * 7919) + "_of_the_car").c_str());
  return names;
}

void BM_SignificantNames_Add(benchmark::State& state) {
  const std::vector<KyCXString> names = namesOf(state.range(0));
  for (auto _ : state) {
    HX_SignificantNames significant(31, true);
    HX_SignificantNames::Clash clash;
    for (const KyCXString& name : names) significant.add(name, nullptr, clash);
    benchmark::DoNotOptimize(significant.size());
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_SignificantNames_Add)->Arg(100000)->Arg(1000000);

void BM_UnorderedSet_AddHeads(benchmark::State& state) {
  const std::vector<KyCXString> names = namesOf(state.range(0));
  for (auto _ : state) {
    std::unordered_set<std::string> heads;
    for (const KyCXString& name : names) {
      std::string head(name.cstring());
      head.resize(std::min<std::size_t>(head.size(), 31));
      for (char& c : head)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c + 32);
      heads.insert(std::move(head));
    }
    benchmark::DoNotOptimize(heads.size());
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_UnorderedSet_AddHeads)->Arg(100000)->Arg(1000000);

}  // namespace
