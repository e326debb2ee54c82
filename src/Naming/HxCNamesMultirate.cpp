// Names of tasks and operating-system objects, and times in names.

#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <iterator>

#include "Control/ERR_Messages.h"
#include "Math/FPS_FloatingPointSupport.h"
#include "Naming/HxCNames.h"

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

// The nearest whole number of a quotient that is not negative.
KyCXString rounded(double quotient) {
  return KyCXString(FPS_SatCastToInt(quotient + 0.5), false, true);
}

KyCXString timeText(const KyCXString& period, const KyCXString& offset,
                    double offsetSeconds) {
  return offsetSeconds == 0.0 ? period : period + "_" + offset;
}

// One fixed time base: its unit and its three macros.
struct TimeBase {
  const char* unit;
  double seconds;
  const char* time;
  const char* period;
  const char* offset;
};

constexpr TimeBase kTimeBases[] = {
    {"1us", 1e-6, "(Time1us)", "(Period1us)", "(Offset1us)"},
    {"10us", 1e-5, "(Time10us)", "(Period10us)", "(Offset10us)"},
    {"100us", 1e-4, "(Time100us)", "(Period100us)", "(Offset100us)"},
    {"1ms", 1e-3, "(Time1ms)", "(Period1ms)", "(Offset1ms)"},
    {"10ms", 0.01, "(Time10ms)", "(Period10ms)", "(Offset10ms)"},
    {"100ms", 0.1, "(Time100ms)", "(Period100ms)", "(Offset100ms)"},
    {"1s", 1.0, "(Time1s)", "(Period1s)", "(Offset1s)"},
    {"1m", 60.0, "(Time1m)", "(Period1m)", "(Offset1m)"},
    {"1h", 3600.0, "(Time1h)", "(Period1h)", "(Offset1h)"},
    {"1d", 86400.0, "(Time1d)", "(Period1d)", "(Offset1d)"}};

constexpr char kTime[] = "(Time)";
constexpr char kPeriod[] = "(Period)";
constexpr char kOffset[] = "(Offset)";

bool contains(const HxCCIdentifier& id, const KyCXString& text) {
  return id.getCookedName(HxCCIdentifier::eActualName).contains(text) ||
         id.getCookedName(HxCCIdentifier::eFormalName).contains(text);
}

void reportImprecise(const HxCCIdentifier& id, const char* kind,
                     double seconds) {
  char value[400];  // the largest double has 309 digits before the point
  // Not printf(), which would write the decimal point of the locale.
  char digits[sizeof value] = "";
  std::to_chars(digits, std::end(digits) - 1, seconds, std::chars_format::fixed,
                10);
  std::snprintf(value, sizeof value, "%12s", digits);
  ERR_Msg1207(messageRef(id), kind, value);
}

}  // namespace

// A text without a macro of its own carries neither references nor flags, so
// that there is nothing to do where the macro does not occur.
bool HxCNames::replaceMacro(HxCCIdentifier& id, const char* macro,
                            const KyCXString& text) {
  if (!contains(id, "$" + KyCXString(macro))) return false;
  return substAllDollarZByValue(id, macro, HxCCIdentifier(text),
                                eMacroKindExact);
}

void HxCNames::replaceByIdentifier(HxCCIdentifier& id, const char* macro,
                                   const HxCCIdentifier& value) {
  HxCCIdentifier name(value);
  name.makeCIdentifier();
  substAllDollarZByValue(id, macro, name, eMacroKindExact);
}

void HxCNames::replaceMultirateTimeName(HxCCIdentifier& id, double period,
                                        double offset, bool cyclic) {
  if (!cyclic) {
    replaceAcyclicMultirateTimeName(id);
    return;
  }
  offset = std::fabs(offset);
  replaceBaseTimeMacros(id, period, offset);
  replaceGenericTimeMacro(id, period, offset);
}

void HxCNames::replaceBaseTimeMacros(HxCCIdentifier& id, double period,
                                     double offset) {
  for (const TimeBase& base : kTimeBases) {
    const double periods = period / base.seconds;
    const double offsets = offset / base.seconds;
    const KyCXString periodText = rounded(periods);
    const KyCXString offsetText = rounded(offsets);
    const bool periodExact = FPS_IsIntegerValue(periods);
    const bool offsetExact = FPS_IsIntegerValue(offsets);
    const auto replace = [&](const char* macro, const char* kind,
                             const KyCXString& text, bool exact) {
      if (replaceMacro(id, macro, text) && !exact)
        ERR_Msg1206(messageRef(id), kind, base.unit, period, offset);
    };
    replace(base.time, "Time", timeText(periodText, offsetText, offset),
            periodExact && offsetExact);
    replace(base.period, "Period", periodText, periodExact);
    replace(base.offset, "Offset", offsetText, offsetExact);
  }
}

void HxCNames::replaceGenericTimeMacro(HxCCIdentifier& id, double period,
                                       double offset) {
  KyCXString periodText;
  KyCXString offsetText;
  const bool periodImprecise = findGenericTimeMacro(period, periodText);
  const bool offsetImprecise = findGenericTimeMacro(offset, offsetText);
  const bool time =
      replaceMacro(id, kTime, timeText(periodText, offsetText, offset));
  const bool periodUsed = replaceMacro(id, kPeriod, periodText);
  const bool offsetUsed = replaceMacro(id, kOffset, offsetText);
  if (periodImprecise && (time || periodUsed))
    reportImprecise(id, "period", period);
  if (offsetImprecise && (time || offsetUsed))
    reportImprecise(id, "offset", offset);
}

// The text of \p value (seconds) in the largest unit that is exact and not
// larger. Returns true if no unit is.
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
  const KyCXString acyclic("ACYCLIC");
  bool replaced = false;
  const auto replaceAll = [&](const char* TimeBase::*macro,
                              const char* generic) {
    for (const TimeBase& base : kTimeBases)
      replaced |= replaceMacro(id, base.*macro, acyclic);
    replaced |= replaceMacro(id, generic, acyclic);
  };
  replaceAll(&TimeBase::time, kTime);
  replaceAll(&TimeBase::period, kPeriod);
  replaceAll(&TimeBase::offset, kOffset);
  if (replaced) ERR_Msg1205(messageRef(id), id.getRawName(kActive).cstring());
}

void HxCNames::replaceMultirateTaskISRName(HxCCIdentifier& id,
                                           const HxCCIdentifier& task,
                                           const HxCCIdentifier& isr,
                                           bool isTaskName) {
  const HxCCIdentifier isrBefore(isr);  // isr may be the name changed here
  if (isTaskName) {
    if (replaceMacro(id, "(Task)", "__Task_"))
      ERR_Msg1204(messageRef(id), id.getRawName(kActive).cstring());
  } else {
    const bool hasTask = !task.getCookedName(kActive).isEmpty();
    replaceByIdentifier(id, "(Task)", hasTask ? task : isr);
  }
  replaceByIdentifier(id, "(ISR)", isrBefore);
}

void HxCNames::replaceMultirateObjName(HxCCIdentifier& id,
                                       const HxCCIdentifier& obj) {
  replaceByIdentifier(id, "(PObj)", obj);
}

void HxCNames::replaceMultirateEventName(HxCCIdentifier& id,
                                         const HxCCIdentifier& event) {
  replaceByIdentifier(id, "(Event)", event);
}

void HxCNames::replaceMultirateISRName(HxCCIdentifier& id,
                                       const HxCCIdentifier& isr) {
  replaceByIdentifier(id, "(ISR)", isr);
}

void HxCNames::replaceMultirateMsgName(HxCCIdentifier& id,
                                       const HxCCIdentifier& msg) {
  replaceByIdentifier(id, "(Msg)", msg);
}

void HxCNames::replaceMultirateCtrName(HxCCIdentifier& id,
                                       const HxCCIdentifier& ctr) {
  replaceByIdentifier(id, "(Ctr)", ctr);
}

void HxCNames::replaceMultirateMsgVarName(HxCCIdentifier& id,
                                          const KyCXString& text) {
  leda::array<KyCXString> parts;
  text.split('#', parts);
  KyCXString value("1");
  if (parts.size() > 1) {
    value = parts[parts.high()];
    value = value.head(value.length() - 1);
  }
  // The value may hold macros: its flags count even where nothing is replaced.
  substAllDollarZByValue(id, "(MsgVar)", HxCCIdentifier(value),
                         eMacroKindExact);
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
