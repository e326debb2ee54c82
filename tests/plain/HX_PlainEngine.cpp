// Expansion of templates, and the single-letter macros.
#include "plain/HX_PlainNames.h"
#include "plain/HX_PlainSrcRef.h"

namespace plain {

void Names::report(int row, int severity, int ref, const std::string& text) {
  std::string source;
  if (ref != kNone)
    source = narrow(toString(m_Model, Model::at(m_Model.refs, ref), u""));
  m_Messages.push_back(shownMessage(row, severity, text, ref, source));
}

// The reference if it is of this kind, else null.
const Ref* Names::refOf(int ref, Ref::Kind kind) const {
  if (ref == kNone) return nullptr;
  const Ref& found = Model::at(m_Model.refs, ref);
  return found.kind == kind ? &found : nullptr;
}

bool Names::createNameFromForm(Id& id, int type, Bits retained,
                               Bits provisional, bool suppressMessages) {
  m_NameComplete = true;
  if (id.getCookLevel() == Id::eFull) return m_NameComplete;
  const bool wasFormalActive = id.isFormalNameActive();
  const Text actual = id.getCookedName(Id::eActualName);
  const Text formal = id.getCookedName(Id::eFormalName);
  const bool hasR = actual == formal + u"$R" || actual == u"$R" + formal;
  if (actual != formal && !hasR) {
    id.activateFormalName();
    createSingleNameFromForm(id, type, retained, provisional, suppressMessages);
    id.activateActualName();
    createSingleNameFromForm(id, type, retained, provisional, suppressMessages);
  } else {
    id.activateFormalName();
    createSingleNameFromForm(id, type, retained, provisional, suppressMessages);
    const auto from = Id::eFormalName, to = Id::eActualName;
    id.setCookedName(id.getCookedName(Id::eActiveName), to);
    id.setIdentifierChangeable(id.getIdentifierChangeable(from) || hasR, to);
    id.setDollarLUsed(id.getDollarLUsed(from), to);
    id.setDollarEUsed(id.getDollarEUsed(from), to);
    id.setDollarNUsed(id.getDollarNUsed(from), to);
  }
  if (wasFormalActive)
    id.activateFormalName();
  else
    id.activateActualName();
  id.setCookLevel(Id::eFull);
  return m_NameComplete;
}

Text Names::getRootDollarI() {
  Text systemId;
  if (m_Model.rootDepth == 3) systemId = m_Model.contextId;
  if (systemId.empty()) systemId = m_Model.optionsId;
  return systemId;
}

Names::Context Names::contextOf(const Id& id) {
  Context c;
  c.ivBlock = id.getSourceIVBlock();
  c.srcRef = id.getSourceRef();
  if (c.srcRef == kNone && c.ivBlock != kNone)
    c.srcRef = Model::at(m_Model.ivBlocks, c.ivBlock).ref;
  c.reportRef = c.srcRef;
  c.systemId = getRootDollarI();
  const Ref* const blockRef = refOf(c.srcRef, Ref::eBlock);
  if (blockRef != nullptr && blockRef->target != kNone) {
    c.block = blockRef->target;
    const Block& own = Model::at(m_Model.blocks, c.block);
    if (own.isNamedThroughParent && own.parent != kNone) {
      c.srcRef = m_Model.blockRef(own.parent);
      c.block = own.parent;
    }
    c.systemId = m_Model.subsystem(c.block).systemId;
    const Block& block = Model::at(m_Model.blocks, c.block);
    if (block.isChart && block.chartState != kNone) {
      c.chartState = block.chartState;
      c.srcRef = m_Model.objectRef(c.chartState);
    }
  }
  const Ref* const objectRef = refOf(c.srcRef, Ref::eStateflow);
  if (objectRef != nullptr && objectRef->target != kNone) {
    c.object = objectRef->target;
    const Object& object = Model::at(m_Model.objects, c.object);
    c.block = object.block;
    c.chartState = object.chartState;
    if (c.chartState != kNone) {
      const int chart = Model::at(m_Model.objects, c.chartState).chart;
      c.systemId = Model::at(m_Model.charts, chart);
    } else if (c.block != kNone) {
      c.systemId = m_Model.subsystem(c.block).systemId;
    }
  }
  if (const Ref* dd = refOf(id.getDdSourceRef(), Ref::eDd)) {
    for (const DdObject& object : m_Model.dd)
      if (object.handle == dd->handle)
        c.ddName = wide(object.path.substr(object.path.rfind('/') + 1));
  }
  return c;
}

// One branch per macro, in the order of the test.
void Names::createSingleNameFromForm(Id& id, int type, Bits retained,
                                     Bits provisional, bool suppressMessages) {
  const auto active = Id::eActiveName;
  Text form = id.getCookedName(active);
  Text result;
  Context c = contextOf(id);
  const auto tell = [&](int row, const Text& macro) {
    if (suppressMessages) return;
    report(row, 1, c.reportRef,
           "The " + narrow(macro) + " name macro in the " +
               narrow(id.getRawName(active)) + " name template is " +
               (row == 1202 ? "not supported here" : "unknown") +
               ". It is ignored.");
  };
  if (form.empty()) {
    if (c.reportRef == kNone)
      assertion();
    else if (!suppressMessages)
      report(503, 1, c.reportRef, "A template name is empty.");
    form = refOf(c.srcRef, Ref::eStateflow) != nullptr ? u"$C_$O" : u"$S_$B";
  }
  std::size_t pos = 0;
  while (pos < form.size()) {
    const std::size_t d = form.find('$', pos);
    if (d == Text::npos) {
      result += form.substr(pos);
      break;
    }
    result += form.substr(pos, d - pos);
    pos = d;
    const Text letter = sub(form, d + 1, d + 1);
    const char16_t l = letter.empty() ? u'\0' : letter[0];
    const auto isKept = [&](Bits bit) {
      return stays(result, retained, provisional, bit, u"$" + letter);
    };
    if (l == 'L') {
      if (!isKept(0x1))
        evaluateLabelMacro(result, id.getSignalLabel(), c.block);
      id.setDollarLUsed(true, active);
    } else if (l == 'B') {
      if (!isKept(0x2)) evaluateBlockNameMacro(result, c.block, c.ivBlock);
    } else if (l == 'S') {
      if (!isKept(0x4)) evaluateSystemNumberMacro(result, c);
    } else if (l == 'I') {
      if (!isKept(0x8)) result += c.systemId;
    } else if (l == 'M') {
      if (!isKept(0x10)) result += m_Model.modelName;
    } else if (l == 'N') {
      if (!isKept(0x20)) result += m_Model.subsystemName;
      id.setDollarNUsed(true, active);
    } else if (l == 'H') {
      if (!isKept(0x40))
        result += c.object == kNone
                      ? u"_H"
                      : Model::at(m_Model.objects, c.object).hierarchy;
    } else if (l == 'O') {
      if (!isKept(0x80)) evaluateSFObjectNameMacro(result, c.object);
    } else if (l == 'C') {
      if (!isKept(0x100)) evaluateSFObjectIDMacro(result, c);
    } else if (l == 'D') {
      evaluateDollarD(result, retained, provisional, id, c);
    } else if (l == 'X') {
      Text value;
      id.getDollarXValue(value);
      if (!isKept(0x800)) result += value.empty() ? u"_X" : value;
    } else if (l == 'T') {
      if (!isKept(0x400)) evaluateTypeNameMacro(result, type);
    } else if (l == '$') {
      result += u"$";
    } else if (l == 'R') {
      if (!isKept(0x1000)) c.isChangeable = true;
    } else if (l == '(') {
      pos += evaluateExtendedNameMacro(result, retained, provisional, form, pos,
                                       id, type, c.reportRef, suppressMessages);
      continue;
    } else {
      result += u"$" + letter;
      pos += 2;
      if (l == 'P') {
        tell(1202, u"'$P'");
      } else if (l == 'V' || l == 'v') {
        tell(1202, u"'$V' and '$v'");
      } else if (l == 'F' || l == 'f') {
        tell(1202, u"'$F' and '$f'");
      } else if (l == 'E') {
        const std::size_t length = findDollarELength(form, pos);
        if (length > 0) result += cIdentifier(form.substr(pos, length));
        pos += length;
        tell(1202, u"'$E'");
      } else {
        tell(1203, u"'$" + letter + u"'");
      }
      continue;
    }
    pos += 2;
  }
  id.setCookedName(result, active);
  if (c.isChangeable) id.setIdentifierChangeable(true, active);
}

std::size_t Names::findDollarELength(const Text& text, std::size_t start) {
  if (start >= text.size() || text[start] != '(') return 0;
  std::size_t count = 1;
  int depth = 1;
  bool isQuoted = false;
  while (start + count < text.size() && depth > 0) {
    const char16_t c = text[start + count];
    if (c == '\'')
      isQuoted = !isQuoted;
    else if (!isQuoted)
      depth += c == '(' ? 1 : c == ')' ? -1 : 0;
    ++count;
  }
  return count;
}

bool Names::stays(Text& result, Bits retained, Bits provisional, Bits bit,
                  const Text& macro) {
  if ((provisional & bit) != 0) m_NameComplete = false;
  if ((retained & bit) == 0) return false;
  result += macro;
  m_NameComplete = false;
  return true;
}

void Names::evaluateLabelMacro(Text& result, const Text& label, int block) {
  Text text;
  if (!label.empty())
    text = cIdentifier(trimmed(withoutAngleBrackets(trimmed(label))));
  if (text.empty() && block != kNone)
    text = cIdentifier(Model::at(m_Model.blocks, block).name);
  result += text;
}

void Names::evaluateBlockNameMacro(Text& result, int block, int ivBlock) {
  if (block != kNone)
    result += cIdentifier(Model::at(m_Model.blocks, block).name);
  else if (ivBlock != kNone)
    result += cIdentifier(Model::at(m_Model.ivBlocks, ivBlock).rawName);
  else
    result += u"_B";
}

void Names::evaluateSystemNumberMacro(Text& result, Context& c) {
  c.isChangeable = true;
  if (c.block != kNone) {
    const unsigned int number = m_Model.subsystem(c.block).number;
    const bool isNegative = number > 0x7FFFFFFF;
    result += u"S" + c.systemId + (isNegative ? u"0" : decimal(number));
  } else if (!c.systemId.empty()) {
    result += u"S" + c.systemId + u"0";
  } else {
    result += u"_S";
  }
}

void Names::evaluateSFObjectIDMacro(Text& result, Context& c) {
  if (c.object == kNone) {
    result += u"_C";
    return;
  }
  c.isChangeable = true;
  const int number = Model::at(m_Model.objects, c.object).number;
  result += u"C" + c.systemId + decimal(number);
}

void Names::evaluateSFObjectNameMacro(Text& result, int object) {
  result += object == kNone
                ? u"_O"
                : cIdentifier(Model::at(m_Model.objects, object).name);
}

void Names::evaluateDollarD(Text& result, Bits retained, Bits provisional,
                            const Id& id, Context& c) {
  if ((provisional & 0x200) != 0) {
    result += u"_D";
    m_NameComplete = false;
  } else if ((retained & 0x200) != 0) {
    result += u"$D";
    m_NameComplete = false;
  } else if (id.getDdSourceRef() != kNone) {
    result += c.ddName.empty() ? u"_D" : c.ddName;
  } else if (c.object != kNone) {
    result += u"DD_";
    evaluateSFObjectIDMacro(result, c);
    result += u"_";
    evaluateSFObjectNameMacro(result, c.object);
  } else if (c.block != kNone) {
    result += u"DD_";
    evaluateSystemNumberMacro(result, c);
    result += u"_";
    evaluateBlockNameMacro(result, c.block, c.ivBlock);
  } else {
    result += u"_D";
  }
}

}  // namespace plain
