// Type macros, extended macros and keywords.
#include "plain/HX_PlainNames.h"

namespace plain {

const Type& Names::scalar(int type) const {
  const Type* found = &Model::at(m_Model.types, type);
  while (found->element != kNone)
    found = &Model::at(m_Model.types, found->element);
  return *found;
}

void Names::evaluateTypeNameMacro(Text& result, int type) {
  if (type == kNone) {
    result += u"_T";
    return;
  }
  const Type& t = scalar(type);
  if (t.unnamed != 0) return;
  if (t.isDerived) {
    if (t.origin != kNone) result += Model::at(m_Model.types, t.origin).cut;
  } else if (t.isBase) {
    result += t.cut;
  } else if (t.is64Bit) {
    result += t.isSigned ? u"I64" : u"U64";
  } else if (t.isNumerical) {
    if (t.hasCut)
      result += t.cut;
    else if (t.underlying != kNone)
      result += Model::at(m_Model.types, t.underlying).cut;
  } else {
    assertion();
  }
}

void Names::evaluateLongTypeMacro(Text& result, int type) {
  if (type == kNone) {
    result += u"__Type_";
    return;
  }
  const Type& t = scalar(type);
  Text text;
  if (t.unnamed != 0) {
    if (t.hasNameObject) text = t.name;
  } else if (t.isDerived || t.isBase || t.isNumerical) {
    text = t.name;
  } else {
    assertion();
  }
  result += cIdentifier(text);
}

void Names::evaluateBaseTypeMacro(Text& result, int type) {
  if (type == kNone) {
    result += u"__BaseType_";
    return;
  }
  const Type& t = scalar(type);
  const auto nameOr = [&](int other) {
    return other == kNone ? Text(u"_UnknownHXBaseType_")
                          : Model::at(m_Model.types, other).name;
  };
  Text text;
  if (t.unnamed != 0) {
  } else if (t.isBitfield) {
    text = nameOr(m_Model.bitfieldBase);
    if (text.empty()) text = nameOr(kNone);
  } else if (t.isDerived) {
    text = nameOr(t.origin);
  } else if (t.isBase) {
    text = t.name;
  } else if (t.isNumerical) {
    text = nameOr(t.origin);
  } else {
    assertion();
  }
  result += cIdentifier(text);
}

std::size_t Names::evaluateExtendedNameMacro(Text& result, Bits retained,
                                             Bits provisional, const Text& form,
                                             std::size_t pos, const Id& id,
                                             int type, int reportRef,
                                             bool suppressMessages) {
  const std::size_t close = form.find(')', pos + 2);
  if (close == Text::npos) {
    result += form.substr(pos);
    return form.size();
  }
  const Text name = form.substr(pos + 2, close - pos - 2);
  const std::string macro = "$" + narrow(name);
  std::vector<Text> known{
      u"Task",           u"ISR",          u"Msg",        u"Ctr",
      u"Event",          u"MsgVar",       u"PObj",       u"Section",
      u"Module",         u"FunctionName", u"PageNumber", u"DataVariantName",
      u"VariantItemName"};
  for (const Text kind : {u"Time", u"Period", u"Offset"}) {
    known.push_back(kind);
    for (const Text unit : {u"1us", u"10us", u"100us", u"1ms", u"10ms",
                            u"100ms", u"1s", u"1m", u"1h", u"1d"})
      known.push_back(kind + unit);
  }
  bool isKnown = false;
  for (const Text& text : known) isKnown = isKnown || text == name;
  if (name == u"Type") {
    if (!stays(result, retained, provisional, 0x80000, u"$(Type)"))
      evaluateLongTypeMacro(result, type);
  } else if (name == u"BaseType") {
    if (!stays(result, retained, provisional, 0x80000, u"$(BaseType)"))
      evaluateBaseTypeMacro(result, type);
  } else if (name == u"Component") {
    evaluateComponentMacro(result, id);
  } else {
    if (!suppressMessages)
      report(isKnown ? 1202 : 1203, 1, reportRef,
             "The " + macro + " name macro in the " +
                 narrow(id.getRawName(Id::eActiveName)) + " name template is " +
                 (isKnown ? "not supported here" : "unknown") +
                 ". It is ignored.");
    result += u"__" + name + u"_";
  }
  return name.size() + 3;
}

void Names::evaluateComponentMacro(Text& result, const Id& id) {
  const std::string failure =
      "The $(Component) name macro could not substitute";
  int variable = id.getDdSourceRef();
  if (variable == kNone && refOf(id.getSourceRef(), Ref::eDd) != nullptr)
    variable = id.getSourceRef();
  const Ref* const ref = refOf(variable, Ref::eDd);
  if (ref == nullptr) return report(1209, 1, variable, failure);
  std::string path = ddPath(m_Model, ref->handle);
  if (path.rfind("//DD0/Pool/Variables/", 0) != 0) return;
  path.erase(0, std::string("//DD0/Pool/").size());
  if (!m_Model.hasComponents) return report(1209, 1, variable, failure);
  std::string firstProperty, firstComponent;
  bool isFound = false;
  for (const Component& component : m_Model.components) {
    for (const Component::Property& property : component.relatedVariables) {
      if (path.rfind(property.path, 0) != 0) continue;
      if (!isFound) {
        isFound = true;
        firstProperty = property.name;
        firstComponent = component.name;
        result += wide(component.name);
        break;
      }
      report(1210, 2, variable,
             "The variable was referenced first through the RelatedVariables "
             "property " +
                 firstProperty + " of software component " + firstComponent +
                 " and second by the RelatedVariables property " +
                 property.name + " of software component " + component.name +
                 ".");
    }
  }
  if (!isFound) report(1209, 1, variable, failure);
}

void Names::boot() {
  m_Keywords.clear();
  for (const Text word :
       {u"auto",     u"break",  u"case",    u"char",   u"const",    u"continue",
        u"default",  u"do",     u"double",  u"else",   u"enum",     u"extern",
        u"float",    u"for",    u"goto",    u"if",     u"int",      u"long",
        u"register", u"return", u"short",   u"signed", u"sizeof",   u"static",
        u"struct",   u"switch", u"typedef", u"union",  u"unsigned", u"void",
        u"volatile", u"while"})
    m_Keywords[word] = eKeyword;
}

void Names::addToKeywordDict(const Text& word, tagHxEDictEntryType type) {
  m_Keywords[word] = type;
}

bool Names::isStringValidCVariableName(const Text& name) {
  if (name.empty()) return false;
  const auto found = m_Keywords.find(name);
  if (found == m_Keywords.end()) return isCIdentifier(name);
  const char* const kinds[] = {"C keyword ", "Base type name ",
                               "User data type name "};
  report(408 + found->second, 2, kNone,
         kinds[found->second] + narrow(name) + " used as identifier.");
  return false;
}

bool Names::isFileNameValid(const Text& name) {
  for (const char16_t c : name)
    if (!isIdentifierUnit(c) && c != '-') return false;
  return !name.empty();
}

bool Names::isFileNameValid(const Id& id) {
  return isFileNameValid(id.getCookedName(Id::eActiveName));
}

void Names::appendSuffix(Text& name, int index) {
  Text code(1, static_cast<char16_t>('a' + index % 26));
  for (int q = index / 26; q > 0; q /= 26) {
    --q;
    code += static_cast<char16_t>('a' + q % 26);
  }
  std::size_t length = name.size();
  if (m_Model.limitsNames && length + 1 + code.size() >= 31)
    length = 31 - code.size() - 1;
  name = name.substr(0, length) + u"_" + code;
}

}  // namespace plain
