// Checks a document against the schema while the text is read, and passes the
// values on to the bindings.
//
// A frame per open list or object; no recursion. A fault of a value does not
// end the reading: the value is left out, with all parts.
#include <algorithm>
#include <charconv>

#include "host/model/HX_Document.h"
#include "host/model/HX_ModelReading.h"
#include "host/model/HX_Schema.h"

namespace {

/// The schema with the bindings of all readers.
HX_Schema boundSchema() {
  HX_Schema schema(kHxModelSchema);
  std::map<std::string_view, const HX_FieldBinding*> rows;
  for (const HX_Bindings& bindings :
       {HX_OptionBindings(), HX_SourceBindings(), HX_TypeBindings(),
        HX_ScopeBindings(), HX_NameBindings()}) {
    for (const HX_FieldBinding& row : bindings) rows[row.path] = &row;
  }
  const auto find = [&](const std::string& path) {
    const auto found = rows.find(path);
    return found == rows.end() ? nullptr : found->second;
  };
  for (const auto& node : schema.nodes) {
    node->binding = find(node->path);
    for (HX_SchemaField& field : node->fields) {
      field.binding = find(field.path);
      const bool hasParts =
          (field.node->types & HX_SchemaNode::eObject) != 0 ||
          (field.node->items != nullptr &&
           (field.node->items->types & HX_SchemaNode::eObject) != 0);
      if (field.binding == nullptr && !hasParts)
        throw std::logic_error("schema: nothing reads " + field.path);
    }
  }
  return schema;
}

// The text at the place of a syntax fault, up to bytes beyond ASCII, because
// such bytes may be ill-formed.
std::string_view printable(std::string_view text, std::size_t at) {
  constexpr std::size_t kMost = 12;
  text = text.substr(at, kMost);
  const auto ascii = [](char c) {
    return static_cast<unsigned char>(c) < 0x80;
  };
  const auto end = std::find_if_not(text.begin(), text.end(), ascii);
  return text.substr(0, static_cast<std::size_t>(end - text.begin()));
}

const HX_Schema& modelSchema() {
  static const HX_Schema s_Schema = boundSchema();
  return s_Schema;
}

std::string shown(const HX_JsonValue& value) {
  char text[32];
  switch (value.kind) {
    case HX_JsonValue::eNull:
      return "null";
    case HX_JsonValue::eBoolean:
      return value.boolean ? "true" : "false";
    case HX_JsonValue::eText:
      return HX_Quoted(value.text);
    default:
      return {text, std::to_chars(text, text + sizeof text, value.number).ptr};
  }
}

unsigned typeOf(const HX_JsonValue& value) {
  switch (value.kind) {
    case HX_JsonValue::eBoolean:
      return HX_SchemaNode::eBoolean;
    case HX_JsonValue::eText:
      return HX_SchemaNode::eText;
    case HX_JsonValue::eWhole:
      return HX_SchemaNode::eWhole | HX_SchemaNode::eNumber;
    case HX_JsonValue::eFraction:
      return HX_SchemaNode::eNumber;
    default:
      return 0;
  }
}

class Reader : public HX_JsonEvents {
 public:
  Reader(HX_ModelReading& reading, HX_Progress& progress)
      : m_Reading(reading), m_Progress(progress) {
    m_Next.node = m_Schema.root;
  }

  bool value(const HX_JsonValue& value, std::size_t end) override {
    if (m_Skipped > 0) return true;
    const Target target = nextTarget(end);
    if (target.node == nullptr) return true;
    if (target.node->types != 0 && (target.node->types & typeOf(value)) == 0)
      return refuse(end, shown(value), target.node->expectedTypes());
    int word = -1;
    const std::string expected = target.node->mismatch(value, word);
    if (!expected.empty()) return refuse(end, shown(value), expected);
    if (!m_Frames.empty() && target.isRuleField)
      m_Frames.back().ruleWord = word;
    if (target.binding == nullptr || target.binding->set == nullptr)
      return true;
    HX_BoundValue bound;
    static_cast<HX_JsonValue&>(bound) = value;
    bound.place = static_cast<HX_TokenEnd>(end);
    target.binding->set(m_Reading, bound);
    return true;
  }

  bool key(std::string_view text, std::size_t end) override {
    if (m_Skipped > 0) return true;
    Frame& frame = m_Frames.back();
    m_Next = {};
    const int index = frame.node->findField(text, frame.lastField + 1);
    if (index < 0) {
      if (frame.node->isClosed)
        refuse(end, "the field " + HX_Quoted(text), knownFields(*frame.node));
      return true;
    }
    const std::uint64_t bit = std::uint64_t{1} << index;
    if ((frame.seen & bit) != 0)
      return refuse(end, "the field " + HX_Quoted(text) + " a second time",
                    "the field once");
    frame.seen |= bit;
    frame.lastField = index;
    const HX_SchemaField& field =
        frame.node->fields[static_cast<std::size_t>(index)];
    m_Next = {field.node, field.binding, index == frame.node->ruleField};
    return true;
  }

  bool beginObject(std::size_t end) override {
    return begin(end, HX_SchemaNode::eObject, "an object");
  }
  bool beginList(std::size_t end) override {
    return begin(end, HX_SchemaNode::eList, "a list");
  }

  bool endObject(std::size_t end) override {
    m_Progress.moveTo(end);
    --m_Depth;
    if (m_Skipped > 0) return --m_Skipped, true;
    const Frame frame = m_Frames.back();
    checkRequired(frame);
    const HX_FieldBinding* binding = frame.node->binding;
    if (binding != nullptr && binding->end != nullptr)
      binding->end(m_Reading, m_Reading.faults.count() > frame.faultsBefore);
    m_Frames.pop_back();
    return true;
  }

  bool endList(std::size_t) override {
    --m_Depth;
    if (m_Skipped > 0) return --m_Skipped, true;
    const Frame& frame = m_Frames.back();
    if (frame.count < frame.node->minItems)
      refuse(
          frame.place, "a list of " + std::to_string(frame.count),
          "a list with a length from " + std::to_string(frame.node->minItems));
    m_Frames.pop_back();
    return true;
  }

 private:
  /// The expectation of the next value.
  struct Target {
    const HX_SchemaNode* node = nullptr;  // null: the value is left out
    const HX_FieldBinding* binding = nullptr;
    bool isRuleField = false;
  };
  struct Frame {
    const HX_SchemaNode* node = nullptr;
    const HX_FieldBinding* binding = nullptr;  // for the values of a list
    bool isList = false;
    int lastField = -1;
    int ruleWord = -1;
    std::uint64_t seen = 0;
    std::size_t count = 0;
    std::size_t place = 0;
    std::size_t faultsBefore = 0;
  };

  bool refuse(std::size_t place, const std::string& found,
              const std::string& expected) {
    m_Reading.faults.add(place, found, expected);
    return true;
  }

  static std::string knownFields(const HX_SchemaNode& node) {
    std::string keys;
    for (const HX_SchemaField& field : node.fields)
      keys += (keys.empty() ? "" : ", ") + HX_Quoted(field.key);
    return "one of the fields " + keys;
  }

  Target nextTarget(std::size_t end) {
    if (m_Frames.empty() || !m_Frames.back().isList) return m_Next;
    Frame& list = m_Frames.back();
    if (++list.count == list.node->maxItems + 1)
      refuse(
          end, "a longer list",
          "a list with a length up to " + std::to_string(list.node->maxItems));
    if (list.count > list.node->maxItems) return {};
    return {list.node->items, list.binding};
  }

  bool begin(std::size_t end, unsigned type, const char* found) {
    if (++m_Depth > m_Schema.maxDepth) {
      refuse(end, "lists and objects " + std::to_string(m_Depth) + " deep",
             "at most " + std::to_string(m_Schema.maxDepth));
      return false;
    }
    if (m_Skipped > 0) return ++m_Skipped, true;
    const Target target = nextTarget(end);
    const bool fits =
        target.node != nullptr && (target.node->types & type) != 0;
    if (!fits) {
      ++m_Skipped;
      if (target.node != nullptr) refuse(end, found, expectation(*target.node));
      return true;
    }
    Frame& frame = m_Frames.emplace_back();
    frame.node = target.node;
    frame.binding = target.binding;
    frame.isList = type == HX_SchemaNode::eList;
    frame.place = end;
    frame.faultsBefore = m_Reading.faults.count();
    const HX_FieldBinding* own = target.node->binding;
    if (!frame.isList && own != nullptr && own->begin != nullptr)
      own->begin(m_Reading, static_cast<HX_TokenEnd>(end));
    return true;
  }

  static std::string expectation(const HX_SchemaNode& node) {
    if (node.words.empty()) return node.expectedTypes();
    int word = -1;
    HX_JsonValue none;
    none.kind = HX_JsonValue::eText;
    return node.mismatch(none, word);
  }

  void checkRequired(const Frame& frame) {
    std::uint64_t required = frame.node->required;
    for (const HX_SchemaRule& rule : frame.node->rules) {
      if (frame.ruleWord >= 0 && (rule.words >> frame.ruleWord & 1) != 0)
        required |= rule.required;
    }
    const std::uint64_t missing = required & ~frame.seen;
    for (std::size_t i = 0; i < 64 && missing >> i != 0; ++i) {
      if ((missing >> i & 1) == 0) continue;
      const HX_SchemaField& field = frame.node->fields[i];
      refuse(frame.place, "no field " + HX_Quoted(field.key),
             "the field with " + expectation(*field.node));
    }
  }

  const HX_Schema& m_Schema = modelSchema();
  HX_ModelReading& m_Reading;
  HX_Progress& m_Progress;
  std::vector<Frame> m_Frames;
  Target m_Next;
  std::size_t m_Depth = 0;
  std::size_t m_Skipped = 0;  // open lists and objects that are left out
};

}  // namespace

bool HX_ReadDocument(HX_Document& document, HX_ModelReading& reading,
                     HX_Progress& progress) {
  progress.begin("reading, bytes", document.text.size());
  if (document.text.size() > UINT32_MAX)
    throw HX_InputError(HX_Visible(document.file) +
                        ": cannot be read: expected at most 4294967295 bytes");
  Reader reader(reading, progress);
  const HX_JsonEnd end = HX_ReadJson(document.text, reader);
  if (end.expected == nullptr) return !end.isStopped;
  std::string found = "the end of the file";
  if (end.place < document.text.size())
    found = HX_Quoted(printable(std::string_view(document.text), end.place));
  reading.faults.add(end.place, found, end.expected, kHxBadSyntax);
  return false;
}

HX_ModelLimits HX_LimitsOfSchema() {
  return {modelSchema().maxElements, modelSchema().maxChain};
}
