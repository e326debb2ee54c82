// Random calls of identifiers, names and keywords on both sides.
#include "Naming/HxCNames.h"
#include "plain/HX_PlainCase.h"
#include "plain/HX_PlainNames.h"
#include "platform/model/HxCGlobal.h"

namespace plain {

namespace {

constexpr std::size_t kIds = 3;

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
  static void append(Id& id, const Text& t) { id.addPostfix(t); }
  static void appendChars(Id& id, const Text& t) { id.addPostfix(chars(t)); }
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
  static void append(Id& id, const Text& t) { id += kyText(t); }
  void appendChars(Id& id, const Text& t) { id += chars(t); }
  Messages takeMessages() const { return model.takeMessages(); }

  LibraryModel model;
  std::string held;
  Names names;
  Id ids[kIds];
};

enum Op {
  eSetName,
  eCreateName,
  eSubstitute,
  eSetSource,
  eSetDdSource,
  eSetIvBlock,
  eSetLabel,
  eSetX,
  eActivateActual,
  eActivateFormal,
  eSetLevel,
  eSetFlag,
  eSetCooked,
  eFileName,
  eSymbolName,
  eTimeName,
  eTaskName,
  eOtherName,
  eMsgVarName,
  eCopy,
  eAssign,
  eAssignText,
  eAssignChars,
  eOwnName,
  ePrefix,
  ePostfix,
  eAppend,
  eAppendChars,
  eMakeC,
  eAdaptSize,
  eEqual,
  eAddWord,
  eVariableName,
  eFileNameText,
  eFileNameId,
  eSuffix,
  eCopyNames,
  eOpCount
};
const char* const kOpNames[] = {"setName",
                                "createNameFromForm",
                                "substAllDollarZByValue",
                                "setSourceRef",
                                "setDdSourceRef",
                                "setSourceIVBlock",
                                "setSignalLabel",
                                "setDollarXValue",
                                "activateActualName",
                                "activateFormalName",
                                "setCookLevel",
                                "set flag",
                                "setCookedName",
                                "handleFileNameMacro",
                                "handleSymbolNameMacro",
                                "replaceMultirateTimeName",
                                "replaceMultirateTaskISRName",
                                "replaceMultirate...Name",
                                "replaceMultirateMsgVarName",
                                "copy",
                                "assign",
                                "assign text",
                                "assign characters",
                                "setName of own name",
                                "addPrefix",
                                "addPostfix",
                                "+=",
                                "+= characters",
                                "makeCIdentifier",
                                "adaptSize",
                                "==",
                                "addToKeywordDict",
                                "isStringValidCVariableName",
                                "isFileNameValid text",
                                "isFileNameValid",
                                "appendSuffix",
                                "copy names"};
static_assert(std::size(kOpNames) == eOpCount);

struct Call {
  int op = 0;
  int id = 0, other = 0, third = 0;
  Text text;
  int number = 0, index = 0;
  bool flag = false;
  unsigned int retained = 0, provisional = 0;
  double period = 0, offset = 0;
};

Text templateFrom(Choices& c, const char* what) {
  return c.text(what, 6,
                {u"x",
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
                 u"$(Time)",
                 u"$(Period)",
                 u"$(Offset)",
                 u"$(Time1ms)",
                 u"$(Period10us)",
                 u"$(Offset100ms)",
                 u"$(Time1h)",
                 u"$(Period1d)",
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
                 u"$\u0416",
                 u"\u00FC",
                 u" ",
                 u"9",
                 u"abcdefghijklmnopqrstuvwxyz",
                 u"int",
                 u"#"});
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

bool usesOther(int op) {
  return op == eSubstitute || op == eTaskName || op == eOtherName ||
         op == eCopy || op == eAssign || op == eEqual;
}

Call callFrom(Choices& c, const Model& model, int op, int id) {
  Call call;
  call.op = op;
  c.tell(std::string("\n  ") + kOpNames[op]);
  call.id = id;
  if (id != 0) c.tell(" id=" + std::to_string(id));
  call.other = usesOther(op) ? c.below("other", kIds) : id;
  if (op == eTaskName) call.third = c.below("third", kIds);
  call.flag = c.flag("flag");
  switch (call.op) {
    case eSubstitute:
      call.number = c.below("kind", 3);
      call.text = c.text(
          "macro", 1,
          {u"E", u"e", u"N", u"n", u"L", u"l", u"x", u"X", u"B", u"(Task)",
           u"(tASK)", u"Task", u"R", u"$", u"E(", u"\u0416", u"t"});
      break;
    case eCreateName:
      call.index = c.index("type", model.types.size());
      call.retained = bitsFrom(c, "retained");
      call.provisional = bitsFrom(c, "provisional");
      break;
    case eSetSource:
    case eSetDdSource:
      call.index = c.index("ref", model.refs.size());
      break;
    case eSetIvBlock:
      call.index = c.index("ivBlock", model.ivBlocks.size());
      break;
    case eSymbolName:
      call.index = c.index("symbol", model.symbols.size());
      break;
    case eTimeName:
      call.period = secondsFrom(c, "period");
      call.offset = secondsFrom(c, "offset") * c.of("sign", {1.0, -1.0});
      break;
    case eSuffix:
      call.number = c.of("index", {0, 25, 26, 27, 701, 702, 18278, 475253});
      call.text = templateFrom(c, "text");
      break;
    case eVariableName:
    case eAddWord:
    case eFileNameText:
      call.number = c.below("kind", 3);
      call.text = c.text("word", 2,
                         {u"int", u"a", u"UInt8", u"1", u"-", u" ", u"while",
                          u"_", u"\u0416"});
      break;
    default:
      call.number = c.below("number", 12);
      call.text = templateFrom(c, "text");
  }
  return call;
}

// Makes the call. RETURNS: the result as text.
template <class Side>
std::string resultOf(Side& side, const Call& call) {
  using Id = typename Side::Id;
  using Names = typename Side::Names;
  Id& id = side.ids[call.id];
  Id& other = side.ids[call.other];
  Names& names = side.names;
  const auto text = side.text(call.text);
  const auto type = static_cast<typename Id::HxENameTypeTag>(call.number % 3);
  const auto yes = [](bool result) { return result ? "true" : "false"; };
  switch (call.op) {
    case eSetName:
      return yes(id.setName(text));
    case eCreateName:
      return yes(names.createNameFromForm(id, side.type(call.index),
                                          call.retained, call.provisional,
                                          call.flag));
    case eSubstitute:
      return yes(names.substAllDollarZByValue(
          id, text, other,
          static_cast<typename Names::tagMacroKindEnum>(call.number)));
    case eSetSource:
      id.setSourceRef(side.ref(call.index));
      break;
    case eSetDdSource:
      id.setDdSourceRef(side.ref(call.index));
      break;
    case eSetIvBlock:
      id.setSourceIVBlock(side.ivBlock(call.index));
      break;
    case eSetLabel:
      id.setSignalLabel(text);
      break;
    case eSetX:
      id.setDollarXValue(text);
      break;
    case eActivateActual:
      id.activateActualName();
      break;
    case eActivateFormal:
      id.activateFormalName();
      break;
    case eSetLevel:
      id.setCookLevel(
          static_cast<typename Id::HxECookLevelTag>(call.number % 4));
      break;
    case eSetFlag:
      if (call.number / 3 == 0) id.setIdentifierChangeable(call.flag, type);
      if (call.number / 3 == 1) id.setDollarLUsed(call.flag, type);
      if (call.number / 3 == 2) id.setDollarEUsed(call.flag, type);
      if (call.number / 3 == 3) id.setDollarNUsed(call.flag, type);
      break;
    case eSetCooked:
      id.setCookedName(text, type);
      break;
    case eFileName:
      return yes(names.handleFileNameMacro(id, call.flag));
    case eSymbolName:
      if (call.index != kNone)
        names.handleSymbolNameMacro(id, side.symbol(call.index));
      break;
    case eTimeName:
      names.replaceMultirateTimeName(id, call.period, call.offset, call.flag);
      break;
    case eTaskName:
      names.replaceMultirateTaskISRName(id, other, side.ids[call.third],
                                        call.flag);
      break;
    case eOtherName:
      if (call.number % 5 == 0) names.replaceMultirateObjName(id, other);
      if (call.number % 5 == 1) names.replaceMultirateEventName(id, other);
      if (call.number % 5 == 2) names.replaceMultirateISRName(id, other);
      if (call.number % 5 == 3) names.replaceMultirateMsgName(id, other);
      if (call.number % 5 == 4) names.replaceMultirateCtrName(id, other);
      break;
    case eMsgVarName:
      names.replaceMultirateMsgVarName(id, text);
      break;
    case eCopy:
      id = Id(other);
      break;
    case eAssign:
      id = other;
      break;
    case eAssignText:
      id = text;
      break;
    case eAssignChars:
      id = side.chars(call.text);
      break;
    case eOwnName:
      return yes(
          id.setName(call.flag ? id.getCookedName(type) : id.getRawName(type)));
    case ePrefix:
      id.addPrefix(text);
      break;
    case ePostfix:
      id.addPostfix(text);
      break;
    case eAppend:
      side.append(id, call.text);
      break;
    case eAppendChars:
      side.appendChars(id, call.text);
      break;
    case eMakeC:
      id.makeCIdentifier();
      break;
    case eAdaptSize:
      side.adaptSize(id);
      break;
    case eEqual:
      return yes(id == other);
    case eAddWord:
      names.addToKeywordDict(
          text,
          static_cast<typename Names::tagHxEDictEntryType>(call.number % 3));
      break;
    case eVariableName:
      return yes(names.isStringValidCVariableName(text));
    case eFileNameText: {
      auto name = text;
      return yes(names.isFileNameValid(name));
    }
    case eFileNameId:
      return yes(names.isFileNameValid(id));
    case eSuffix: {
      auto name = text;
      names.appendSuffix(name, call.number);
      return shown(side.plainText(name));
    }
    default: {
      Names copy(names);
      (void)copy;
    }
  }
  return "";
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

// A line per call: result, identifiers of the call, messages.
template <class Side>
std::vector<std::string> answersOf(Side& side, const std::vector<Call>& calls) {
  std::vector<std::string> answers;
  side.names.boot();
  for (const Call& call : calls) {
    std::string answer = resultOf(side, call);
    answer += "\n   id" + stateOf(side, side.ids[call.id]);
    if (call.other != call.id)
      answer += "\n   other" + stateOf(side, side.ids[call.other]);
    for (const std::string& message : side.takeMessages())
      answer += "\n   " + message;
    answers.push_back(answer);
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
  const auto add = [&](int op, int id) {
    calls.push_back(callFrom(choices, model, op, id));
    described.push_back(std::to_string(calls.size()) + " " + kOpNames[op]);
  };
  // First identifiers with a template and references, then any calls: mostly
  // expansions and substitutions.
  for (int id = 0; id < 2; ++id)
    for (const int op : {eSetName, eSetSource, eSetDdSource, eSetIvBlock,
                         eSetLabel, eSetX, eActivateActual})
      if (choices.byte() % 4 > (op > eSetSource ? 2 : 0)) add(op, id);
  while (calls.size() < 16 && !choices.isEmpty()) {
    const int op = choices.byte() % (2 * eOpCount);
    add(op < eOpCount ? op : 1 + op % 2, choices.byte() % kIds);
  }
  LibrarySide library(model);
  PlainSide plain(model);
  return firstDifference(described, answersOf(library, calls),
                         answersOf(plain, calls));
}

}  // namespace plain
