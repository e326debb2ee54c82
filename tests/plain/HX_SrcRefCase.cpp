// Random calls of source references, sets and server on both sides.
#include "SourceRef/HxCSrcRefCompare.h"
#include "SourceRef/HxCSrcRefServer.h"
#include "plain/HX_PlainCase.h"
#include "plain/HX_PlainSrcRef.h"
#include "platform/dump/HX_Dump.h"

namespace plain {

namespace {

constexpr std::size_t kSets = 3;

enum Op {
  eMake,
  eCopy,
  eAssign,
  eClone,
  eAdd,
  eSetLocation,
  eSetFile,
  eSetLine,
  eSetCause,
  eSetBlock,
  eAddSet,
  eAssignSet,
  eCopySet,
  eClear,
  eMakeSet,
  eServerRef,
  eServerShutdown,
  eSpecific,
  eCompare,
  eDump,
  eOpCount
};
const char* const kOpNames[] = {"make",
                                "copy",
                                "assign",
                                "clone",
                                "addSrcRef",
                                "setLocation",
                                "setFile",
                                "setLine",
                                "setCause",
                                "setBlock",
                                "addSrcRef of a set",
                                "assign set",
                                "copy set",
                                "clear",
                                "make set",
                                "getSrcRef",
                                "shutdown",
                                "getSpecificSrcRefFromSet",
                                "compare",
                                "dump"};
static_assert(std::size(kOpNames) == eOpCount);

// An index may be too large: every use takes the rest.
struct Call {
  int op = 0, ref = 0, other = 0, set = 0, from = 0, number = 0, line = 0;
  bool isNull = false;
  Text text, cause;
};

Call callFrom(Choices& c) {
  Call call;
  call.op = c.below("op", eOpCount);
  c.tell(std::string("\n  ") + kOpNames[call.op]);
  call.ref = c.below("ref", 16);
  call.other = c.below("other", 16);
  call.isNull = c.rarely("isNull", 6);
  call.set = c.below("set", kSets);
  call.from = c.below("from", kSets);
  call.number = c.below("number", 8);
  call.line = c.of("line", {0, 12, -2147483647 - 1});
  call.text = c.text("text", 2, {u"a.cpp", u"\u0416", u" ", u"'"});
  call.cause = c.text("cause", 2, {u"bad", u"\n", u"\u00E4"});
  return call;
}

const char* yes(bool holds) { return holds ? "1" : "0"; }

// The plain side.
class PlainSide {
 public:
  PlainSide(const Model& m, int next) : model(m), refs(m.refs) {
    maker.next = next;
  }

  std::size_t count() const { return refs.size(); }
  std::string resultOf(const Call& call) {
    const std::size_t i = call.ref % count();
    const Ref* const a = call.isNull ? nullptr : &refs[i];
    const Ref* const b = &refs[call.other % count()];
    RefSet& set = sets[call.set];
    const int element = call.isNull ? kNone : static_cast<int>(i);
    const bool isOwn = i < model.blocks.size() + model.objects.size();
    switch (call.op) {
      case eMake:
        refs.push_back(made(call));
        break;
      case eCopy:
        refs.push_back(maker.copy(refs[i]));
        break;
      case eAssign:
        if (!isOwn && b->kind == refs[i].kind) refs[i] = Ref(*b);
        break;
      case eClone:
        refs.push_back(maker.clone(refs[i]));
        break;
      case eSetLocation:
      case eSetFile:
      case eSetLine:
      case eSetCause:
        if (refs[i].kind != Ref::eInternal) break;
        if (call.op == eSetCause) refs[i].cause = call.cause;
        if (call.op == eSetLocation || call.op == eSetFile)
          refs[i].file = call.text;
        if (call.op == eSetLocation || call.op == eSetLine)
          refs[i].line = call.line;
        break;
      case eSetBlock:
        if (!isOwn && refs[i].kind == Ref::eBlock)
          refs[i].target = blockOf(call);
        break;
      case eAdd:
        add(set, element);
        break;
      case eAddSet:
        for (const int ref : RefSet(sets[call.from])) add(set, ref);
        break;
      case eAssignSet:
      case eCopySet:
        set = RefSet(sets[call.from]);
        break;
      case eClear:
        set.clear();
        break;
      case eMakeSet:
        set.clear();
        add(set, element);
        break;
      case eServerRef:
        refs.push_back(maker.internal());
        break;
      case eServerShutdown:
        return "11";
      case eSpecific: {
        Specific s = specific(refs, call.isNull ? RefSet() : set);
        const int untouched = -2;
        return std::to_string((call.number & 1) != 0 ? s.block : untouched) +
               " " + std::to_string((call.number & 2) != 0 ? s.dd : untouched) +
               " " +
               std::to_string((call.number & 4) != 0 ? s.other : untouched);
      }
      case eCompare: {
        const Comparison c = compared(model, a, b);
        return std::string(yes(c.bothFromDD)) + yes(c.bothFromDDButDifferent) +
               yes(c.onlyOneFromDD) + yes(c.bothFromUserScript) +
               yes(c.differentNotFromUserScript) + std::to_string(c.which);
      }
      case eDump:
        return "open HxCSrcRef; Source: " +
               shown(toString(model, refs[i], u"")) + " 0; close";
      default:
        break;
    }
    return "";
  }

  std::string shownRef(std::size_t i) const {
    const Ref& ref = refs[i];
    const char* const kinds[] = {"s", "si", "sb", "sc", "sd", "sn"};
    std::string result = std::to_string(ref.id) + kinds[ref.kind] + " " +
                         shown(toString(model, ref, u"a\nb"));
    if (ref.kind == Ref::eInternal)
      result += shown(ref.file) + std::to_string(ref.line) + shown(ref.cause);
    if (ref.kind == Ref::eBlock)
      result += std::to_string(ref.target) + " " +
                std::to_string(blockHandle(model, ref));
    if (ref.kind == Ref::eStateflow)
      result += std::to_string(ref.target) + " " +
                std::to_string(ref.target == kNone
                                   ? -1
                                   : Model::at(model.objects, ref.target).id);
    if (ref.kind == Ref::eDd)
      result += std::to_string(ref.handle) + ddPath(model, ref.handle);
    if (ref.kind == Ref::eInput)
      result += std::to_string(blockHandle(model, ref));
    return result;
  }
  std::string shownSet(int i) const {
    std::string refsOf;
    for (const int ref : sets[i]) refsOf += std::to_string(ref) + " ";
    const int first = sets[i].empty() ? kNone : sets[i][0];
    return std::to_string(sets[i].size()) + " " + std::to_string(first) + ": " +
           refsOf + "| " + refsOf + "-1 | " + refsOf + "-1 | ";
  }

 private:
  int blockOf(const Call& call) const {
    const int count = static_cast<int>(model.blocks.size());
    return call.number % (count + 1) - 1;
  }
  Ref made(const Call& call) {
    Ref ref;
    switch (call.number) {
      case 0:
        return maker.made(ref);
      case 1:
      case 2:
      case 3:
        ref = maker.internal();
        if (call.number > 1) ref.file = call.text;
        if (call.number > 1) ref.line = call.line;
        if (call.number > 2) ref.cause = call.cause;
        return ref;
      case 4:
      case 5:
        ref.kind = Ref::eDd;
        ref.handle = call.number == 4 ? 0 : kUnknownHandle;
        return maker.made(ref);
      case 6:
        ref.kind = Ref::eStateflow;
        return maker.made(ref);
      default:
        ref.kind = Ref::eInput;
        return maker.made(ref);
    }
  }

  const Model& model;
  std::vector<Ref> refs;
  RefSet sets[kSets];
  RefMaker maker;
};

// Sections and entries as text.
class TextDump : public HX_Dump {
 public:
  explicit TextDump(const HxCSrcRef* ref) : m_pRef(ref) {}
  void openObject(const HX_Dumpable* object, const KyCXString& name) override {
    text += object == m_pRef ? "open " : "open another ";
    text += name.cstring();
  }
  void writeEntry(const KyCXString& label, const KyCXString& value,
                  int level) override {
    text += std::string("; ") + label.cstring() + " " + shown(textOf(value)) +
            " " + std::to_string(level);
  }
  void closeObject(const HX_Dumpable* object) override {
    text += object == m_pRef ? "; close" : "; close another";
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
void assign(const T* to, const T* from) {
  if (to != nullptr && from != nullptr) *const_cast<T*>(to) = *from;
}

// REQUIRES for an effect: references of the same class.
void assignRef(const HxCSrcRef* to, const HxCSrcRef* from) {
  assign(to->isBlock(), from->isBlock());
  assign(to->isStateflow(), from->isStateflow());
  assign(to->isDd(), from->isDd());
  assign(to->isInternal(), from->isInternal());
  assign(to->isInputBlock(), from->isInputBlock());
  const auto isOther = [](const HxCSrcRef* ref) {
    return !ref->isBlock() && !ref->isStateflow() && !ref->isDd() &&
           !ref->isInternal() && !ref->isInputBlock();
  };
  if (isOther(to) && isOther(from)) assign(to, from);
}

class LibrarySide {
 public:
  explicit LibrarySide(Model& m) : model(m) {
    for (std::size_t i = 0; i < m.refs.size(); ++i)
      m.refs[i].id = model.refs[i]->getSrcRefId() - model.firstNumber;
  }

  std::size_t count() const { return model.refs.size(); }
  std::string resultOf(const Call& call) {
    const std::size_t i = call.ref % count();
    const HxCSrcRef* const ref = model.refs[i];
    const HxCSrcRef* const a = call.isNull ? nullptr : ref;
    const HxCSrcRef* const b = model.refs[call.other % count()];
    HxCSrcRefSet& set = sets[call.set];
    const bool isOwn = i < model.blocks.size() + model.objects.size();
    auto* const internal = const_cast<HxCInternalSrcRef*>(ref->isInternal());
    auto* const block = const_cast<HxCBlockSrcRef*>(ref->isBlock());
    switch (call.op) {
      case eMake:
        own(made(call));
        break;
      case eCopy:
        own(copied(ref));
        break;
      case eAssign:
        if (!isOwn) assignRef(ref, b);
        break;
      case eClone:
        own(ref->clone());
        break;
      case eSetLocation:
        if (internal) internal->setLocation(kyText(call.text), call.line);
        break;
      case eSetFile:
        if (internal) internal->setFile(kyText(call.text));
        break;
      case eSetLine:
        if (internal) internal->setLine(call.line);
        break;
      case eSetCause:
        if (internal) internal->setCause(kyText(call.cause));
        break;
      case eSetBlock:
        if (block && !isOwn) block->setBlock(blockOf(call));
        break;
      case eAdd:
        set.addSrcRef(a);
        break;
      case eAddSet:
        set.addSrcRef(sets[call.from]);
        break;
      case eAssignSet:
        set = sets[call.from];
        break;
      case eCopySet:
        set = HxCSrcRefSet(sets[call.from]);
        break;
      case eClear:
        set.clear();
        break;
      case eMakeSet:
        set = HxCSrcRefSet(a);
        break;
      case eServerRef:
        model.refs.push_back(server.getSrcRef());
        break;
      case eServerShutdown:
        return std::string(yes(server.shutdown())) + yes(server.boot());
      case eSpecific: {
        const HxCSrcRef* found[] = {&untouched, &untouched, &untouched};
        const auto place = [&](int k) {
          return (call.number >> k & 1) != 0 ? &found[k] : nullptr;
        };
        HxCSrcRefServer::getSpecificSrcRefFromSet(call.isNull ? nullptr : &set,
                                                  place(0), place(1), place(2));
        return std::to_string(model.indexOf(found[0])) + " " +
               std::to_string(model.indexOf(found[1])) + " " +
               std::to_string(model.indexOf(found[2]));
      }
      case eCompare: {
        const HxCSrcRefCompare c;
        int which = 7;
        const bool onlyOne = c.onlyOneFromDD(a, b, which);
        return std::string(yes(c.bothFromDD(a, b))) +
               yes(c.bothFromDDButDifferent(a, b)) + yes(onlyOne) +
               yes(c.bothFromUserScript(a, b)) +
               yes(c.differentDdSrcRefNotFromUserScript(a, b)) +
               std::to_string(which);
      }
      case eDump: {
        TextDump dump(ref);
        if (const_cast<HxCSrcRef*>(ref)->dump(&dump, true) != &dump)
          return "another dump";
        return dump.text;
      }
      default:
        break;
    }
    return "";
  }

  std::string shownRef(std::size_t i) const {
    const HxCSrcRef* const ref = model.refs[i];
    KyCXString text("a\nb");
    ref->toString(text);
    std::string result = std::to_string(ref->getSrcRefId() - model.firstNumber);
    if (ref->isSrcRef() == ref) result += 's';
    if (ref->isInternal() == ref) result += 'i';
    if (ref->isBlock() == ref) result += 'b';
    if (ref->isStateflow() == ref) result += 'c';
    if (ref->isDd() == ref) result += 'd';
    if (ref->isInputBlock() == ref) result += 'n';
    if (ref->isModule() != nullptr) result += 'm';
    result += " " + shown(textOf(text));
    if (const HxCInternalSrcRef* internal = ref->isInternal())
      result += shown(textOf(internal->getFile())) +
                std::to_string(internal->getLine()) +
                shown(textOf(internal->getCause()));
    if (const HxCBlockSrcRef* block = ref->isBlock())
      result += std::to_string(indexIn(model.blocks, block->getBlock())) + " " +
                std::to_string(block->getBlockHandle());
    if (const HxCStateflowSrcRef* object = ref->isStateflow())
      result += std::to_string(indexIn(model.objects, object->getSfObject())) +
                " " + std::to_string(object->getSfObjectId());
    if (const HxCDdSrcRef* dd = ref->isDd()) {
      KyCXString path("before");
      dd->getDdPath(path);
      result += std::to_string(dd->getDdHandle()) + path.cstring();
    }
    if (const HxCInputBlockSrcRef* input = ref->isInputBlock())
      result += std::to_string(input->getBlockHandle());
    return result;
  }

  // All answers of a set: one walk of forEach, two walks of an iterator.
  std::string shownSet(int i) const {
    const HxCSrcRefSet& set = sets[i];
    std::string result = std::to_string(set.getSrcRefCnt()) + " " +
                         std::to_string(model.indexOf(set.getASrcRef())) + ": ";
    const auto tell = [&](const HxCSrcRef* ref) {
      result += std::to_string(model.indexOf(ref)) + " ";
    };
    set.forEach(tell);
    result += "| ";
    const std::unique_ptr<HX_Iterator<const HxCSrcRef*>> it(
        set.createIterator());
    for (int walk = 0; walk < 2; ++walk, it->first()) {
      for (; !it->isDone(); it->next()) tell(it->currentItem());
      it->next();
      try {
        tell(it->currentItem());
      } catch (int thrown) {
        result += std::to_string(thrown) + " | ";
      }
    }
    return result;
  }

  LibraryModel model;

 private:
  template <class All, class T>
  static int indexIn(const All& all, const T* object) {
    for (std::size_t i = 0; i < all.size(); ++i)
      if (all[i].get() == object) return static_cast<int>(i);
    return kNone;
  }
  HX_Block* blockOf(const Call& call) {
    const int count = static_cast<int>(model.blocks.size());
    return entry(model.blocks, call.number % (count + 1) - 1);
  }
  void own(HxCSrcRef* ref) {
    m_Owned.emplace_back(ref);
    model.refs.push_back(ref);
  }
  HxCSrcRef* made(const Call& call) {
    const KyCXString file = kyText(call.text), cause = kyText(call.cause);
    switch (call.number) {
      case 0:
        return new HxCSrcRef();
      case 1:
        return new HxCInternalSrcRef();
      case 2:
        return new HxCInternalSrcRef(file, call.line);
      case 3:
        return new HxCInternalSrcRef(file, call.line, cause);
      case 4:
        return new HxCDdSrcRef();
      case 5:
        return new HxCDdSrcRef(kUnknownHandle);
      case 6:
        return new HxCStateflowSrcRef();
      default:
        return new HxCInputBlockSrcRef(*model.inputs.back());
    }
  }

  const HxCSrcRef untouched;
  HxCSrcRefServer server;
  HxCSrcRefSet sets[kSets];
  std::deque<std::unique_ptr<HxCSrcRef>> m_Owned;
};

// Result, the references of the call, the newest reference, and the set.
template <class Side>
std::vector<std::string> answersOf(Side& side, const std::vector<Call>& calls) {
  std::vector<std::string> answers;
  for (const Call& call : calls) {
    const std::size_t ref = call.ref % side.count();
    answers.push_back(side.resultOf(call) + "\n   ref " + side.shownRef(ref) +
                      "\n   newest " + side.shownRef(side.count() - 1) +
                      "\n   set " + side.shownSet(call.set));
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
    calls.push_back(callFrom(choices));
    described.push_back(std::to_string(calls.size()) + " " +
                        kOpNames[calls.back().op]);
  }
  LibrarySide library(model);
  const int next = HxCSrcRef().getSrcRefId() + 1 - library.model.firstNumber;
  PlainSide plain(model, next);
  const auto libraryAnswers = answersOf(library, calls);
  return firstDifference(described, libraryAnswers, answersOf(plain, calls));
}

}  // namespace plain
