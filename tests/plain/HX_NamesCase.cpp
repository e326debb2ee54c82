// Random calls of identifiers, names and keywords on both sides.
#include "Naming/HxCNames.h"
#include "plain/HX_PlainCase.h"
#include "plain/HX_PlainNames.h"
#include "platform/model/HxCGlobal.h"

namespace plain {

namespace {

constexpr int kIds = 3;

// The plain side: indices stay indices, texts stay texts.
struct PlainSide {
  using Id = Identifier;
  using Names = plain::Names;
  explicit PlainSide(const Model& m) : model(m) {}

  static const Text& text(const Text& t) { return t; }
  static Text chars(const Text& t) { return wide(narrow(t)); }
  static const Text& plainText(const Text& t) { return t; }
  static int ref(int i) { return i; }
  static int index(int i) { return i; }
  static int ivBlock(int i) { return i; }
  static int type(int i) { return i; }
  static int symbol(int i) { return i; }
  void adaptSize(Id& id) const { id.adaptSize(model.limitsNames); }
  Messages takeMessages() { return std::exchange(messages, {}); }

  const Model& model;
  Messages messages;
  Names names{model, messages};
  Id ids[kIds];
};

struct LibrarySide {
  using Id = HxCCIdentifier;
  using Names = HxCNames;
  explicit LibrarySide(Model& m) : model(m) {}
  LibrarySide(const LibrarySide&) = delete;
  LibrarySide& operator=(const LibrarySide&) = delete;
  ~LibrarySide() { HxCNames::shutdown(); }

  static KyCXString text(const Text& t) { return kyText(t); }
  const char* chars(const Text& t) { return (held = narrow(t)).c_str(); }
  static Text plainText(const KyCXString& t) { return textOf(t); }
  const HxCSrcRef* ref(int i) { return entry(model.refs, i); }
  int index(const HxCSrcRef* ref) const { return model.indexOf(ref); }
  int index(const HX_BdBlock* block) const {
    for (std::size_t i = 0; i < model.ivBlocks.size(); ++i)
      if (&model.ivBlocks[i] == block) return static_cast<int>(i);
    return kNone;
  }
  HX_BdBlock* ivBlock(int i) { return entry(model.ivBlocks, i); }
  HX_DataType* type(int i) { return entry(model.types, i); }
  HxCSymbol* symbol(int i) { return entry(model.symbols, i); }
  static void adaptSize(Id& id) { id.adaptSize(); }
  Messages takeMessages() const { return model.takeMessages(); }

  LibraryModel model;
  std::string held;
  Names names;
  Id ids[kIds];
};

// Arguments of a call, drawn as the letters of the row say.
struct Call {
  std::size_t row = 0;
  int id = 0, other = 0, third = 0;  // o, h
  bool flag = false;                 // f
  Text text;                         // t template, l label, m macro, w word
  int number = 0;                    // n
  int index = 0;  // r reference, i block, s symbol, T type, or kNone
  unsigned int retained = 0, provisional = 0;  // b
  double period = 0, offset = 0;               // p
};

// A call of one operation. The result is a text.
template <class S>
struct Row {
  const char* name;
  const char* arguments;
  std::string (*make)(S&, typename S::Id&, const Call&);
};

std::string told(bool result) { return result ? "true" : "false"; }

// RETURNS: a row per operation, often used ones first.
template <class S>
const auto& rows() {
  using Id = typename S::Id;
  using C = Call;
  using Tag = typename Id::HxENameTypeTag;
  using Level = typename Id::HxECookLevelTag;
  using Names = typename S::Names;
  using Kind = typename Names::tagMacroKindEnum;
  using Word = typename Names::tagHxEDictEntryType;
#define HX_ROW(name, arguments, ...)                           \
  {                                                            \
    name, arguments,                                           \
        []([[maybe_unused]] S& s, [[maybe_unused]] Id& id,     \
           [[maybe_unused]] const C& c) -> std::string {       \
          [[maybe_unused]] const auto text = s.text(c.text);   \
          [[maybe_unused]] const Tag type = Tag(c.number % 3); \
          __VA_ARGS__;                                         \
        }                                                      \
  }
#define HX_DO(name, arguments, ...) \
  HX_ROW(name, arguments, __VA_ARGS__; return "")
  static const Row<S> kRows[] = {
    HX_ROW("createNameFromForm", "Tbf",
           return told(s.names.createNameFromForm(
               id, s.type(c.index), c.retained, c.provisional, c.flag))),
    HX_ROW("substAllDollarZByValue", "omn",
           return told(s.names.substAllDollarZByValue(id, text, s.ids[c.other],
                                                      Kind(c.number % 3)))),
    HX_DO("replaceMultirateTimeName", "pf",
          s.names.replaceMultirateTimeName(id, c.period, c.offset, c.flag)),
    HX_DO("replaceMultirateTaskISRName", "ohf",
          s.names.replaceMultirateTaskISRName(id, s.ids[c.other],
                                              s.ids[c.third], c.flag)),
    HX_ROW("handleFileNameMacro", "f",
           return told(s.names.handleFileNameMacro(id, c.flag))),
    HX_ROW("setName", "t", return told(id.setName(text))),
    HX_DO("setSourceRef", "r", id.setSourceRef(s.ref(c.index))),
    HX_DO("setDdSourceRef", "r", id.setDdSourceRef(s.ref(c.index))),
    HX_DO("setSourceIVBlock", "i", id.setSourceIVBlock(s.ivBlock(c.index))),
    HX_DO("setSignalLabel", "l", id.setSignalLabel(text)),
    HX_DO("setDollarXValue", "t", id.setDollarXValue(text)),
    HX_DO("activateActualName", "", id.activateActualName()),
    HX_DO("activateFormalName", "", id.activateFormalName()),
    HX_DO("setCookLevel", "n", id.setCookLevel(Level(c.number % 4))),
    HX_DO("setIdentifierChangeable", "nf",
          id.setIdentifierChangeable(c.flag, type)),
    HX_DO("setDollarLUsed", "nf", id.setDollarLUsed(c.flag, type)),
    HX_DO("setDollarEUsed", "nf", id.setDollarEUsed(c.flag, type)),
    HX_DO("setDollarNUsed", "nf", id.setDollarNUsed(c.flag, type)),
    HX_DO("setCookedName", "tn", id.setCookedName(text, type)),
    HX_DO("handleSymbolNameMacro", "s",
          if (c.index != kNone)
              s.names.handleSymbolNameMacro(id, s.symbol(c.index))),
    HX_DO("replaceMultirateObjName", "o",
          s.names.replaceMultirateObjName(id, s.ids[c.other])),
    HX_DO("replaceMultirateEventName", "o",
          s.names.replaceMultirateEventName(id, s.ids[c.other])),
    HX_DO("replaceMultirateISRName", "o",
          s.names.replaceMultirateISRName(id, s.ids[c.other])),
    HX_DO("replaceMultirateMsgName", "o",
          s.names.replaceMultirateMsgName(id, s.ids[c.other])),
    HX_DO("replaceMultirateCtrName", "o",
          s.names.replaceMultirateCtrName(id, s.ids[c.other])),
    HX_DO("replaceMultirateMsgVarName", "t",
          s.names.replaceMultirateMsgVarName(id, text)),
    HX_DO("copy", "o", id = Id(s.ids[c.other])),
    HX_DO("assign", "o", id = s.ids[c.other]),
    HX_DO("assign text", "t", id = text),
    HX_DO("assign characters", "t", id = s.chars(c.text)),
    HX_ROW("setName of raw name", "n",
           return told(id.setName(id.getRawName(type)))),
    HX_ROW("setName of cooked name", "n",
           return told(id.setName(id.getCookedName(type)))),
    HX_DO("addPrefix", "t", id.addPrefix(text)),
    HX_DO("addPostfix", "t", id.addPostfix(text)),
    HX_DO("+=", "t", id += text),
    HX_DO("+= characters", "t", id += s.chars(c.text)),
    HX_DO("+= own name", "n", id += id.getRawName(type)),
    HX_DO("makeCIdentifier", "", id.makeCIdentifier()),
    HX_DO("adaptSize", "", s.adaptSize(id)),
    HX_ROW("==", "o", return told(id == s.ids[c.other])),
    HX_DO("addToKeywordDict", "wn",
          s.names.addToKeywordDict(text, Word(c.number % 3))),
    HX_ROW("isStringValidCVariableName", "w",
           return told(s.names.isStringValidCVariableName(text))),
    HX_ROW("isFileNameValid", "w", auto name = text;
           return told(s.names.isFileNameValid(name))),
    HX_ROW("isFileNameValid of identifier", "",
           return told(s.names.isFileNameValid(id))),
    HX_ROW("appendSuffix", "tn", auto name = text;
           s.names.appendSuffix(name, c.number * c.number);
           return shown(s.plainText(name)))
  };
#undef HX_DO
#undef HX_ROW
  return kRows;
}

constexpr std::initializer_list<const char16_t*> kPieces = {
    u"x",
    u"_",
    u"$B",
    u"$S",
    u"$L",
    u"$C",
    u"$O",
    u"$D",
    u"$N",
    u"$E",
    u"$R",
    u"$X",
    u"$T",
    u"$I",
    u"$M",
    u"$H",
    u"$$",
    u"$",
    u":",
    u"$P",
    u"$V$v",
    u"$F$f",
    u"$Q",
    u"$l$n$e",
    u"$(Type)",
    u"$(BaseType)",
    u"$(Component)",
    u"$(Task)",
    u"$(ISR)",
    u"$(Event)",
    u"$(Msg)",
    u"$(MsgVar)",
    u"$(Ctr)",
    u"$(PObj)",
    u"$(DataVariantName)",
    u"$(Foo)",
    u"$(",
    u"$(Type",
    u"(",
    u")",
    u"'",
    u"$E(a-(b')'))",
    u"$x",
    u"$t$T",
    u"$\u0142",
    u"\u00FC",
    u" ",
    u"9",
    u"abcdefghijklmnopqrstuvwxyz",
    u"int",
    u"#"};

// A template of macros and other pieces, or of any characters.
Text templateFrom(Choices& c) {
  Text text = c.text(nullptr, 6, kPieces);
  if (c.byte() % 4 == 3) {
    text += u"$(";
    text += c.of(nullptr, {u"Time", u"Period", u"Offset"});
    text += c.of(nullptr, {u"", u"1us", u"10us", u"100us", u"1ms", u"10ms",
                           u"100ms", u"1s", u"1m", u"1h", u"1d"});
    text += u")";
  }
  if (c.byte() % 12 == 11) text = c.anyText();
  const int twice = c.byte() % 10;
  if (twice == 1) text += u":" + text;
  if (twice == 2) text += u":$R" + text;
  if (twice == 3) text += u":" + text + u"$R";
  c.tell(" " + shown(text));
  return text;
}

unsigned int bitsFrom(Choices& c, const char* what) {
  const int shift = c.below(what, 48) - 24;
  if (shift < 0) return shift == -1 ? 0xFFFFFFFF : 0;
  return 1u << shift;
}

double secondsFrom(Choices& c, const char* what) {
  const double factor = c.of(what, {0.0, 1.0, 0.005, 0.1, 7.0, 0.3333333});
  return factor * c.of(what, {1.0, 1e-3, 1e-6, 60.0, 3600.0, 86400.0, 1e-7, 1e5,
                              1.5, 2147.4836475});
}

void drawArgument(Choices& c, const Model& m, char argument, Call& call) {
  const auto index = [&](std::size_t count) {
    call.index = c.index("index", count);
  };
  if (argument == 'o') call.other = c.below("other", kIds);
  if (argument == 'h') call.third = c.below("third", kIds);
  if (argument == 'f') call.flag = c.flag("flag");
  if (argument == 't') call.text = templateFrom(c);
  if (argument == 'l')
    call.text =
        c.text("label", 3, {u"<", u" ", u"a", u">", u"9-", u"\n", u"< a >"});
  if (argument == 'm')
    call.text =
        c.text("macro", 1,
               {u"E", u"e", u"N", u"n", u"L", u"l", u"x", u"X", u"B", u"(Task)",
                u"(tASK)", u"Task", u"R", u"$", u"E(", u"\u0416", u"t"});
  if (argument == 'w')
    call.text = c.text(
        "word", 2,
        {u"int", u"a", u"UInt8", u"1", u"-", u" ", u"while", u"_", u"\u0416"});
  if (argument == 'n') call.number = c.byte();
  if (argument == 'r') index(m.refs.size());
  if (argument == 'i') index(m.ivBlocks.size());
  if (argument == 's') index(m.symbols.size());
  if (argument == 'T') index(m.types.size());
  if (argument == 'b') call.retained = bitsFrom(c, "retained");
  if (argument == 'b') call.provisional = bitsFrom(c, "provisional");
  if (argument == 'p') call.period = secondsFrom(c, "period");
  if (argument == 'p')
    call.offset = secondsFrom(c, "offset") * c.of("sign", {1.0, -1.0});
}

// All fields; a flag as the answer of the getter and as stored.
template <class Side>
std::string stateOf(Side& side, typename Side::Id& id) {
  using Id = typename Side::Id;
  std::string state = id.isFormalNameActive() ? " formal" : " actual";
  state += " level " + std::to_string(id.getCookLevel());
  Id stored(id);
  stored.setCookLevel(static_cast<typename Id::HxECookLevelTag>(3));
  for (int i = 0; i < 3; ++i) {
    const auto type = static_cast<typename Id::HxENameTypeTag>(i);
    state += " " + shown(side.plainText(id.getRawName(type))) + "/" +
             shown(side.plainText(id.getCookedName(type)));
    for (const Id* from : {&id, &stored}) {
      state += "/";
      if (from->getIdentifierChangeable(type)) state += 'R';
      if (from->getDollarLUsed(type)) state += 'L';
      if (from->getDollarEUsed(type)) state += 'E';
      if (from->getDollarNUsed(type)) state += 'N';
    }
  }
  auto x = side.text(u"");
  id.getDollarXValue(x);
  return state + " label " + shown(side.plainText(id.getSignalLabel())) +
         " x " + shown(side.plainText(x)) + " refs " +
         std::to_string(side.index(id.getSourceRef())) + " " +
         std::to_string(side.index(id.getDdSourceRef())) + " " +
         std::to_string(side.index(id.getSourceIVBlock()));
}

// A text per call: result, identifiers of the call, messages.
template <class Side>
std::vector<std::string> answersOf(Side& side, const std::vector<Call>& calls) {
  std::vector<std::string> answers;
  side.names.boot();
  for (const Call& call : calls) {
    const Row<Side>& row = rows<Side>()[call.row];
    std::string answer = row.make(side, side.ids[call.id], call) + "\n   id" +
                         stateOf(side, side.ids[call.id]);
    if (row.arguments[0] == 'o')
      answer += "\n   other" + stateOf(side, side.ids[call.other]);
    for (const std::string& message : side.takeMessages())
      answer += "\n   " + message;
    answers.push_back(answer);
    // Names put into each other would double again and again.
    auto& id = side.ids[call.id];
    if (answer.size() > 3'000) id = side.text(u"x");
  }
  return answers;
}

}  // namespace

std::string differenceOfNames(const std::string& bytes, std::string* log) {
  Choices choices(bytes, log);
  Model model = randomModel(choices);
  std::vector<Call> calls;
  std::vector<std::string> described;
  choices.tell("\ncalls:");
  const auto add = [&](std::size_t row, int id) {
    const Row<PlainSide>& operation = rows<PlainSide>()[row];
    described.push_back("\n  " + std::to_string(calls.size() + 1) + " " +
                        operation.name + " of " + std::to_string(id));
    choices.tell(described.back());
    calls.emplace_back();
    calls.back().row = row;
    calls.back().id = calls.back().other = id;
    for (const char* argument = operation.arguments; *argument; ++argument)
      drawArgument(choices, model, *argument, calls.back());
  };
  // First identifiers with template and references, then any calls, half of
  // them expansions, substitutions, multirate names and file names.
  const std::size_t kSetters = 12, kRows = std::size(rows<PlainSide>());
  for (int id = 0; id < 2; ++id)
    for (std::size_t row = 5; row < kSetters; ++row)
      if (choices.byte() % 4 > (row < 7 ? 0 : row < 9 ? 1 : 2)) add(row, id);
  while (calls.size() < 16 && !choices.isEmpty()) {
    const std::size_t often[] = {0, 1, 0, 1, 2, 3, 4};
    const auto row = static_cast<std::size_t>(choices.byte()) % (2 * kRows);
    add(row < kRows ? row : often[row % 7], choices.byte() % kIds);
  }
  LibrarySide library(model);
  PlainSide plain(model);
  return firstDifference(described, answersOf(library, calls),
                         answersOf(plain, calls));
}

}  // namespace plain
