// Rows of the macro table as constants; private to the naming engine.
//
// The engine names a row by its text at compile time. A text without a row does
// not compile:
//
//   constexpr const HX_Macro& kBlockName = HX_MacroOf("$B");
//   result += kBlockName.placeholder;

#ifndef NAMING_HX_MACROROWS_H
#define NAMING_HX_MACROROWS_H

#include <array>
#include <cstddef>
#include <iterator>
#include <string_view>

#include "Naming/HX_MacroTable.h"
#include "Naming/HxCNames.h"

namespace hx_macros {

constexpr auto kCaller = HX_Macro::eStageCaller;
constexpr auto kMultirate = HX_Macro::eStageMultirate;
constexpr auto kTemplate = HX_Macro::eStageTemplate;
constexpr auto kSymbol = HX_Macro::eStageSymbol;
constexpr auto kNone = HX_Macro::eOriginNone;
constexpr auto kModel = HX_Macro::eOriginModel;
constexpr auto kSource = HX_Macro::eOriginSource;
constexpr auto kDdObject = HX_Macro::eOriginDdObject;
constexpr auto kType = HX_Macro::eOriginType;
constexpr auto kTask = HX_Macro::eOriginTask;
constexpr auto kOfSymbol = HX_Macro::eOriginSymbol;

// Columns: text, bit, stage, origin, message, placeholder, meaning,
// example.
// Each example belongs to the model of the tests: block "Speed Gain" in
// subsystem a3, chart object "go#" with number 7 in a chart of subsystem c.
inline constexpr HX_Macro kLetters[] = {
    {"$L", HxCNames::eMacroLabel, kTemplate, kSource, 0, "",
     "signal label, else block name", "speed"},
    {"$B", HxCNames::eMacroBlockName, kTemplate, kSource, 0, "_B", "block name",
     "Speed_Gain"},
    {"$S", HxCNames::eMacroSystemNumber, kTemplate, kSource, 0, "_S",
     "S with subsystem id and number", "Sa3"},
    {"$I", HxCNames::eMacroSystemId, kTemplate, kSource, 0, "", "subsystem id",
     "a"},
    {"$M", HxCNames::eMacroModelName, kTemplate, kModel, 0, "", "model name",
     "plant v2"},
    {"$N", HxCNames::eMacroSubsystemName, kTemplate, kModel, 0, "",
     "name of the subsystem under generation", "Ctrl"},
    {"$H", HxCNames::eMacroStateHierarchy, kTemplate, kSource, 0, "_H",
     "states around the chart object", "Top_Run"},
    {"$O", HxCNames::eMacroSFObjectName, kTemplate, kSource, 0, "_O",
     "name of the chart object", "go_"},
    {"$C", HxCNames::eMacroSFObjectId, kTemplate, kSource, 0, "_C",
     "C with subsystem id and number of the chart object", "Cc7"},
    {"$D", HxCNames::eMacroDdObjectName, kTemplate, kDdObject, 0, "_D",
     "name of the data dictionary object", "Kp"},
    {"$T", HxCNames::eMacroTypeName, kTemplate, kType, 0, "_T",
     "short name of the type", "i16"},
    {"$X", HxCNames::eMacroXName, kTemplate, kNone, 0, "_X",
     "text given with the name", "ext"},
    {"$R", HxCNames::eMacroChangeable, kTemplate, kNone, 0, "",
     "nothing; the name may change", ""},
    {"$$", 0, kTemplate, kNone, 0, "$", "one dollar sign", "$"},
    {"$E", 0, kCaller, kNone, 1202, "$E", "text given by the caller", "x"},
    {"$P", 0, kCaller, kNone, 1202, "$P", "text given by the caller", "x"},
    {"$x", 0, kSymbol, kOfSymbol, 1203, "$x", "text of the symbol", "ext"},
    {"$f", 0, kSymbol, kOfSymbol, 1202, "$f", "name of the symbol, a function",
     "step"},
    {"$F", 0, kSymbol, kOfSymbol, 1202, "$F",
     "name of the symbol, a function, in upper case", "STEP"},
    {"$v", 0, kSymbol, kOfSymbol, 1202, "$v", "name of the symbol, no function",
     "speed"},
    {"$V", 0, kSymbol, kOfSymbol, 1202, "$V",
     "name of the symbol, no function, in upper case", "SPEED"},
    {"$t", 0, kSymbol, kOfSymbol, 1203, "$t",
     "short name of the type of the symbol", "i16"}};

inline constexpr HX_Macro kExtended[] = {
    {"$(Task)", 0, kMultirate, kTask, 1202, "__Task_",
     "name of the task, else of the interrupt service routine", "fast_task"},
    {"$(ISR)", 0, kMultirate, kTask, 1202, "__ISR_",
     "name of the interrupt service routine", "irq_1"},
    {"$(Msg)", 0, kMultirate, kNone, 1202, "__Msg_", "name of the message",
     "msg"},
    {"$(Ctr)", 0, kMultirate, kNone, 1202, "__Ctr_", "name of the counter",
     "ctr"},
    {"$(Event)", 0, kMultirate, kNone, 1202, "__Event_", "name of the event",
     "evt"},
    {"$(MsgVar)", 0, kMultirate, kNone, 1202, "__MsgVar_",
     "number or text of the message variable", "7"},
    {"$(PObj)", 0, kMultirate, kNone, 1202, "__PObj_",
     "name of the operating-system object", "obj"},
    {"$(Section)", 0, kCaller, kNone, 1202, "__Section_", "code section", "x"},
    {"$(Module)", 0, kCaller, kNone, 1202, "__Module_", "module", "x"},
    {"$(FunctionName)", 0, kCaller, kNone, 1202, "__FunctionName_",
     "name of the function", "x"},
    {"$(DataVariantName)", 0, kCaller, kNone, 1202, "__DataVariantName_",
     "name of the data variant", "x"},
    {"$(PageNumber)", 0, kCaller, kNone, 1202, "__PageNumber_",
     "number of the page", "x"},
    {"$(VariantItemName)", 0, kCaller, kNone, 1202, "__VariantItemName_",
     "name of the variant item", "x"},
    {"$(Type)", HxCNames::eMacroLongTypeName, kTemplate, kType, 0, "__Type_",
     "name of the type", "Int16"},
    {"$(BaseType)", HxCNames::eMacroLongTypeName, kTemplate, kType, 0,
     "__BaseType_", "name of the base type", "Int16"},
    {"$(Component)", 0, kTemplate, kDdObject, 0, "",
     "software component of the variable", "Engine"}};

// --- Time macros: units x {Time, Period, Offset}, and each kind without unit.

struct TimeUnit {
  const char* text;
  double seconds;
};

inline constexpr TimeUnit kTimeUnits[] = {
    {"1us", 1e-6},  {"10us", 1e-5}, {"100us", 1e-4}, {"1ms", 1e-3},
    {"10ms", 0.01}, {"100ms", 0.1}, {"1s", 1.0},     {"1m", 60.0},
    {"1h", 3600.0}, {"1d", 86400.0}};
constexpr std::size_t kTimeUnitCount = std::size(kTimeUnits);
/// Index of the macros without a unit, behind the units.
constexpr std::size_t kNoTimeUnit = kTimeUnitCount;

struct TimeKind {
  const char* text;
  const char* meaning;
  const char* example;         // of 10 ms and an offset of 5 ms
  const char* exampleInUnits;  // of two units and an offset of one unit
};

enum TimeKindIndex : std::size_t { eTime, ePeriod, eOffset };
inline constexpr TimeKind kTimeKinds[] = {
    {"Time", "period and offset", "10ms_5ms", "2_1"},
    {"Period", "period", "10ms", "2"},
    {"Offset", "offset", "5ms", "1"}};

constexpr std::size_t kTimeCount = std::size(kTimeKinds) * (kTimeUnitCount + 1);

/// Texts of one time macro.
struct TimeTexts {
  char text[16];
  char placeholder[16];
  char meaning[48];
};

template <std::size_t N>
constexpr void join(char (&target)[N],
                    std::initializer_list<std::string_view> parts) {
  std::size_t length = 0;
  for (const std::string_view part : parts)
    for (const char letter : part) target[length++] = letter;
}

inline constexpr auto kTimeTexts = [] {
  std::array<TimeTexts, kTimeCount> all{};
  for (std::size_t i = 0; i < kTimeCount; ++i) {
    const TimeKind& kind = kTimeKinds[i / (kTimeUnitCount + 1)];
    const std::size_t unit = i % (kTimeUnitCount + 1);
    const char* name = unit == kNoTimeUnit ? "" : kTimeUnits[unit].text;
    join(all[i].text, {"$(", kind.text, name, ")"});
    join(all[i].placeholder, {"__", kind.text, name, "_"});
    if (unit == kNoTimeUnit)
      join(all[i].meaning, {kind.meaning, " in the largest exact unit"});
    else
      join(all[i].meaning, {kind.meaning, " in units of ", name});
  }
  return all;
}();

inline constexpr auto kTable = [] {
  std::array<HX_Macro, std::size(kLetters) + std::size(kExtended) + kTimeCount>
      table{};
  std::size_t count = 0;
  for (const HX_Macro& row : kLetters) table[count++] = row;
  for (const HX_Macro& row : kExtended) table[count++] = row;
  for (std::size_t i = 0; i < kTimeCount; ++i) {
    const TimeTexts& texts = kTimeTexts[i];
    const TimeKind& kind = kTimeKinds[i / (kTimeUnitCount + 1)];
    const bool inUnits = i % (kTimeUnitCount + 1) != kNoTimeUnit;
    table[count++] = {
        texts.text,    0,
        kMultirate,    kTask,
        1202,          texts.placeholder,
        texts.meaning, inUnits ? kind.exampleInUnits : kind.example};
  }
  return table;
}();

/// Row of the time macro of \p kind in \p unit, an index of kTimeUnits or
/// kNoTimeUnit.
constexpr const HX_Macro& timeMacro(TimeKindIndex kind, std::size_t unit) {
  return kTable[std::size(kLetters) + std::size(kExtended) +
                kind * (kTimeUnitCount + 1) + unit];
}

}  // namespace hx_macros

/// Row of the macro \p text. REQUIRES: the table has such a row.
consteval const HX_Macro& HX_MacroOf(std::string_view text) {
  std::size_t row = 0;
  while (hx_macros::kTable[row].text != text) ++row;
  return hx_macros::kTable[row];
}

#endif  // NAMING_HX_MACROROWS_H
