// Substitution of single macros: by a value, by a symbol, and multirate names.
#include <algorithm>
#include <cmath>
#include <cstdio>

#include "plain/HX_PlainNames.h"

namespace plain {

bool Names::substAllDollarZByValue(Id& id, const Text& macro, const Id& value,
                                   tagMacroKindEnum kind) {
  if (macro == u"e" || macro == u"E") id.setCookLevel(Id::eDollarE);
  if (value.getCookLevel() == Id::eDollarE && id.getCookLevel() == Id::eRaw)
    id.setCookLevel(Id::eDollarE);
  const bool actual =
      substAllDollarZByValue(id, macro, value, kind, Id::eActualName);
  const bool formal =
      substAllDollarZByValue(id, macro, value, kind, Id::eFormalName);
  return actual || formal;
}

bool Names::substAllDollarZByValue(Id& id, const Text& macro, const Id& value,
                                   tagMacroKindEnum kind, Id::Tag type) {
  if (value.getDdSourceRef() != kNone)
    id.setDdSourceRef(value.getDdSourceRef());
  if (value.getSourceRef() != kNone) id.setSourceRef(value.getSourceRef());
  const auto active = Id::eActiveName;
  if (value.getIdentifierChangeable(active))
    id.setIdentifierChangeable(true, active);
  if (value.getDollarLUsed(active)) id.setDollarLUsed(true, active);
  if (value.getDollarEUsed(active)) id.setDollarEUsed(true, active);
  if (value.getDollarNUsed(active)) id.setDollarNUsed(true, active);

  const Text source = id.getCookedName(type);
  const Text replacement = value.getCookedName(type);
  Text lowerKey = macro, upperKey = macro, upperReplacement = replacement;
  if (kind == eAnyCase || kind == eCaseSelectsValue) {
    lowerKey = lower(macro);
    upperKey = upper(macro);
  }
  if (kind == eCaseSelectsValue) upperReplacement = upper(replacement);

  Text result;
  bool isReplaced = false;
  std::size_t pos = 0;
  for (;;) {
    const std::size_t d = source.find('$', pos);
    if (pos >= source.size() || d == Text::npos) break;
    result += source.substr(pos, d - pos);
    Text text = source.substr(d + 1, macro.size());
    if (kind == eAnyCase) text = lower(text);
    if (text == lowerKey || text == upperKey) {
      result += text == lowerKey ? replacement : upperReplacement;
      pos = d + lowerKey.size() + 1;
      isReplaced = true;
      if (macro == u"e" || macro == u"E") id.setDollarEUsed(true, type);
      if (macro == u"l" || macro == u"L") id.setDollarLUsed(true, type);
      if (macro == u"n" || macro == u"N") id.setDollarNUsed(true, type);
      continue;
    }
    const char16_t next = d + 1 < source.size() ? source[d + 1] : u'\0';
    std::size_t end = d + 2;
    if (next == '(') {
      const std::size_t close = source.find(')', d);
      end = close == Text::npos ? source.size() : close + 1;
    } else if (next == 'E') {
      end = d + 2 + findDollarELength(source, d + 2);
    }
    result += source.substr(d, end - d);
    pos = end;
  }
  if (pos < source.size()) result += source.substr(pos);
  id.setCookedName(result, type);
  return isReplaced;
}

bool Names::handleFileNameMacro(Id& id, bool useModelContext) {
  Bits retained = 0xFEFC1;
  if (!useModelContext && id.getSourceRef() == kNone) retained |= 0xE;
  return createNameFromForm(id, kNone, retained, 0, false);
}

void Names::handleSymbolNameMacro(Id& id, int symbol) {
  const Symbol& s = Model::at(m_Model.symbols, symbol);
  substAllDollarZByValue(id, u"x", Id(s.dollarX), eAnyCase);
  substAllDollarZByValue(id, s.kind == 3 ? u"f" : u"v", Id(s.name),
                         eCaseSelectsValue);
  Text cut;
  if (s.type != kNone) cut = Model::at(m_Model.types, s.type).cut;
  substAllDollarZByValue(id, u"t", Id(cut), eAnyCase);
  id.setCookLevel(Id::eSymbol);
}

namespace {

const double kTolerance = std::ldexp(1.0, -26);

bool areApproxEqual(double a, double b) {
  const double scale = std::max({1.0, std::fabs(a), std::fabs(b)});
  return kTolerance * scale > std::fabs(a - b);
}

// 64 bits at most.
bool isInteger(double x) {
  return areApproxEqual(std::min(std::floor(x + 0.5), 0x1p63), x);
}

Text count(double x) {
  const double largest = 2147483647.0;
  return decimal(static_cast<long long>(std::min(x + 0.5, largest)));
}

std::string number(const char* format, double x) {
  char text[400];
  std::snprintf(text, sizeof text, format, x);
  return text;
}

struct Unit {
  const char* text;
  double factor;
};
const Unit kFixedUnits[] = {{"1us", 1e-6},  {"10us", 1e-5}, {"100us", 1e-4},
                            {"1ms", 1e-3},  {"10ms", 0.01}, {"100ms", 0.1},
                            {"1s", 1.0},    {"1m", 60.0},   {"1h", 3600.0},
                            {"1d", 86400.0}};
const Unit kGenericUnits[] = {{"us", 1e-6}, {"ms", 1e-3},  {"s", 1.0},
                              {"m", 60.0},  {"h", 3600.0}, {"d", 86400.0}};

}  // namespace

void Names::replaceMultirateTimeName(Id& id, double period, double offset,
                                     bool cyclic) {
  offset = std::fabs(offset);
  if (cyclic) {
    replaceBaseTimeMacros(id, period, offset);
    replaceGenericTimeMacro(id, period, offset);
  } else {
    replaceAcyclicMultirateTimeName(id);
  }
}

void Names::replaceBaseTimeMacros(Id& id, double period, double offset) {
  for (const Unit& unit : kFixedUnits) {
    const auto tell = [&](const std::string& kind) {
      report(1206, 1, multirateRef(id),
             "A time name macro '" + kind + "' with the time base " +
                 unit.text + " is used. The period time " +
                 number("%f", period) + " or offset " + number("%f", offset) +
                 " cannot be represented precisely with this time base.");
    };
    const double pq = period / unit.factor;
    const double oq = offset / unit.factor;
    const Text time = count(pq) + (offset == 0.0 ? Text() : u"_" + count(oq));
    const Text end = wide(unit.text) + u")";
    if (replaced(id, u"(Time" + end, time) &&
        (!isInteger(pq) || !isInteger(oq)))
      tell("Time");
    if (replaced(id, u"(Period" + end, count(pq)) && !isInteger(pq))
      tell("Period");
    if (replaced(id, u"(Offset" + end, count(oq)) && !isInteger(oq))
      tell("Offset");
  }
}

bool Names::findGenericTimeMacro(double value, Text& text) {
  const double r = std::floor(value * 1000000 + 0.5) * 0.000001;
  bool isImprecise = !areApproxEqual(r, value);
  const Unit* chosen = nullptr;
  for (const Unit& unit : kGenericUnits) {
    if (&unit != kGenericUnits && r < unit.factor) break;
    if (isInteger(r / unit.factor)) chosen = &unit;
  }
  if (chosen == nullptr) {
    chosen = kGenericUnits;
    isImprecise = true;
  }
  text = count(r / chosen->factor) + wide(chosen->text);
  return isImprecise;
}

void Names::replaceGenericTimeMacro(Id& id, double period, double offset) {
  Text periodText, offsetText;
  const bool isPeriodImprecise = findGenericTimeMacro(period, periodText);
  const bool isOffsetImprecise = findGenericTimeMacro(offset, offsetText);
  const Text time = periodText + (offset == 0.0 ? Text() : u"_" + offsetText);
  const bool hasTime = replaced(id, u"(Time)", time);
  const bool hasPeriod = replaced(id, u"(Period)", periodText);
  const bool hasOffset = replaced(id, u"(Offset)", offsetText);
  const auto tell = [&](const std::string& kind, double value) {
    report(1207, 1, multirateRef(id),
           "The " + kind + " " + number("%12.10f", value) +
               " cannot be represented precisely with the $(Time) name macro.");
  };
  if (isPeriodImprecise && (hasTime || hasPeriod)) tell("period", period);
  if (isOffsetImprecise && (hasTime || hasOffset)) tell("offset", offset);
}

void Names::replaceAcyclicMultirateTimeName(Id& id) {
  bool isAny = false;
  for (const Text kind : {u"(Time", u"(Period", u"(Offset"}) {
    for (const Unit& unit : kFixedUnits)
      isAny |= replaced(id, kind + wide(unit.text) + u")", u"ACYCLIC");
    isAny |= replaced(id, kind + u")", u"ACYCLIC");
  }
  if (isAny)
    report(1205, 2, multirateRef(id),
           "A time/period/offset name macro is used in a noncyclic task. Name "
           "template: " +
               narrow(id.getRawName(Id::eActiveName)));
}

void Names::replaceMultirateTaskISRName(Id& id, const Id& task, const Id& isr,
                                        bool isTaskName) {
  const Id isrCopy = isr;  // the argument may be the identifier
  const bool hasTask = !task.getCookedName(Id::eActiveName).empty();
  if (!isTaskName)
    made(id, u"(Task)", hasTask ? task : isr);
  else if (replaced(id, u"(Task)", u"__Task_"))
    report(1204, 2, multirateRef(id),
           "The $Task name macro is used in the task name template " +
               narrow(id.getRawName(Id::eActiveName)) +
               ". This is not allowed.");
  made(id, u"(ISR)", isrCopy);
}

void Names::replaceMultirateMsgVarName(Id& id, const Text& text) {
  Text value = u"1";
  const std::vector<Text> parts = split(text, '#');
  if (parts.size() > 1) {
    value = parts.back();
    if (!value.empty()) value.pop_back();
  }
  replaced(id, u"(MsgVar)", value);
}

}  // namespace plain
