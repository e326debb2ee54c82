#include "host/model/HX_Synthesis.h"

#include <iterator>
#include <string>

#include "host/base/HX_JsonWriter.h"

namespace {

constexpr int kBlocksPerSubsystem = 50;

// SplitMix64 (Steele, Lea, Flood: Fast splittable pseudorandom number
// generators, 2014): the same sequence everywhere.
class Random {
 public:
  explicit Random(std::uint64_t seed) : m_State(seed) {}
  /// 0 to \p count - 1.
  int below(int count) {
    std::uint64_t z = m_State += 0x9E3779B97F4A7C15U;
    z = (z ^ z >> 30) * 0xBF58476D1CE4E5B9U;
    z = (z ^ z >> 27) * 0x94D049BB133111EBU;
    return static_cast<int>((z ^ z >> 31) % static_cast<unsigned>(count));
  }

 private:
  std::uint64_t m_State;
};

constexpr const char* kParts[] = {"Speed",  "Torque", "Limit", "Filter",
                                  "Sensor", "Error",  "Gain",  "Demand",
                                  "Offset", "Brake",  "Pedal", "Engine"};

std::string blockName(Random& random) {
  std::string name;
  for (int words = 2 + random.below(3); words > 0; --words)
    name += (name.empty() ? "" : " ") +
            std::string(kParts[random.below(std::size(kParts))]);
  return name;
}

std::string numbered(const char* letter, int number) {
  return letter + std::to_string(number);
}

struct TypeRow {
  const char* id;
  const char* name;
  const char* kind;
  const char* of;  // the C type of a base type, else the type below
};

constexpr TypeRow kTypes[] = {{"i16", "Int16", "base", "short"},
                              {"f32", "Float32", "base", "float"},
                              {"speed", "speed_t", "derived", "i16"}};

void writeTypes(HX_JsonWriter& json) {
  json.key("types");
  json.open('[');
  for (const TypeRow& row : kTypes) {
    const bool isBase = std::string(row.kind) == "base";
    json.next();
    json.open('{');
    json.field("id", row.id);
    json.field("name", row.name);
    json.field("kind", row.kind);
    json.field(isBase ? "c" : "of", row.of);
    if (isBase) json.field("cut", row.id);
    json.close('}');
  }
  json.close(']');
}

void writeVariable(HX_JsonWriter& json, int index, Random& random) {
  static constexpr const char* kTemplates[] = {"$S_$B", "$B", "$L_$T",
                                               "$S_$B_$L"};
  json.next();
  json.open('{');
  json.field("id", numbered("v", index));
  json.field("template", kTemplates[random.below(4)]);
  json.field("kind", "variable");
  json.field("source", numbered("b", index));
  json.field("type", kTypes[random.below(3)].id);
  json.field("label", numbered("sig_", random.below(index + 1)));
  json.rawField("initial", std::to_string(random.below(2000) - 1000));
  json.rawField("lsb", "0.5");
  if (index > 0 && random.below(4) == 0) {
    json.key("dependsOn");
    json.open('[');
    json.element(numbered("v", random.below(index)));
    json.close(']');
  }
  json.close('}');
}

void beginSubsystem(HX_JsonWriter& json, int number) {
  json.next();
  json.open('{');
  json.field("id", numbered("s", number));
  json.field("name", "Subsystem " + std::to_string(number));
  json.key("subsystem");
  json.open('{');
  json.field("id", "a");
  json.rawField("number", std::to_string(number));
  json.close('}');
  json.key("blocks");
  json.open('[');
}

void writeBlocks(HX_JsonWriter& json, int blocks, Random& random) {
  json.key("blocks");
  json.open('[');
  for (int i = 0; i < blocks; ++i) {
    if (i % kBlocksPerSubsystem == 0)
      beginSubsystem(json, 1 + i / kBlocksPerSubsystem);
    json.next();
    json.open('{');
    json.field("id", numbered("b", i));
    json.field("name", blockName(random));
    json.close('}');
    if ((i + 1) % kBlocksPerSubsystem != 0 && i + 1 != blocks) continue;
    json.close(']');
    json.close('}');
  }
  json.close(']');
}

}  // namespace

void HX_Synthesize(std::ostream& out, int blocks, std::uint64_t seed) {
  HX_JsonWriter json(out, 1);
  json.open('{');
  json.key("model");
  json.open('{');
  json.field("name", "synthetic");
  json.field("systemId", "a");
  json.close('}');
  json.key("options");
  json.open('{');
  json.rawField("limitNames", "true");
  json.close('}');
  // Blocks and variables have random numbers of their own: neither list waits
  // for the other list.
  Random blockRandom(seed);
  writeBlocks(json, blocks, blockRandom);
  writeTypes(json);
  json.key("names");
  json.open('[');
  Random nameRandom(~seed);
  for (int i = 0; i < blocks; ++i) writeVariable(json, i, nameRandom);
  json.close(']');
  json.close('}');
  json.end();
}
