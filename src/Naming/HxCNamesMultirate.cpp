// Names of tasks and operating-system objects, and times in names.
//
// A time is written as a count of units. The unit is fixed by the macro, or the
// largest generic unit up to the value with a whole count.
//
// Example: 90 s, rounded to whole microseconds.
//   us 90000000   ms 90000   s 90   m 1.5   (h and d lie above the value)
//   The count of m is not whole: "90s".
//
// Invariants:
// 1. A macro that the names do not hold causes neither work nor a message.
// 2. A message goes out only behind the replacement.

#include <cmath>
#include <cstdio>

#include "Control/ERR_Messages.h"
#include "Control/HX_Memory.h"
#include "Math/FPS_FloatingPointSupport.h"
#include "Naming/HX_MacroRows.h"
#include "Naming/HxCNames.h"
#include "implContainers/HX_Number.h"

namespace {

struct GenericUnit {
  const char* text;
  double seconds;
};

constexpr GenericUnit kGenericUnits[] = {{"us", 1e-6},  {"ms", 1e-3},
                                         {"s", 1.0},    {"m", 60.0},
                                         {"h", 3600.0}, {"d", 86400.0}};

constexpr double kMicrosecondsPerSecond = 1000000.0;

const HxCSrcRef* messageRef(const HxCCIdentifier& id) {
  return id.getSourceRef() != nullptr ? id.getSourceRef() : id.getDdSourceRef();
}

// Nearest whole number of a quotient that is not negative.
KyCXString rounded(double quotient) {
  return KyCXString(FPS_SatCastToInt(quotient + 0.5), false, true);
}

KyCXString timeText(const KyCXString& period, const KyCXString& offset,
                    double offsetSeconds) {
  return offsetSeconds == 0.0 ? period : period + "_" + offset;
}

// A macro as substAllDollarZByValue() takes macros: without the '$'.
const char* withoutDollar(const HX_Macro& macro) { return macro.text + 1; }

const char* timeName(hx_macros::TimeKindIndex kind, std::size_t unit) {
  return withoutDollar(hx_macros::timeMacro(kind, unit));
}

bool contains(const HxCCIdentifier& id, const KyCXString& text) {
  return id.getCookedName(HxCCIdentifier::eActualName).contains(text) ||
         id.getCookedName(HxCCIdentifier::eFormalName).contains(text);
}

void reportImprecise(const HxCCIdentifier& id, const char* kind,
                     double seconds) {
  char value[400];  // the largest double has 309 digits before the point
  char digits[sizeof value];
  HX_WriteFixed(digits, sizeof digits, seconds, 10);
  std::snprintf(value, sizeof value, "%12s", digits);
  ERR_Msg1207(messageRef(id), kind, value);
}

}  // namespace

// Replaces by a text. A text without a macro carries neither references nor
// flags: without the macro in the names nothing is left to do.
bool HxCNames::replaceMacro(HxCCIdentifier& id, const char* macro,
                            const KyCXString& text) {
  if (!contains(id, "$" + KyCXString(macro))) return false;
  return replaceByTemplate(id, macro, text);
}

// Replaces by the identifier that has \p text as its template.
bool HxCNames::replaceByTemplate(HxCCIdentifier& id, const char* macro,
                                 const KyCXString& text) {
  HxCCIdentifier value;
  value.setTemplate(text);
  return replaceAll(id, macro, value, eMacroKindExact);
}

// Replaces by \p value as a C identifier.
void HxCNames::replaceByIdentifier(HxCCIdentifier& id, const HX_Macro& macro,
                                   const HxCCIdentifier& value) {
  HxCCIdentifier name;
  name.copy(value);
  name.makeCNames();
  replaceAll(id, withoutDollar(macro), name, eMacroKindExact);
}

void HxCNames::replaceMultirateTimeName(HxCCIdentifier& id, double period,
                                        double offset, bool cyclic) {
  HX_WithinMemory([&] {
    if (!cyclic) return replaceAcyclicMultirateTimeName(id);
    offset = std::fabs(offset);
    replaceBaseTimeMacros(id, period, offset);
    replaceGenericTimeMacro(id, period, offset);
  });
}

void HxCNames::replaceBaseTimeMacros(HxCCIdentifier& id, double period,
                                     double offset) {
  using namespace hx_macros;
  for (std::size_t unit = 0; unit < kTimeUnitCount; ++unit) {
    const TimeUnit& base = kTimeUnits[unit];
    const double periods = period / base.seconds;
    const double offsets = offset / base.seconds;
    const KyCXString periodText = rounded(periods);
    const KyCXString offsetText = rounded(offsets);
    const bool periodExact = FPS_IsIntegerValue(periods);
    const bool offsetExact = FPS_IsIntegerValue(offsets);
    const auto replace = [&](TimeKindIndex kind, const KyCXString& text,
                             bool exact) {
      if (replaceMacro(id, timeName(kind, unit), text) && !exact)
        ERR_Msg1206(messageRef(id), kTimeKinds[kind].text, base.text, period,
                    offset);
    };
    replace(eTime, timeText(periodText, offsetText, offset),
            periodExact && offsetExact);
    replace(ePeriod, periodText, periodExact);
    replace(eOffset, offsetText, offsetExact);
  }
}

void HxCNames::replaceGenericTimeMacro(HxCCIdentifier& id, double period,
                                       double offset) {
  KyCXString periodText;
  KyCXString offsetText;
  const auto generic = [](hx_macros::TimeKindIndex kind) {
    return timeName(kind, hx_macros::kNoTimeUnit);
  };
  const bool periodImprecise = findGenericTimeMacro(period, periodText);
  const bool offsetImprecise = findGenericTimeMacro(offset, offsetText);
  const bool time = replaceMacro(id, generic(hx_macros::eTime),
                                 timeText(periodText, offsetText, offset));
  const bool periodUsed =
      replaceMacro(id, generic(hx_macros::ePeriod), periodText);
  const bool offsetUsed =
      replaceMacro(id, generic(hx_macros::eOffset), offsetText);
  if (periodImprecise && (time || periodUsed))
    reportImprecise(id, "period", period);
  if (offsetImprecise && (time || offsetUsed))
    reportImprecise(id, "offset", offset);
}

// Text of \p value (seconds) in the largest exact unit up to \p value.
// Returns true if no unit is exact.
bool HxCNames::findGenericTimeMacro(double value, KyCXString& text) {
  const double rounding =
      std::floor(value * kMicrosecondsPerSecond + 0.5) * 0.000001;
  bool imprecise = !FPS_ValuesAreApproxEqual(rounding, value);
  const GenericUnit* chosen = nullptr;
  for (const GenericUnit& unit : kGenericUnits) {
    if (&unit != kGenericUnits && rounding < unit.seconds) break;
    if (FPS_IsIntegerValue(rounding / unit.seconds)) chosen = &unit;
  }
  if (chosen == nullptr) {
    chosen = kGenericUnits;
    imprecise = true;
  }
  text = rounded(rounding / chosen->seconds) + chosen->text;
  return imprecise;
}

void HxCNames::replaceAcyclicMultirateTimeName(HxCCIdentifier& id) {
  using namespace hx_macros;
  const KyCXString acyclic("ACYCLIC");
  bool replaced = false;
  for (const TimeKindIndex kind : {eTime, ePeriod, eOffset})
    for (std::size_t unit = 0; unit <= kNoTimeUnit; ++unit)
      replaced |= replaceMacro(id, timeName(kind, unit), acyclic);
  if (replaced) ERR_Msg1205(messageRef(id), id.getRawName(kActive).cstring());
}

void HxCNames::replaceMultirateTaskISRName(HxCCIdentifier& id,
                                           const HxCCIdentifier& task,
                                           const HxCCIdentifier& isr,
                                           bool isTaskName) {
  HX_WithinMemory([&] {
    constexpr const HX_Macro& kTask = HX_MacroOf("$(Task)");
    HxCCIdentifier isrBefore;  // the argument may be the name changed here
    isrBefore.copy(isr);
    if (isTaskName) {
      if (replaceMacro(id, withoutDollar(kTask), kTask.placeholder))
        ERR_Msg1204(messageRef(id), id.getRawName(kActive).cstring());
    } else {
      const bool hasTask = !task.getCookedName(kActive).isEmpty();
      replaceByIdentifier(id, kTask, hasTask ? task : isr);
    }
    replaceByIdentifier(id, HX_MacroOf("$(ISR)"), isrBefore);
  });
}

void HxCNames::replaceMultirateObjName(HxCCIdentifier& id,
                                       const HxCCIdentifier& obj) {
  HX_WithinMemory([&] { replaceByIdentifier(id, HX_MacroOf("$(PObj)"), obj); });
}

void HxCNames::replaceMultirateEventName(HxCCIdentifier& id,
                                         const HxCCIdentifier& event) {
  HX_WithinMemory(
      [&] { replaceByIdentifier(id, HX_MacroOf("$(Event)"), event); });
}

void HxCNames::replaceMultirateISRName(HxCCIdentifier& id,
                                       const HxCCIdentifier& isr) {
  HX_WithinMemory([&] { replaceByIdentifier(id, HX_MacroOf("$(ISR)"), isr); });
}

void HxCNames::replaceMultirateMsgName(HxCCIdentifier& id,
                                       const HxCCIdentifier& msg) {
  HX_WithinMemory([&] { replaceByIdentifier(id, HX_MacroOf("$(Msg)"), msg); });
}

void HxCNames::replaceMultirateCtrName(HxCCIdentifier& id,
                                       const HxCCIdentifier& ctr) {
  HX_WithinMemory([&] { replaceByIdentifier(id, HX_MacroOf("$(Ctr)"), ctr); });
}

void HxCNames::replaceMultirateMsgVarName(HxCCIdentifier& id,
                                          const KyCXString& text) {
  HX_WithinMemory([&] {
    leda::array<KyCXString> parts;
    text.split('#', parts);
    KyCXString value("1");
    if (parts.size() > 1) {
      value = parts[parts.high()];
      value = value.head(value.length() - 1);
    }
    // The flags of macros in the value count even without a replacement.
    replaceByTemplate(id, withoutDollar(HX_MacroOf("$(MsgVar)")), value);
  });
}

void HxCNames::determineOsekBaseTime(double value, tagHxEOsekTimeBase& base,
                                     KyCXString& unit) {
  if (value < 1000) {
    base = eOsekTimeBaseUs;
    unit = "us";
  } else if (value < 1000000) {
    base = eOsekTimeBaseMs;
    unit = "ms";
  }
}
