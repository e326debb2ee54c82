// Expansion and substitution of name templates, keyword check and suffixes.
// Item of work: one name, unless a comment says otherwise.

#include "Naming/HxCNames.h"

#include <benchmark/benchmark.h>

#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

#include "platform/model/HX_Block.h"
#include "platform/model/HxCGlobal.h"

#ifdef HX_HAVE_FMT
#include <fmt/args.h>
#include <fmt/format.h>
#endif
#ifdef HX_HAVE_BOOST
#include <boost/algorithm/string/replace.hpp>
#endif

namespace {

constexpr auto kFormal = HxCCIdentifier::eFormalName;
constexpr auto kActual = HxCCIdentifier::eActualName;

// "Sa3_Gain_Ctrl_plant_ab" from four macros with values in the model.
struct Model {
  Model() {
    GLB_SetModelName("plant");
    GLB_SetSubsystemName("Ctrl");
    block.setSubsystem("a", 3);
  }
  HX_Block block{"Gain"};
};

void expandRepeatedly(benchmark::State& state, const KyCXString& form) {
  Model model;
  HxCNames names;
  HxCCIdentifier id(form);
  id.setSourceRef(model.block.getSrcRef());
  const KyCXString actual(id.getCookedName(kActual));
  for (auto _ : state) {
    id.setCookLevel(HxCCIdentifier::eCookLevelRaw);
    id.setCookedName(form, kFormal);
    id.setCookedName(actual, kActual);
    names.createNameFromForm(id, nullptr, 0, 0, false);
    benchmark::DoNotOptimize(id.getCookedName(kActual).cstring());
  }
}

void BM_HxCNames_ExpandFourMacros(benchmark::State& state) {
  expandRepeatedly(state, "$S_$B_$N_$M_ab");
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_HxCNames_ExpandFourMacros);

// Item of work: one macro.
void BM_HxCNames_ExpandManyMacros(benchmark::State& state) {
  KyCXString form;
  for (int i = 0; i < state.range(0); ++i) form += i % 2 == 0 ? "$B" : "_$M";
  expandRepeatedly(state, form);
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(BM_HxCNames_ExpandManyMacros)->Arg(64)->Arg(1024);

void BM_Fmt_ExpandFourNamed(benchmark::State& state) {
#ifdef HX_HAVE_FMT
  const std::string form = "S{id}{number}_{block}_{subsystem}_{model}_ab";
  const std::string id = "a";
  const std::string block = "Gain";
  const std::string subsystem = "Ctrl";
  const std::string model = "plant";
  for (auto _ : state) {
    std::string name =
        fmt::format(fmt::runtime(form), fmt::arg("id", id),
                    fmt::arg("number", 3), fmt::arg("block", block),
                    fmt::arg("subsystem", subsystem), fmt::arg("model", model));
    benchmark::DoNotOptimize(name.data());
  }
  state.SetItemsProcessed(state.iterations());
#else
  state.SkipWithError("peer not installed: libfmt-dev");
#endif
}
BENCHMARK(BM_Fmt_ExpandFourNamed);

// Macro late in the template, found or absent. The peer searches one text, the
// library both names of the identifier.
constexpr char kLateForm[] = "$S_a_rather_long_$B_$M_name_$x";

void BM_HxCNames_Substitute(benchmark::State& state) {
  HxCNames names;
  const HxCCIdentifier value("value");
  const KyCXString macro(state.range(0) != 0 ? "x" : "y");
  HxCCIdentifier id(kLateForm);
  const KyCXString formal(id.getCookedName(kFormal));
  const KyCXString actual(id.getCookedName(kActual));
  for (auto _ : state) {
    id.setCookedName(formal, kFormal);
    id.setCookedName(actual, kActual);
    benchmark::DoNotOptimize(names.substAllDollarZByValue(
        id, macro, value, HxCNames::eMacroKindExact));
  }
  state.SetItemsProcessed(state.iterations() * 2);  // texts
}
BENCHMARK(BM_HxCNames_Substitute)->Arg(0)->Arg(1);

void BM_Boost_Substitute(benchmark::State& state) {
#ifdef HX_HAVE_BOOST
  const std::string form = kLateForm;
  const std::string macro = state.range(0) != 0 ? "$x" : "$y";
  const std::string value = "value";
  for (auto _ : state) {
    std::string name = boost::replace_all_copy(form, macro, value);
    benchmark::DoNotOptimize(name.data());
  }
  state.SetItemsProcessed(state.iterations());
#else
  state.SkipWithError("peer not installed: libboost-dev");
#endif
}
BENCHMARK(BM_Boost_Substitute)->Arg(0)->Arg(1);

void BM_HxCNames_AppendSuffix(benchmark::State& state) {
  HxCNames names;
  const KyCXString base("Sa3_Speed_Gain_of_the_car");
  int index = 0;
  for (auto _ : state) {
    KyCXString name(base);
    names.appendSuffix(name, index++ & 1023);
    benchmark::DoNotOptimize(name.cstring());
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_HxCNames_AppendSuffix);

// Item of work: the name of a task with three time macros.
void BM_HxCNames_MultirateTime(benchmark::State& state) {
  HxCNames names;
  const HxCCIdentifier form("T_$(Time1ms)_$(Period)_$(Offset10us)");
  for (auto _ : state) {
    HxCCIdentifier id(form);
    names.replaceMultirateTimeName(id, 0.01, 0.005, true);
    benchmark::DoNotOptimize(id.getCookedName(kFormal).cstring());
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_HxCNames_MultirateTime);

// --- Reserved words ---

constexpr std::string_view kC90[] = {
    "auto",     "break",  "case",    "char",   "const",    "continue",
    "default",  "do",     "double",  "else",   "enum",     "extern",
    "float",    "for",    "goto",    "if",     "int",      "long",
    "register", "return", "short",   "signed", "sizeof",   "static",
    "struct",   "switch", "typedef", "union",  "unsigned", "void",
    "volatile", "while"};

// Questions: the names of a model, a few reserved words among them.
std::vector<std::string> questions() {
  std::vector<std::string> result;
  for (int i = 0; i < 1000; ++i) {
    result.push_back("Sa" + std::to_string(i) + "_Speed_Gain_of_the_car");
    result.push_back("x" + std::to_string(i));
    if (i % 50 == 0) result.emplace_back(kC90[i / 50]);
  }
  return result;
}

// Words reserved by the headers of a target beside the keywords.
std::vector<std::string> moreWords(std::size_t count) {
  std::vector<std::string> result;
  for (std::size_t i = 0; i < count; ++i)
    result.push_back("_Target_word_" + std::to_string(i));
  return result;
}

void BM_HxCNames_IsReserved(benchmark::State& state) {
  HxCNames::boot();
  HxCNames names;
  const auto words = moreWords(static_cast<std::size_t>(state.range(0)) - 32);
  for (const std::string& word : words)
    names.addToKeywordDict(word.c_str(), HxCNames::eDictCKeyword);
  std::vector<KyCXString> asked;
  for (const std::string& text : questions())
    if (text.find_first_of("0123456789") != std::string::npos)
      asked.emplace_back(text.c_str());
  std::size_t next = 0;
  for (auto _ : state) {
    benchmark::DoNotOptimize(names.isStringValidCVariableName(asked[next]));
    if (++next == asked.size()) next = 0;
  }
  state.SetItemsProcessed(state.iterations());
  HxCNames::shutdown();
}
BENCHMARK(BM_HxCNames_IsReserved)->Arg(32)->Arg(200);

bool isIdentifier(const std::string& text) {
  for (char c : text)
    if (c != '_' && (c < '0' || c > '9') && ((c | 32) < 'a' || (c | 32) > 'z'))
      return false;
  return !text.empty() && (text[0] < '0' || text[0] > '9');
}

// Peer with the same questions and the same answer: no word, an identifier.
void BM_UnorderedSet_IsReserved(benchmark::State& state) {
  std::unordered_set<std::string> set;
  for (std::string_view word : kC90) set.emplace(word);
  for (auto& word : moreWords(static_cast<std::size_t>(state.range(0)) - 32))
    set.insert(word);
  std::vector<std::string> asked;
  for (const std::string& text : questions())
    if (text.find_first_of("0123456789") != std::string::npos)
      asked.push_back(text);
  std::size_t next = 0;
  for (auto _ : state) {
    benchmark::DoNotOptimize(set.count(asked[next]) == 0 &&
                             isIdentifier(asked[next]));
    if (++next == asked.size()) next = 0;
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_UnorderedSet_IsReserved)->Arg(32)->Arg(200);

// Perfect hash of the 32 keywords alone, found at compile time.
struct PerfectHash {
  static constexpr unsigned kSlots = 256;
  static constexpr unsigned slot(std::string_view text, unsigned seed) {
    unsigned hash = seed;
    for (char c : text) hash = hash * 31 + static_cast<unsigned char>(c);
    return (hash >> 7) % kSlots;
  }
  constexpr PerfectHash() {
    for (seed = 1;; ++seed) {
      for (auto& word : words) word = {};
      std::size_t placed = 0;
      for (std::string_view word : kC90) {
        auto& place = words[slot(word, seed)];
        if (!place.empty()) break;
        place = word;
        ++placed;
      }
      if (placed == std::size(kC90)) return;
    }
  }
  unsigned seed = 0;
  std::string_view words[kSlots];
};

void BM_PerfectHash_IsReserved(benchmark::State& state) {
  static constexpr PerfectHash kHash;
  std::vector<std::string> asked;
  for (const std::string& text : questions())
    if (text.find_first_of("0123456789") != std::string::npos)
      asked.push_back(text);
  std::size_t next = 0;
  for (auto _ : state) {
    const std::string& text = asked[next];
    benchmark::DoNotOptimize(kHash.words[PerfectHash::slot(text, kHash.seed)] !=
                                 text &&
                             isIdentifier(text));
    if (++next == asked.size()) next = 0;
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_PerfectHash_IsReserved);

}  // namespace
