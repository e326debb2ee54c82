// Checks the platform layer of this build, a host's own or ours, against the
// contracts. A compiler that stops here names the call that is missing.

#include <cstdio>
#include <type_traits>

#include "Contract/HX_ContainerContract.h"
#include "Contract/HX_ModelContract.h"
#include "Contract/HX_ServiceContract.h"
#include "Contract/HX_StringContract.h"
#include "SourceRef/HxCSrcRef.h"
#include "platform/containers/array.h"
#include "platform/containers/dictionary.h"
#include "platform/containers/integer.h"
#include "platform/containers/list.h"
#include "platform/containers/stack.h"
#include "platform/datadictionary/HX_DataDictionary.h"
#include "platform/datadictionary/kyddapi.h"
#include "platform/datatypes/DT_DataTypes.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/datatypes/HX_NumericalType.h"
#include "platform/datatypes/HX_TypeSupport.h"
#include "platform/dump/HX_Dump.h"
#include "platform/dump/HX_Dumpable.h"
#include "platform/matlab/HX_MexInterface.h"
#include "platform/matlab/HX_MxArrayConverter.h"
#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/memory/HxCMemController.h"
#include "platform/messages/ERR_MessageHandler.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_BlockDataBase.h"
#include "platform/model/HX_InputBlockId.h"
#include "platform/model/HX_IvData.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HX_SlBlockHandlesDB.h"
#include "platform/model/HX_StateflowBlock.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/HxCSymbol.h"
#include "platform/model/SC_Chart.h"
#include "platform/model/SC_Model.h"
#include "platform/model/SC_State.h"
#include "platform/os/HX_OsClock.h"
#include "platform/os/HX_OsFile.h"
#include "platform/os/HX_OsThread.h"
#include "platform/os/HX_OsVersion.h"
#include "platform/strings/KyCXString.h"

namespace {

using Texts = leda::array<KyCXString>;
using Numbers = leda::dictionary<int, int, leda::ab_tree>;
using Words = leda::dictionary<KyCXString, int, leda::ab_tree>;

static_assert(HX_StringContract<KyCXString, Texts>);
static_assert(HX_ArrayContract<Texts, KyCXString>);
static_assert(HX_StackContract<leda::stack<double>, double>);
static_assert(HX_ListContract<leda::list<std::FILE*>, std::FILE*>);
static_assert(HX_DictionaryContract<Numbers, int, int>);
static_assert(HX_DictionaryContract<Words, KyCXString, int>);
static_assert(HX_IntegerContract<leda::integer>);

static_assert(HX_BlockContract<HX_Block, KyCXString, HxCSrcRef>);
static_assert(HX_IvBlockContract<HX_BdBlock, KyCXString, HxCSrcRef>);
static_assert(HX_ChartObjectContract<SC_Model, KyCXString, HxCSrcRef>);
static_assert(HX_ChartContract<SC_ModelAccess, SC_Model, KyCXString>);
static_assert(HX_SymbolContract<HxCSymbol, KyCXString, HX_DataType>);
static_assert(HX_GlobalContract<HxCGlobal, KyCXString, HX_Block>);
static_assert(HX_InputBlockContract<HX_InputBlockId>);
static_assert(HX_DataTypeContract<HX_DataType, KyCXString, HxCSrcRef>);
static_assert(HX_NumericalTypeContract<HX_NumericalType>);
static_assert(
    HX_DataTypeServerContract<HX_DataTypeServer, HX_DataType, HxCSrcRef>);

static_assert(HX_MemoryContract<HxCMemController>);
static_assert(HX_DumpContract<HX_Dump, HX_Dumpable, KyCXString>);
static_assert(HX_DataDictionaryContract<HX_DataDictionary, KyCXString>);
static_assert(HX_DictionaryClientContract<kyddapi::KYCDDObject,
                                          kyddapi::KYCDDSoftwareComponent,
                                          kyddapi::KYSDDHandleNode>);
static_assert(HX_SimulinkContract<HX_SimulinkInterface, HX_MxArrayConverter,
                                  mxArray, KyCXString>);

// The result of a function, if the function takes such arguments.
template <class Result, class... Arguments>
constexpr bool gives(Result (*)(Arguments...)) {
  return true;
}
template <class Result>
constexpr bool gives(Result (*)(int, const HxCSrcRef*, int, ...)) {
  return true;
}

// Free functions: result, arguments, function.
static_assert(gives<int, const KyCXString&, const KyCXString&>(&leda::compare));
static_assert(gives<void>(&ERR_EmitErrorMessage));
static_assert(gives<int>(&ERR_get_errstatus));
static_assert(gives<bool>(&ShowInternalInfo));
static_assert(gives<int, const char*, int, const char*>(&HX_DebugReport));
static_assert(gives<void>(&HX_DebugBreak));
static_assert(std::is_same_v<decltype(pHXMemory), HxCMemController*>);
static_assert(gives<const KyCXString&>(&GLB_GetModelName));
static_assert(gives<const KyCXString&>(&GLB_GetSubsystemName));
static_assert(gives<const KyCXString&>(&GLB_GetFullSystemPath));
static_assert(gives<void, void*>(&DDAPIHeapFree));
static_assert(gives<mxArray*, const char*>(&mxCreateString));
static_assert(gives<mxArray*, double>(&mxCreateScalarDouble));
static_assert(gives<void, mxArray*>(&mxDestroyArray));
static_assert(gives<mxArray*, double>(&MXCreateInitializedScalarMxArray));
static_assert(gives<void, mxArray*>(&MXDestroyArray));
static_assert(gives<mxArray*, mxArray*, int, const char*>(&MXGetField));
static_assert(gives<bool, const mxArray*, KyCXString&>(&MXCopyMXArrayToString));
static_assert(
    gives<int, int, mxArray**, int, mxArray**, const char*>(&MEXCallMATLAB));
static_assert(requires { mexPrintf("%s", ""); });
static_assert(std::is_same_v<decltype(DT_GetMax(DT_GetINT64())), double>);
static_assert(std::is_same_v<decltype(DT_GetMin(0)), double>);
static_assert(std::is_same_v<decltype(DT_GetMaxAsInt64(0)), long long>);
static_assert(std::is_same_v<decltype(DT_GetMinAsInt64(0)), long long>);
static_assert(
    gives<int, long long>(&HX_TypeSupport::findHighestBitSetInInt64Value));

// The calls of the system may have any calling convention.
static_assert(requires(std::int64_t * number, const char* text,
                       std::size_t size) {
  { HX_ProcessClock() } -> std::same_as<std::int64_t>;
  { QueryPerformanceFrequency(number) } -> std::convertible_to<int>;
  { QueryPerformanceCounter(number) } -> std::convertible_to<int>;
  { HX_RewriteFile(text, text, size) } -> std::same_as<bool>;
  { HX_AppendToFile(text, text, size) } -> std::same_as<bool>;
});
static_assert(requires(HX_ThreadHandle thread, int priority) {
  { GetCurrentThread() } -> std::convertible_to<HX_ThreadHandle>;
  { GetThreadPriority(thread) } -> std::convertible_to<int>;
  { SetThreadPriority(thread, priority) } -> std::convertible_to<int>;
});
static_assert(requires(HX_ModuleHandle module, const char* name, char* path,
                       std::uint32_t size, std::uint32_t* handle, void* block,
                       void** value, unsigned int* length) {
  { GetModuleHandleA(name) } -> std::convertible_to<HX_ModuleHandle>;
  GetModuleFileNameA(module, path, size);
  {
    GetFileVersionInfoSizeA(name, handle)
    } -> std::convertible_to<std::uint32_t>;
  { GetFileVersionInfoA(name, size, size, block) } -> std::convertible_to<int>;
  { VerQueryValueA(block, name, value, length) } -> std::convertible_to<int>;
});

}  // namespace
