#include "fuzz/HX_DocumentGrammar.h"

#include <algorithm>
#include <iterator>
#include <map>
#include <sstream>
#include <string_view>

#include "host/base/HX_JsonWriter.h"
#include "host/model/HX_Schema.h"

namespace {

/// Fields that define or use ids, by the letter of the ids.
struct IdRow {
  std::string_view path;
  char letter;
  bool isDefinition;
};

constexpr IdRow kIds[] = {
    {"block.id", 's', true},
    {"chartObject.id", 's', true},
    {"dataDictionary.objects.id", 'd', true},
    {"type.id", 't', true},
    {"scope.id", 'c', true},
    {"name.id", 'n', true},
    {"name.source", 's', false},
    {"name.alsoFrom", 's', false},
    {"name.dd", 'd', false},
    {"name.type", 't', false},
    {"name.symbol.type", 't', false},
    {"type.of", 't', false},
    {"type.fields.type", 't', false},
    {"name.scope", 'c', false},
    {"name.task", 'n', false},
    {"name.isr", 'n', false},
    {"name.dependsOn", 'n', false},
    {"scope.function", 'n', false},
};

// Texts that have broken something, or might.
constexpr const char* kTexts[] = {
    "a",
    "Speed Gain",
    "int",
    "$B",
    "$S_$B",
    "$L_$T:$L$R",
    "$(Time)_$(Task)",
    "x:y:z",
    "",
    "_",
    "\xE9\x80\x9F\xE5\xBA\xA6",
    "Gr\xC3\xB6\xC3\x9F"
    "e",
    "\xF0\x9F\x9A\x97",
    "*/",
    "?\?/",
    "a/b",
    "$$",
    "$(",
    "$E($E)",
    "$X$R",
    "0",
    "1e400",
    "main",
    "a very long name that has to be cut in the middle of the text",
    "\n\t\\\"",
    "//DD0/a/b",
    "E",
    "(Section)",
    "$O_$C_$H",
    "$D",
    "$v$f$x$t"};

class Grammar {
 public:
  Grammar(HX_Bytes& bytes, std::ostream& out)
      : m_Bytes(bytes), m_Json(out, 0) {}

  void writeDocument() {
    writeValue(*m_Schema.root, "", 0);
    m_Json.end();
  }

 private:
  bool isLikely() { return m_Bytes.below(4) != 0; }

  void writeValue(const HX_SchemaNode& node, const std::string& path,
                  int depth) {
    const bool isOdd = m_Bytes.number() == 255;  // the wrong type
    unsigned types = isOdd ? HX_SchemaNode::eBoolean : node.types;
    if ((types & HX_SchemaNode::eList) != 0 &&
        (types == HX_SchemaNode::eList || m_Bytes.flag()))
      return writeList(node, path, depth);
    if ((types & HX_SchemaNode::eObject) != 0) return writeObject(node, depth);
    if ((types & (HX_SchemaNode::eWhole | HX_SchemaNode::eNumber)) != 0)
      return m_Json.raw(number(node));
    if ((types & HX_SchemaNode::eBoolean) != 0)
      return m_Json.raw(m_Bytes.flag() ? "true" : "false");
    m_Json.text(text(node, path));
  }

  void writeList(const HX_SchemaNode& node, const std::string& path,
                 int depth) {
    constexpr int kDeepest = 12;
    int count = depth > kDeepest ? 0 : m_Bytes.below(5);
    count = std::max(count, static_cast<int>(node.minItems));
    m_Json.open('[');
    for (int i = 0; i < count; ++i) {
      m_Json.next();
      writeValue(*node.items, path, depth + 1);
    }
    m_Json.close(']');
  }

  void writeObject(const HX_SchemaNode& node, int depth) {
    // The field of the rules first: the other fields depend on it.
    int word = -1;
    std::uint64_t wanted = node.required;
    if (node.ruleField >= 0) {
      const auto& words = field(node, node.ruleField).node->words;
      word = m_Bytes.below(static_cast<int>(words.size()));
      for (const HX_SchemaRule& rule : node.rules)
        if ((rule.words >> word & 1) != 0) wanted |= rule.required;
      if (isLikely()) wanted |= std::uint64_t{1} << node.ruleField;
    }
    m_Json.open('{');
    for (int i = 0; i < static_cast<int>(node.fields.size()); ++i) {
      const bool isRequired = (wanted >> i & 1) != 0;
      if (isRequired ? m_Bytes.number() == 254 : isLikely()) continue;
      const HX_SchemaField& each = field(node, i);
      m_Json.key(each.key);
      if (i == node.ruleField)
        m_Json.text(each.node->words[static_cast<std::size_t>(word)]);
      else
        writeValue(*each.node, each.path, depth + 1);
    }
    m_Json.close('}');
  }

  static const HX_SchemaField& field(const HX_SchemaNode& node, int index) {
    return node.fields[static_cast<std::size_t>(index)];
  }

  std::string number(const HX_SchemaNode& node) {
    const int choice = m_Bytes.below(6);
    if (choice == 0 && node.minimum) return whole(*node.minimum);
    if (choice == 1 && node.maximum) return whole(*node.maximum);
    if (choice == 2 && (node.types & HX_SchemaNode::eWhole) == 0)
      return m_Bytes.flag() ? "1e300" : "-0.5";
    return std::to_string(1 + m_Bytes.below(8));
  }
  static std::string whole(double value) {
    return std::to_string(static_cast<long long>(value));
  }

  std::string text(const HX_SchemaNode& node, const std::string& path) {
    for (const IdRow& row : kIds) {
      if (row.path == path) return id(row);
    }
    if (!node.words.empty())
      return node.words[static_cast<std::size_t>(
          m_Bytes.below(static_cast<int>(node.words.size())))];
    if (node.pattern && isLikely())
      return path == "dataDictionary.objects.path" ? "//DD0/a/b" : unique('x');
    return kTexts[m_Bytes.below(static_cast<int>(std::size(kTexts)))];
  }

  // Definitions count up; uses choose among low numbers.
  std::string id(const IdRow& row) {
    if (row.isDefinition) return unique(row.letter);
    return row.letter + std::to_string(m_Bytes.below(2));
  }
  std::string unique(char letter) {
    return letter + std::to_string(m_Next[letter]++);
  }

  const HX_Schema m_Schema{kHxModelSchema};
  HX_Bytes& m_Bytes;
  HX_JsonWriter m_Json;
  std::map<char, int> m_Next;
};

}  // namespace

std::string HX_DocumentFrom(HX_Bytes& bytes) {
  std::ostringstream out;
  Grammar(bytes, out).writeDocument();
  return std::move(out).str();
}
