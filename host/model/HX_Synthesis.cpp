#include "host/model/HX_Synthesis.h"

#include <nlohmann/json.hpp>

using nlohmann::ordered_json;

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

constexpr char kFrame[] = R"({
  "model": {"name": "synthetic", "systemId": "a"},
  "options": {"limitNames": true},
  "blocks": [],
  "types": [
    {"id": "i16", "name": "Int16", "kind": "base", "c": "short", "cut": "i16"},
    {"id": "f32", "name": "Float32", "kind": "base", "c": "float",
     "cut": "f32"},
    {"id": "speed", "name": "speed_t", "kind": "derived", "of": "i16"}],
  "names": []
})";

ordered_json variable(int index, Random& random) {
  static constexpr const char* kTypes[] = {"i16", "f32", "speed"};
  static constexpr const char* kTemplates[] = {"$S_$B", "$B", "$L_$T",
                                               "$S_$B_$L"};
  const std::string number = std::to_string(index);
  ordered_json name{{"id", "v" + number},
                    {"template", kTemplates[random.below(4)]},
                    {"kind", "variable"},
                    {"source", "b" + number},
                    {"type", kTypes[random.below(3)]},
                    {"label", "sig_" + std::to_string(random.below(index + 1))},
                    {"initial", random.below(2000) - 1000},
                    {"lsb", 0.5}};
  if (index > 0 && random.below(4) == 0)
    name["dependsOn"] = {"v" + std::to_string(random.below(index))};
  return name;
}

}  // namespace

std::string HX_Synthesize(int blocks, std::uint64_t seed) {
  Random random(seed);
  ordered_json document = ordered_json::parse(kFrame);
  ordered_json& subsystems = document["blocks"];
  for (int i = 0; i < blocks; ++i) {
    if (i % kBlocksPerSubsystem == 0) {
      const int number = 1 + i / kBlocksPerSubsystem;
      subsystems.push_back({{"id", "s" + std::to_string(number)},
                            {"name", "Subsystem " + std::to_string(number)},
                            {"subsystem", {{"id", "a"}, {"number", number}}},
                            {"blocks", ordered_json::array()}});
    }
    subsystems.back()["blocks"].push_back(
        {{"id", "b" + std::to_string(i)}, {"name", blockName(random)}});
    document["names"].push_back(variable(i, random));
  }
  return document.dump(1) + "\n";
}
