// Random calls of source references and server on both sides.
#include "SourceRef/HxCSrcRefCompare.h"
#include "SourceRef/HxCSrcRefServer.h"
#include "plain/HX_PlainCase.h"
#include "plain/HX_PlainSrcRef.h"
#include "platform/dump/HX_Dump.h"

namespace plain {

namespace {

struct Call {
  std::size_t row = 0, ref = 0, other = 0;  // any number: taken modulo
  int number = 0, line = 0;
  bool isNull = false;
  Text text, cause;
};

class PlainSide {
 public:
  PlainSide(const Model& m, int next) : model(m), refs(m.refs), maker{next} {}

  void enter(const Ref& ref) { refs.push_back(ref); }
  std::size_t count() const { return refs.size(); }
  Ref made(Ref::Kind kind, unsigned long handle = 0) {
    Ref ref;
    ref.kind = kind;
    ref.handle = handle;
    return maker.made(ref);
  }

  const Model& model;
  std::vector<Ref> refs;
  RefMaker maker;
};

class LibrarySide {
 public:
  explicit LibrarySide(Model& m) : model(m) {
    for (std::size_t i = 0; i < m.refs.size(); ++i)
      m.refs[i].id = model.refs[i]->getSrcRefId() - model.firstNumber;
  }

  void enter(const HxCSrcRef* ref) { model.refs.push_back(ref); }
  void own(HxCSrcRef* ref) {
    m_Owned.emplace_back(ref);
    enter(ref);
  }
  std::size_t count() const { return model.refs.size(); }

  LibraryModel model;
  const HxCSrcRef untouched;
  HxCSrcRefServer server;

 private:
  std::deque<std::unique_ptr<HxCSrcRef>> m_Owned;
};

// Sections and entries as text.
class TextDump : public HX_Dump {
 public:
  explicit TextDump(const HxCSrcRef* ref) : m_pRef(ref) {}
  void openObject(const HX_Dumpable* object, const KyCXString& name) override {
    text += (object == m_pRef ? "open " : "another ") + shown(textOf(name));
  }
  void writeEntry(const KyCXString& label, const KyCXString& value,
                  int level) override {
    text += shown(textOf(label)) + shown(textOf(value)) + std::to_string(level);
  }
  void closeObject(const HX_Dumpable* object) override {
    text += object == m_pRef ? " close" : " another";
  }

  std::string text;

 private:
  const HxCSrcRef* m_pRef;
};

HxCSrcRef* copied(const HxCSrcRef* ref) {
  if (ref->isBlock()) return HX_Block::dupSrcRef(*ref->isBlock());
  if (ref->isStateflow()) return new HxCStateflowSrcRef(*ref->isStateflow());
  if (ref->isDd()) return new HxCDdSrcRef(*ref->isDd());
  if (ref->isInternal()) return new HxCInternalSrcRef(*ref->isInternal());
  if (ref->isInputBlock()) return new HxCInputBlockSrcRef(*ref->isInputBlock());
  return new HxCSrcRef(*ref);
}

template <class T>
HxCSrcRef* assigned(T* made, const T& ref) {
  *made = ref;
  return made;
}
// A reference of the same class with other contents, and then assigned to.
HxCSrcRef* assignedFrom(const HxCSrcRef* ref, const HX_InputBlockId& otherId) {
  if (ref->isBlock()) {
    HxCBlockSrcRef* const made = HX_Block::dupSrcRef(*ref->isBlock());
    made->setBlock(nullptr);
    return assigned(made, *ref->isBlock());
  }
  if (ref->isStateflow())
    return assigned(new HxCStateflowSrcRef(), *ref->isStateflow());
  if (ref->isDd()) return assigned(new HxCDdSrcRef(), *ref->isDd());
  if (ref->isInternal())
    return assigned(new HxCInternalSrcRef(), *ref->isInternal());
  if (ref->isInputBlock())
    return assigned(new HxCInputBlockSrcRef(otherId), *ref->isInputBlock());
  return assigned(new HxCSrcRef(), *ref);
}

std::string comparison(bool both, bool different, bool onlyOne, int which,
                       bool scripts, bool noScripts) {
  std::string result = std::to_string(which);
  for (const bool holds : {both, different, onlyOne, scripts, noScripts})
    result += holds ? '1' : '0';
  return result;
}

using Result = std::string;

// One operation on reference i of both sides. References of the model itself
// are not changed, because blocks and objects own them.
struct Row {
  const char* name;
  Result (*plain)(PlainSide&, std::size_t i, const Call&);
  Result (*library)(LibrarySide&, std::size_t i, const Call&);
};

#define HX_PLAIN(...)                                                \
  []([[maybe_unused]] PlainSide& s, [[maybe_unused]] std::size_t i,  \
     [[maybe_unused]] const Call& c) -> Result {                     \
    [[maybe_unused]] Ref& ref = s.refs[i];                           \
    [[maybe_unused]] const Ref& other = s.refs[c.other % s.count()]; \
    __VA_ARGS__;                                                     \
    return "";                                                       \
  }
#define HX_LIBRARY(...)                                               \
  []([[maybe_unused]] LibrarySide& s, [[maybe_unused]] std::size_t i, \
     [[maybe_unused]] const Call& c) -> Result {                      \
    [[maybe_unused]] const HxCSrcRef* ref = s.model.refs[i];          \
    [[maybe_unused]] const HxCSrcRef* other =                         \
        s.model.refs[c.other % s.count()];                            \
    [[maybe_unused]] const KyCXString text = kyText(c.text);          \
    [[maybe_unused]] auto* internal =                                 \
        const_cast<HxCInternalSrcRef*>(ref->isInternal());            \
    __VA_ARGS__;                                                      \
    return "";                                                        \
  }

const Row kRows[] = {
    {"plain", HX_PLAIN(s.enter(s.made(Ref::eOther))),
     HX_LIBRARY(s.own(new HxCSrcRef()))},
    {"internal", HX_PLAIN(s.enter(s.maker.internal())),
     HX_LIBRARY(s.own(new HxCInternalSrcRef()))},
    {"internal of file and line",
     HX_PLAIN(Ref made = s.maker.internal(); made.file = c.text;
              made.line = c.line; s.enter(made)),
     HX_LIBRARY(s.own(new HxCInternalSrcRef(text, c.line)))},
    {"dictionary", HX_PLAIN(s.enter(s.made(Ref::eDd))),
     HX_LIBRARY(s.own(new HxCDdSrcRef()))},
    {"unknown dictionary object",
     HX_PLAIN(s.enter(s.made(Ref::eDd, kUnknownHandle))),
     HX_LIBRARY(s.own(new HxCDdSrcRef(kUnknownHandle)))},
    {"stateflow", HX_PLAIN(s.enter(s.made(Ref::eStateflow))),
     HX_LIBRARY(s.own(new HxCStateflowSrcRef()))},
    {"unknown input block", HX_PLAIN(s.enter(s.made(Ref::eInput))),
     HX_LIBRARY(s.own(new HxCInputBlockSrcRef(*s.model.inputs.back())))},
    {"copy", HX_PLAIN(s.enter(s.maker.copy(ref))),
     HX_LIBRARY(s.own(copied(ref)))},
    {"clone", HX_PLAIN(s.enter(s.maker.clone(ref))),
     HX_LIBRARY(s.own(ref->clone()))},
    {"assign", HX_PLAIN(Ref made = s.made(ref.kind); made = ref; s.enter(made)),
     HX_LIBRARY(s.own(assignedFrom(ref, *s.model.inputs.back())))},
    {"setFile", HX_PLAIN(if (ref.kind == Ref::eInternal) ref.file = c.text),
     HX_LIBRARY(if (internal) internal->setFile(text))},
    {"setLine", HX_PLAIN(if (ref.kind == Ref::eInternal) ref.line = c.line),
     HX_LIBRARY(if (internal) internal->setLine(c.line))},
    {"setLocation",
     HX_PLAIN(if (ref.kind != Ref::eInternal) return ""; ref.file = c.text;
              ref.line = c.line),
     HX_LIBRARY(if (internal) internal->setLocation(text, c.line))},
    {"setCause", HX_PLAIN(if (ref.kind == Ref::eInternal) ref.cause = c.cause),
     HX_LIBRARY(if (internal) internal->setCause(kyText(c.cause)))},
    {"setBlock",
     HX_PLAIN(if (i >= s.model.ownRefs() && ref.kind == Ref::eBlock)
                  ref.target = c.number % (int(s.model.blocks.size()) + 1) - 1),
     HX_LIBRARY(if (i >= s.model.ownRefs() &&
                    ref->isBlock()) const_cast<HxCBlockSrcRef*>(ref->isBlock())
                    ->setBlock(entry(
                        s.model.blocks,
                        c.number % (int(s.model.blocks.size()) + 1) - 1)))},
    {"getSrcRef", HX_PLAIN(s.enter(s.maker.internal())),
     HX_LIBRARY(s.enter(s.server.getSrcRef()))},
    {"shutdown and boot", HX_PLAIN(return "true"),
     HX_LIBRARY(return s.server.shutdown() && s.server.boot() ? "true"
                                                              : "false")},
    {"getSpecificSrcRefFromSet",
     HX_PLAIN(RefSet set; for (std::size_t k = 0; k < c.other % 16; ++k)
                  add(set, int((i + k) % s.count()));
              const Specific found =
                  specific(s.refs, c.isNull ? RefSet() : set);
              Result result; for (const int k
                                  : {0, 1, 2}) {
                const int refs[] = {found.block, found.dd, found.other};
                const bool isWanted = (c.number >> k & 1) != 0;
                result += std::to_string(isWanted ? refs[k] : -2) + " ";
              } return result),
     HX_LIBRARY(
         HxCSrcRefSet set; for (std::size_t k = 0; k < c.other % 16; ++k)
                               set.addSrcRef(s.model.refs[(i + k) % s.count()]);
         const HxCSrcRef* found[3]; const HxCSrcRef** places[3];
         for (int k = 0; k < 3; ++k) {
           found[k] = &s.untouched;
           places[k] = (c.number >> k & 1) != 0 ? &found[k] : nullptr;
         } HxCSrcRefServer::getSpecificSrcRefFromSet(c.isNull ? nullptr : &set,
                                                     places[0], places[1],
                                                     places[2]);
         Result result;
         for (const HxCSrcRef* one
              : found) result += std::to_string(s.model.indexOf(one)) + " ";
         return result)},
    {"compare",
     HX_PLAIN(const Ref* a = c.isNull ? nullptr : &ref;
              const Comparison d = compared(s.model, a, &other);
              return comparison(d.bothFromDD, d.bothFromDDButDifferent,
                                d.onlyOneFromDD, d.which, d.bothFromUserScript,
                                d.differentNotFromUserScript)),
     HX_LIBRARY(const HxCSrcRef* a = c.isNull ? nullptr : ref;
                const HxCSrcRefCompare d; int which = 7;
                const bool onlyOne = d.onlyOneFromDD(a, other, which);
                return comparison(
                    d.bothFromDD(a, other), d.bothFromDDButDifferent(a, other),
                    onlyOne, which, d.bothFromUserScript(a, other),
                    d.differentDdSrcRefNotFromUserScript(a, other)))},
    {"dump",
     HX_PLAIN(return "open \"HxCSrcRef\"\"Source:\"" +
                     shown(toString(s.model, ref, u"")) + "0 close"),
     HX_LIBRARY(TextDump dump(ref);
                const bool isSame =
                    const_cast<HxCSrcRef*>(ref)->dump(&dump, true) == &dump;
                return isSame ? dump.text : "another dump")}};

#undef HX_PLAIN
#undef HX_LIBRARY

// Number, kinds, text behind a text of the caller, and the rest of the kind.
std::string shownRef(const PlainSide& s, std::size_t i) {
  const Ref& ref = s.refs[i];
  const char* const kinds[] = {"s", "si", "sb", "sc", "sd", "sn"};
  std::string result = std::to_string(ref.id) + kinds[ref.kind] +
                       shown(toString(s.model, ref, u"a\nb"));
  if (ref.kind == Ref::eInternal)
    result += shown(ref.file) + std::to_string(ref.line) + shown(ref.cause);
  if (ref.kind == Ref::eBlock || ref.kind == Ref::eStateflow)
    result += std::to_string(ref.target);
  if (ref.kind == Ref::eBlock || ref.kind == Ref::eInput)
    result += "handle " + std::to_string(blockHandle(s.model, ref));
  if (ref.kind == Ref::eStateflow)
    result +=
        "id " + std::to_string(ref.target == kNone
                                   ? -1
                                   : Model::at(s.model.objects, ref.target).id);
  if (ref.kind == Ref::eDd)
    result += std::to_string(ref.handle) + ddPath(s.model, ref.handle);
  return result;
}

std::string shownRef(const LibrarySide& s, std::size_t i) {
  const HxCSrcRef* const ref = s.model.refs[i];
  const auto indexIn = [](const auto& all, const auto* object) {
    int index = kNone;
    for (std::size_t k = 0; k < all.size(); ++k)
      if (all[k].get() == object) index = static_cast<int>(k);
    return std::to_string(index);
  };
  std::string result = std::to_string(ref->getSrcRefId() - s.model.firstNumber);
  const std::pair<const void*, char> kinds[] = {
      {ref->isSrcRef(), 's'}, {ref->isInternal(), 'i'},
      {ref->isBlock(), 'b'},  {ref->isStateflow(), 'c'},
      {ref->isDd(), 'd'},     {ref->isInputBlock(), 'n'},
      {ref->isModule(), 'm'}};
  for (const auto& [answer, letter] : kinds)
    if (answer != nullptr) result += answer == ref ? letter : '?';
  KyCXString text("a\nb");
  ref->toString(text);
  result += shown(textOf(text));
  if (const HxCInternalSrcRef* internal = ref->isInternal())
    result += shown(textOf(internal->getFile())) +
              std::to_string(internal->getLine()) +
              shown(textOf(internal->getCause()));
  if (const HxCBlockSrcRef* block = ref->isBlock())
    result += indexIn(s.model.blocks, block->getBlock()) + "handle " +
              std::to_string(block->getBlockHandle());
  if (const HxCInputBlockSrcRef* input = ref->isInputBlock())
    result += "handle " + std::to_string(input->getBlockHandle());
  if (const HxCStateflowSrcRef* object = ref->isStateflow())
    result += indexIn(s.model.objects, object->getSfObject()) + "id " +
              std::to_string(object->getSfObjectId());
  if (const HxCDdSrcRef* dd = ref->isDd()) {
    dd->getDdPath(text);
    result += std::to_string(dd->getDdHandle()) + text.cstring();
  }
  return result;
}

// Result, the reference of the call, and the newest reference.
template <class Side, class Make>
std::vector<std::string> answersOf(Side& side, const std::vector<Call>& calls,
                                   Make make) {
  std::vector<std::string> answers;
  for (const Call& call : calls) {
    const std::size_t i = call.ref % side.count();
    const std::string result = (kRows[call.row].*make)(side, i, call);
    answers.push_back(result + "\n  ref " + shownRef(side, i) + "\n  newest " +
                      shownRef(side, side.count() - 1));
  }
  return answers;
}

}  // namespace

std::string differenceOfSrcRefs(const std::string& bytes, std::string* log) {
  Choices choices(bytes, log);
  Model model = randomModel(choices);
  if (model.refs.empty()) model.refs.emplace_back();  // calls need one
  std::vector<Call> calls;
  std::vector<std::string> described;
  choices.tell("\ncalls:");
  while (calls.empty() || (calls.size() < 30 && !choices.isEmpty())) {
    Call call;
    call.row = static_cast<std::size_t>(choices.byte()) % std::size(kRows);
    described.push_back("\n  " + std::to_string(calls.size() + 1) + " " +
                        kRows[call.row].name);
    choices.tell(described.back());
    call.ref = static_cast<std::size_t>(choices.below("ref", 256));
    call.other = static_cast<std::size_t>(choices.below("other", 256));
    call.isNull = choices.rarely("isNull", 6);
    call.number = choices.below("number", 8);
    call.line = choices.of("line", {0, 12, -2147483647 - 1});
    call.text = choices.text("text", 2, {u"a.cpp", u"\u0416", u" ", u"'"});
    call.cause = choices.text("cause", 2, {u"bad", u"\n", u"\u00E4"});
    calls.push_back(call);
  }
  LibrarySide library(model);
  const int next =
      library.untouched.getSrcRefId() + 1 - library.model.firstNumber;
  PlainSide plain(model, next);
  const auto answers = answersOf(library, calls, &Row::library);
  return firstDifference(described, answers,
                         answersOf(plain, calls, &Row::plain));
}

}  // namespace plain
