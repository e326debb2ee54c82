#include "host/import/HX_ChartReader.h"

#include <algorithm>
#include <set>

#include "host/base/HX_NaturalOrder.h"
#include "host/import/HX_Literals.h"
#include "host/import/HX_PartText.h"
#include "host/import/HX_XmlPart.h"

namespace {

// The function of a block written as text stands under this name in the file,
// and the chart's element <eml> has the name that the author gave.
constexpr char kTextFunction[] = "eML_blk_kernel";

// An attribute in newer files, a parameter in older files.
std::string_view nameOf(pugi::xml_node node) {
  const pugi::xml_attribute attribute = node.attribute("name");
  return attribute ? std::string_view(attribute.value())
                   : HX_Parameter(node, "name");
}

class Reader {
 public:
  Reader(pugi::xml_node chart, const std::string& blockId)
      : m_Chart(chart), m_BlockId(blockId) {}

  bool read(pugi::xml_node children, int depth,
            std::vector<HX_ChartObject>& objects) {
    if (depth < 0) return false;
    for (const pugi::xml_node node : children.children()) {
      HX_ChartObject object;
      if (!readObject(node, object)) continue;
      makeUnique(object.id);
      if (!read(node.child("Children"), depth - 1, object.objects))
        return false;
      objects.push_back(std::move(object));
    }
    std::sort(objects.begin(), objects.end(),
              [](const HX_ChartObject& a, const HX_ChartObject& b) {
                if (a.name != b.name) return HX_NaturalLess(a.name, b.name);
                return HX_NaturalLess(a.id, b.id);
              });
    return true;
  }

 private:
  // A damaged chart may give a number twice.
  void makeUnique(std::string& id) {
    const std::string stated = id;
    for (int i = 2; !m_Ids.insert(id).second; ++i)
      id = stated + "~" + std::to_string(i);
  }

  bool readObject(pugi::xml_node node, HX_ChartObject& object) const {
    const std::string_view element = node.name();
    if (element == "state") {
      if (HX_Parameter(node, "isNoteBox") == "1") return false;
      readState(node, object);
    } else if (element == "data" || element == "event") {
      object.kind =
          element == "data" ? HX_ChartObject::eData : HX_ChartObject::eEvent;
      object.name = HX_OneLine(HX_Trimmed(nameOf(node)));
      object.scope = HX_Parameter(node, "scope");
    } else {
      return false;
    }
    object.node = node;
    object.number = node.attribute("SSID").as_int();
    object.id = m_BlockId + "/" + HX_OneLine(node.attribute("SSID").value());
    if (object.name.empty()) object.name = "_";
    return true;
  }

  void readState(pugi::xml_node node, HX_ChartObject& object) const {
    const std::string_view type = HX_Parameter(node, "type");
    const std::string_view label = HX_Parameter(node, "labelString");
    object.kind = type == "FUNC_STATE"    ? HX_ChartObject::eFunction
                  : type == "GROUP_STATE" ? HX_ChartObject::eBox
                                          : HX_ChartObject::eState;
    object.name = object.kind == HX_ChartObject::eFunction
                      ? HX_FunctionName(label)
                      : HX_StateName(label);
    const std::string_view given = HX_Parameter(m_Chart.child("eml"), "name");
    if (object.name == kTextFunction && !given.empty())
      object.name = HX_OneLine(given);
  }

  const pugi::xml_node m_Chart;
  const std::string& m_BlockId;
  std::set<std::string> m_Ids;
};

}  // namespace

std::string HX_StateName(std::string_view label) {
  label = HX_Trimmed(label);
  return HX_OneLine(HX_Trimmed(label.substr(0, label.find_first_of("/\r\n"))));
}

std::string HX_FunctionName(std::string_view signature) {
  signature = HX_Trimmed(signature);
  const std::size_t sign = signature.find('=');
  if (sign < signature.find('(')) signature.remove_prefix(sign + 1);
  return HX_OneLine(
      HX_Trimmed(signature.substr(0, signature.find_first_of("(\r\n"))));
}

bool HX_ReadChart(pugi::xml_node chart, const std::string& blockId, int depth,
                  HX_ModelChart& result) {
  result.number = chart.attribute("id").as_int();
  return Reader(chart, blockId)
      .read(chart.child("Children"), depth, result.objects);
}
