// Random models. Facts that one fixture has in common differ here: parent and
// block, block and chart, formal and actual, own and inherited.
#include "plain/HX_PlainCase.h"

namespace plain {

namespace {

Text nameFrom(Choices& c, const char* what) {
  return c.text(what, 3,
                {u"a", u"B", u"1", u"_", u" ", u"x y", u"-", u"<b>", u"$N",
                 u"\n", u"/", u"\u00FC", u"\u0416", u":", u"abcdefghijklmno"});
}
// No character that the dictionary or a char* would change.
Text narrowFrom(Choices& c, const char* what) {
  return c.text(what, 2, {u"a", u"B", u"7", u"_", u" ", u"-", u"$x", u":"});
}
int idOf(std::size_t i) { return static_cast<int>(i); }

Type typeFrom(Choices& c, const std::vector<Type>& before) {
  Type t;
  t.name = nameFrom(c, "type");
  t.hasCut = c.flag("hasCut");
  t.unnamed = c.rarely("isUnnamed", 4) ? 1 + c.below("unnamed", 2) : 0;
  t.hasNameObject = c.flag("hasNameObject");
  t.isBitfield = c.rarely("isBitfield", 4);
  t.isBase = c.flag("isBase");
  t.isNumerical = c.flag("isNumerical");
  t.is64Bit = t.isNumerical && c.flag("is64Bit");
  t.isSigned = c.flag("isSigned");
  t.element = c.rarely("isArray", 4) ? c.index("element", before.size()) : -1;
  t.origin = c.index("origin", before.size());
  t.underlying = c.index("underlying", before.size());
  t.isDerived = c.flag("isDerived");
  // Base types have a cut, and so has the origin of a derived type.
  t.hasCut = t.hasCut || t.isBase;
  if (t.isDerived && t.origin != kNone && !Model::at(before, t.origin).hasCut)
    t.origin = kNone;
  if (t.isNumerical && t.underlying == kNone) t.hasCut = true;
  if (t.hasCut) t.cut = nameFrom(c, "cut");
  return t;
}

Ref refFrom(Choices& c, const Model& m) {
  Ref ref;
  ref.kind = c.of("kind", {Ref::eDd, Ref::eDd, Ref::eBlock, Ref::eStateflow,
                           Ref::eInternal, Ref::eOther, Ref::eInput});
  switch (ref.kind) {
    case Ref::eDd: {
      const int object = c.index("dd", m.dd.size());
      ref.handle =
          object == kNone ? kUnknownHandle : Model::at(m.dd, object).handle;
      ref.target = object;
      break;
    }
    case Ref::eBlock:
      ref.target = c.index("block", m.blocks.size());
      break;
    case Ref::eInternal:
      ref.file = nameFrom(c, "file");
      ref.line = c.of("line", {12, -1});
      ref.cause = nameFrom(c, "cause");
      break;
    case Ref::eInput:
      ref.target = c.index("input", m.inputs.size());
      break;
    default:
      break;
  }
  return ref;
}

void addBlocksAndObjects(Choices& c, Model& m) {
  m.charts.resize(static_cast<std::size_t>(c.below("charts", 4)));
  for (Text& chart : m.charts) chart = nameFrom(c, "chartId");
  m.blocks.resize(static_cast<std::size_t>(c.below("\n  blocks", 6)));
  m.objects.resize(static_cast<std::size_t>(c.below("objects", 5)));
  std::vector<int> states{kNone};
  for (std::size_t i = 0; i < m.objects.size(); ++i) {
    Object& o = m.objects[i];
    c.tell("\n  object " + std::to_string(i));
    o.id = c.of("id", {1, 42, -5});
    o.number = c.of("number", {0, 7, -3, 2147483647});
    o.name = narrowFrom(c, "name");
    o.sfName = nameFrom(c, "sfName");
    o.hierarchy = nameFrom(c, "hierarchy");
    o.block = c.index("block", m.blocks.size());
    o.chart = c.index("chart", m.charts.size());
    if (o.chart != kNone) states.push_back(idOf(i));
  }
  const auto state = [&] {
    return Model::at(states, c.below("state", idOf(states.size())));
  };
  for (Object& o : m.objects) o.chartState = state();
  for (std::size_t i = 0; i < m.blocks.size(); ++i) {
    Block& b = m.blocks[i];
    c.tell("\n  block " + std::to_string(i));
    b.name = nameFrom(c, "name");
    b.parent = c.index("parent", i);
    b.isSubsystem = c.flag("isSubsystem");
    b.systemId = b.isSubsystem ? nameFrom(c, "systemId") : u"";
    if (b.isSubsystem)
      b.number = c.of("number", {3u, 0u, 0xFFFFFFFFu, 0x80000000u, 12345u});
    b.isNamedThroughParent = c.flag("isNamedThroughParent");
    b.isChart = c.flag("isChart");
    if (b.isChart) b.chartState = state();
    b.handle = c.of("handle", {-1.0, 17.25, 3.0});
  }
}

void addDictionary(Choices& c, Model& m) {
  m.dd.resize(static_cast<std::size_t>(c.below("\n  dd", 4)));
  for (DdObject& object : m.dd) {
    const char* const paths[] = {"//DD0/Pool/Variables/Ctrl/speed",
                                 "//DD0/Pool/Variables/x",
                                 "//DD0/Pool/Variables",
                                 "//DD0/Pool/CGTmpData/x",
                                 "//DD0/CGTmpData/hxscript_C/3/g/h",
                                 "//DD0/CGTmpData/hxscript_C/g"};
    object.path = paths[c.below("path", 6)] + narrow(narrowFrom(c, "more"));
  }
  m.hasComponents = c.flag("hasComponents");
  if (m.hasComponents)
    m.components.resize(static_cast<std::size_t>(c.below("components", 4)));
  for (std::size_t i = 0; i < m.components.size(); ++i) {
    Component& component = m.components[i];
    component.name = "C" + std::to_string(i) + narrow(narrowFrom(c, "more"));
    component.relatedVariables.resize(
        static_cast<std::size_t>(c.below("properties", 4)));
    for (Component::Property& property : component.relatedVariables) {
      const char* const paths[] = {
          "Variables/Ctrl",       "Variables/", "Other", "",
          "Variables/Ctrl/speed", "ariables"};
      property.name = narrow(narrowFrom(c, "property"));
      property.path = paths[c.below("refers", 6)];
    }
  }
}

}  // namespace

Model randomModel(Choices& c) {
  Model m;
  m.modelName = nameFrom(c, "model");
  m.subsystemName = nameFrom(c, "subsystem");
  m.rootDepth = c.below("rootDepth", 4);
  m.contextId = nameFrom(c, "contextId");
  m.optionsId = nameFrom(c, "optionsId");
  m.limitsNames = c.flag("limitsNames");
  addBlocksAndObjects(c, m);
  addDictionary(c, m);
  const auto types = static_cast<std::size_t>(c.below("\n  types", 5));
  while (m.types.size() < types) m.types.push_back(typeFrom(c, m.types));
  m.bitfieldBase = c.index("bitfieldBase", types);
  m.symbols.resize(static_cast<std::size_t>(c.below("\n  symbols", 3)));
  for (Symbol& symbol : m.symbols)
    symbol = {nameFrom(c, "name"), 1 + c.below("kind", 4),
              narrowFrom(c, "dollarX"), c.index("type", types)};
  m.inputs.resize(static_cast<std::size_t>(c.below("\n  inputs", 4)));
  for (std::size_t i = 0; i < m.inputs.size(); ++i) {
    const Text number = decimal(idOf(i));
    m.inputs[i].name = nameFrom(c, "name") + number;
    m.inputs[i].parent = c.index("parent", m.inputs.size());
  }
  m.system = c.index("system", m.inputs.size());
  for (std::size_t i = 0; i < m.blocks.size(); ++i) {
    m.refs.emplace_back();
    m.refs.back().kind = Ref::eBlock;
    m.refs.back().target = idOf(i);
  }
  for (std::size_t i = 0; i < m.objects.size(); ++i) {
    m.refs.emplace_back();
    m.refs.back().kind = Ref::eStateflow;
    m.refs.back().target = idOf(i);
  }
  for (int more = c.below("\n  refs", 5); more > 0; --more)
    m.refs.push_back(refFrom(c, m));
  for (std::size_t i = 0; i < m.refs.size(); ++i) m.refs[i].id = idOf(i);
  m.ivBlocks.resize(static_cast<std::size_t>(c.below("\n  ivBlocks", 3)));
  for (IvBlock& block : m.ivBlocks)
    block = {nameFrom(c, "rawName"), c.index("ref", m.refs.size())};
  return m;
}

}  // namespace plain
