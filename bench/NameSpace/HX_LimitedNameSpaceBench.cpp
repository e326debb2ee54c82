// Deriving variants of taken names. One item of work is one name entered.

#include "NameSpace/HX_LimitedNameSpace.h"

#include <memory>
#include <unordered_map>

#include "HX_NameSpaceBench.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"

#ifdef HX_HAVE_LLVM
#include <llvm/IR/BasicBlock.h>
#include <llvm/IR/Function.h>
#include <llvm/IR/LLVMContext.h>
#include <llvm/IR/Module.h>
#endif

namespace {

void BM_LimitedNameSpace_OneName(benchmark::State& state) {
  const KyCXString wanted("gain");
  KyCXString name;
  for (auto _ : state) {
    auto names = std::make_unique<HX_LimitedNameSpace>();
    for (int i = 0; i < state.range(0); ++i) {
      name = wanted;
      names->addUnique(name);
    }
    state.PauseTiming();
    names.reset();
    state.ResumeTiming();
  }
  if (state.range(0) == 10000 && name != KyCXString("gain_otn"))
    state.SkipWithError("wrong result");
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

#ifdef HX_HAVE_LLVM
// The blocks of a function share one symbol table; naming them is timed.
void BM_ValueSymbolTable_OneName(benchmark::State& state) {
  llvm::LLVMContext context;
  for (auto _ : state) {
    state.PauseTiming();
    auto module = std::make_unique<llvm::Module>("m", context);
    auto* function = llvm::Function::Create(
        llvm::FunctionType::get(llvm::Type::getVoidTy(context), false),
        llvm::Function::ExternalLinkage, "f", *module);
    std::vector<llvm::BasicBlock*> blocks;
    for (int i = 0; i < state.range(0); ++i)
      blocks.push_back(llvm::BasicBlock::Create(context, "", function));
    state.ResumeTiming();
    for (llvm::BasicBlock* block : blocks) block->setName("gain");
    state.PauseTiming();
    module.reset();
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}
#else
HX_MISSING_PEER(BM_ValueSymbolTable_OneName, "llvm-14-dev")
#endif

// Names with one head of the length limit, different behind the head.
std::vector<std::string> longNames(std::int64_t count) {
  std::vector<std::string> names;
  for (std::int64_t i = 0; i < count; ++i)
    names.push_back("engine_speed_controller_state_gain_" + std::to_string(i));
  return names;
}

void BM_LimitedNameSpace_OneHead(benchmark::State& state) {
  HX_OptionsExt options;
  options.setLimitVariableNameLength(true);
  HxCGlobal::setOptions(&options);
  std::vector<KyCXString> wanted;
  for (const std::string& name : longNames(state.range(0)))
    wanted.emplace_back(name.c_str());
  KyCXString name;
  for (auto _ : state) {
    state.PauseTiming();
    auto names = std::make_unique<HX_LimitedNameSpace>();
    for (KyCXString& text : wanted) names->add(text);
    state.ResumeTiming();
    for (const KyCXString& text : wanted) {
      name = text;
      names->addUnique(name);
    }
    state.PauseTiming();
    names.reset();
    state.ResumeTiming();
  }
  if (state.range(0) == 8000 &&
      name != KyCXString("engine_speed_controller_sta_ruk"))
    state.SkipWithError("wrong result");
  HxCGlobal::setOptions(nullptr);
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

// A set with a counter per cut name.
void BM_SetWithCounters_OneHead(benchmark::State& state) {
  const std::vector<std::string> wanted = longNames(state.range(0));
  for (auto _ : state) {
    state.PauseTiming();
    auto names = std::make_unique<std::unordered_map<std::string, int>>();
    for (const std::string& text : wanted) names->emplace(text, 0);
    state.ResumeTiming();
    for (const std::string& text : wanted) {
      std::string name = text.substr(0, 27);
      int& counter = (*names)[name];
      do {
        name.resize(27);
        name += '_';
        name += std::to_string(counter++);
      } while (!names->try_emplace(name, 0).second);
    }
    state.PauseTiming();
    names.reset();
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK(BM_LimitedNameSpace_OneName)->Arg(10000)->Arg(100000);
BENCHMARK(BM_ValueSymbolTable_OneName)->Arg(10000)->Arg(100000);
BENCHMARK(BM_LimitedNameSpace_OneHead)->Arg(1000)->Arg(8000);
BENCHMARK(BM_SetWithCounters_OneHead)->Arg(1000)->Arg(8000);

}  // namespace
