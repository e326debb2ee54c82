// Depth and size of types: each type after the types below, see HX_UseGraph.
//
// Example: a = {b, c}, b = [3] of c, c base. In the order c (1 type deep,
// 1 element), b (2, 3), a (3, 4).
#include "host/model/HX_TypeOrder.h"

#include <algorithm>

#include "host/model/HX_ModelReading.h"
#include "host/model/HX_UseGraph.h"

namespace {

class Check {
 public:
  explicit Check(HX_ModelReading& reading)
      : m_Reading(reading),
        m_Graph(reading.model.types.size()),
        m_Sizes(reading.model.types.size()) {
    for (const HX_TypeItem& type : reading.model.types) {
      if (type.of != nullptr) m_Graph.add(type.index, type.of->index);
      for (const HX_TypeItem::Field& field : type.fields)
        m_Graph.add(type.index, field.type->index);
    }
  }

  void run() {
    m_Graph.walk([this](std::size_t index) { finish(index); },
                 [this](const HX_UseGraph::Circle& circle) {
                   const HX_TokenEnd place =
                       m_Reading.types[circle.front()].place;
                   m_Reading.model.typeCircle.enter(circle, place);
                 });
  }

 private:
  struct Size {
    std::size_t depth = 1;     // types in the longest chain
    std::size_t elements = 0;  // at most one above the limit
  };

  void finish(std::size_t index) {
    const HX_TypeItem& type = m_Reading.model.types[index];
    const std::size_t most = m_Limits.elements;
    Size& size = m_Sizes[index];
    for (const std::size_t used : m_Graph.usesOf(index)) {
      size.depth = std::max(size.depth, m_Sizes[used].depth + 1);
      size.elements =
          std::min(size.elements + m_Sizes[used].elements, most + 1);
    }
    size.elements = std::max<std::size_t>(size.elements, 1);
    if (type.kind == HX_TypeKind::eArray) {
      const auto length = static_cast<std::size_t>(std::max(type.length, 1));
      const bool fits = size.elements <= most / length;
      size.elements = fits ? size.elements * length : most + 1;
    }
    checkLimits(m_Reading.types[index].place, size);
    m_Reading.model.types[index].elements = size.elements;
  }

  // The first type beyond a limit is reported, not the types above.
  void checkLimits(HX_TokenEnd place, Size& size) {
    if (size.depth > m_Limits.chain) {
      m_Reading.faults.add(
          place, std::to_string(size.depth) + " types that stand on each other",
          "at most " + std::to_string(m_Limits.chain));
      size.depth = 1;
      m_Reading.areChainsShort = false;
    }
    if (size.elements > m_Limits.elements) {
      m_Reading.faults.add(place, "a type with more elements",
                           "at most " + std::to_string(m_Limits.elements) +
                               " elements of arrays and structures");
      size.elements = 1;
    }
  }

  HX_ModelReading& m_Reading;
  const HX_ModelLimits m_Limits = HX_LimitsOfSchema();
  HX_UseGraph m_Graph;
  std::vector<Size> m_Sizes;  // by index of the type
};

}  // namespace

void HX_CheckTypeOrder(HX_ModelReading& reading) { Check(reading).run(); }
