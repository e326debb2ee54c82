// The objects of a chart: states, functions, boxes, data and events.

#ifndef HOST_IMPORT_HX_CHARTREADER_H
#define HOST_IMPORT_HX_CHARTREADER_H

#include <pugixml.hpp>
#include <string>
#include <string_view>
#include <vector>

struct HX_ChartObject {
  enum Kind { eState, eFunction, eBox, eData, eEvent };

  Kind kind;
  std::string id;    ///< the id of the chart's block, '/', the number
  std::string name;  ///< without line feeds
  int number;        ///< unique in the chart (SSID)
  pugi::xml_node node;
  std::string_view scope;  ///< of data and events, for example "LOCAL_DATA"
  std::vector<HX_ChartObject> objects;  ///< by name, numbers by value
};

struct HX_ModelChart {
  int number = 0;
  std::vector<HX_ChartObject> objects;
};

/// Notes (boxes with text only), transitions and junctions are left out.
/// \param chart    the element <chart>
/// \param blockId  in front of the ids of the objects
/// \param depth    of states in states
/// \return false for a chart nested deeper than \p depth
bool HX_ReadChart(pugi::xml_node chart, const std::string& blockId, int depth,
                  HX_ModelChart& result);

/// RETURNS: the name in the label of a state: the first line up to a '/'.
std::string HX_StateName(std::string_view label);

/// RETURNS: the name in a signature such as "[a, b] = split(x)".
std::string HX_FunctionName(std::string_view signature);

#endif  // HOST_IMPORT_HX_CHARTREADER_H
