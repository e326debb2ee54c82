#include "plain/HX_PlainSrcRef.h"

namespace plain {

namespace {

Text fullPath(const Model& model, int block) {
  const Block& own = Model::at(model.blocks, block);
  if (own.parent == kNone) return own.name;
  const Text above = fullPath(model, own.parent);
  return above.empty() ? own.name : above + u"/" + own.name;
}

std::string readablePath(const std::string& path) {
  const std::string marker = "CGTmpData/hxscript_";
  const std::size_t at = path.find(marker);
  if (at == std::string::npos) return path;
  const std::string tail = path.substr(at + marker.size());
  const std::size_t first = tail.find('/');
  const std::size_t second = tail.find('/', first + 1);
  const std::size_t last = second == std::string::npos ? first : second;
  return "User script object " + tail.substr(last + 1) + " of block " +
         tail.substr(0, first);
}

// Names from the generated system down to the block. A step fails without a
// generated system, and at an object that is no block or was met before.
Text climbed(const Model& model, int block, Text text) {
  std::vector<int> met;
  while (block != kNone && model.system != kNone &&
         std::count(met.begin(), met.end(), block) == 0) {
    const InputBlock& own = Model::at(model.inputs, block);
    text = met.empty() ? own.name : own.name + u"/" + text;
    met.push_back(block);
    if (block == model.system) break;
    block = own.parent;
  }
  return withBlanks(text);
}

}  // namespace

Text toString(const Model& model, const Ref& ref, const Text& before) {
  const bool isEmpty = ref.target == kNone;
  switch (ref.kind) {
    case Ref::eOther:
      return before + u"Unknown source";
    case Ref::eInternal:
      return u"Internal: Module: '" + ref.file + u"', Line: " +
             decimal(ref.line) + u" Reason: " + ref.cause;
    case Ref::eBlock:
      return isEmpty ? Text() : withBlanks(fullPath(model, ref.target));
    case Ref::eStateflow:
      return isEmpty ? Text() : Model::at(model.objects, ref.target).sfName;
    case Ref::eDd:
      return wide(readablePath(ddPath(model, ref.handle)));
    case Ref::eInput:
      return climbed(model, ref.target, before);
  }
  return Text();
}

double blockHandle(const Model& model, const Ref& ref) {
  if (ref.target == kNone) return -1;
  return ref.kind == Ref::eBlock ? Model::at(model.blocks, ref.target).handle
                                 : Model::at(model.inputs, ref.target).handle;
}

Comparison compared(const Model& model, const Ref* a, const Ref* b) {
  const auto isDd = [](const Ref* ref) {
    return ref != nullptr && ref->kind == Ref::eDd;
  };
  const auto isFromScript = [&](const Ref* ref) {
    return ddPath(model, ref->handle).find("CGTmpData") != std::string::npos;
  };
  Comparison c;
  c.bothFromDD = isDd(a) && isDd(b);
  c.bothFromDDButDifferent = c.bothFromDD && a->handle != b->handle;
  c.bothFromUserScript = c.bothFromDD && isFromScript(a) && isFromScript(b);
  c.differentNotFromUserScript =
      c.bothFromDDButDifferent && !isFromScript(a) && !isFromScript(b);
  if (c.bothFromDD) return c;
  c.which = isDd(b) ? 1 : isDd(a) ? 0 : -1;
  c.onlyOneFromDD = c.which >= 0;
  return c;
}

}  // namespace plain
