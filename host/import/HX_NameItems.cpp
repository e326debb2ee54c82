#include "host/import/HX_NameItems.h"

#include <charconv>
#include <map>

#include "host/import/HX_Dictionary.h"
#include "host/import/HX_Literals.h"
#include "host/import/HX_Notes.h"
#include "host/import/HX_PartText.h"
#include "host/import/HX_XmlPart.h"

namespace {

// The parameter with the type of a second parameter.
struct TypeRow {
  std::string_view parameter;
  std::string_view type;
};

constexpr TypeRow kParameterTypes[] = {
    {"Value", "OutDataTypeStr"},
    {"Gain", "ParamDataTypeStr"},
    {"Table", "TableDataTypeStr"},
    {"BreakpointsForDimension1", "BreakpointsForDimension1DataTypeStr"},
    {"BreakpointsForDimension2", "BreakpointsForDimension2DataTypeStr"},
    {"BreakpointsForDimension3", "BreakpointsForDimension3DataTypeStr"},
};

// Parameters with a given name for the memory of a block.
constexpr const char* kStateNames[] = {"DataStoreName", "StateName",
                                       "StateIdentifier"};

// Constants of the modelling language look like variables.
constexpr std::string_view kConstants[] = {"true", "false", "inf", "Inf",
                                           "nan",  "NaN",   "pi",  "eps"};

bool isVariable(std::string_view text) {
  if (!HX_IsIdentifier(text)) return false;
  for (const std::string_view constant : kConstants) {
    if (text == constant) return false;
  }
  return true;
}

std::string_view ruleType(const HX_ModelBlock& block) {
  return block.isChart ? "Chart" : block.type;
}

// Blocks between the ports and the objects of a chart are made by the tool.
bool isWiringOfChart(const HX_ModelBlock& block) {
  return block.parent != nullptr && block.parent->isChart && !block.hasContent;
}

std::string numberText(double value) {
  char text[32];
  return {text, std::to_chars(text, text + sizeof text, value).ptr};
}

}  // namespace

void HX_NameItems::collect(const HX_ModelBlock& root) {
  Context place{"", "", "", nullptr};
  addFunction(root, place);
  place.parent = &root;
  for (const HX_ModelBlock& block : root.blocks) visit(block, place);
}

void HX_NameItems::visit(const HX_ModelBlock& block, const Context& around) {
  Context place = around;
  place.path += (around.path.empty() ? "" : "/") + block.name;
  place.task = taskOf(block, around);
  if (!isWiringOfChart(block)) {
    addPort(block, place);
    addSignals(block, place);
    addState(block, place);
    addParameters(block, place);
  }
  if (block.isFunction) addFunction(block, place);
  for (const HX_ChartObject& object : block.chart.objects)
    addChartObject(object, place);
  place.parent = &block;
  for (const HX_ModelBlock& inner : block.blocks) visit(inner, place);
}

HX_ImportedName* HX_NameItems::add(const HX_RuleItem& item, const char* kind,
                                   const std::string& id,
                                   const std::string& source,
                                   const Context& place) {
  const HX_Rule* rule = m_Rules.find(item);
  if (rule == nullptr) return nullptr;
  HX_ImportedName& name = m_Names.emplace_back();
  name.id = id;
  name.rule = rule;
  name.kind = kind;
  name.source = source;
  name.task = place.task;
  name.scope = rule->inFunction && !place.body.empty() ? place.body : "file";
  return &name;
}

void HX_NameItems::addFunction(const HX_ModelBlock& block, Context& inner) {
  HX_ImportedName* name =
      add({HX_Rule::eFunction, ruleType(block), inner.path}, "function",
          block.id + "#function", block.id, inner);
  if (name == nullptr) return;
  name->scope = "file";
  inner.body = "body:" + block.id;
  m_Bodies.push_back({inner.body, name->id});
}

void HX_NameItems::addPort(const HX_ModelBlock& block, const Context& place) {
  if (place.parent->parent != nullptr) return;
  const bool isInput = block.type == "Inport";
  if (!isInput && block.type != "Outport") return;
  HX_ImportedName* name = add(
      {isInput ? HX_Rule::eInput : HX_Rule::eOutput, block.type, place.path},
      "variable", block.id + (isInput ? "#input" : "#output"), block.id, place);
  if (name != nullptr)
    setType(*name,
            {block.get("OutDataTypeStr"), "", block.get("PortDimensions")},
            place);
}

void HX_NameItems::addSignals(const HX_ModelBlock& block,
                              const Context& place) {
  HX_RuleItem item{HX_Rule::eSignal, ruleType(block), place.path};
  item.several = block.signals.size() > 1;
  for (const HX_ModelSignal& signal : block.signals) {
    item.labelled = !signal.label.empty();
    const std::string port = std::to_string(signal.port);
    HX_ImportedName* name =
        add(item, "variable", block.id + "#out:" + port, block.id, place);
    if (name == nullptr) continue;
    name->label = signal.label;
    name->x = port;
    setType(*name,
            {block.get("OutDataTypeStr"), "", block.get("PortDimensions")},
            place);
  }
}

void HX_NameItems::addState(const HX_ModelBlock& block, const Context& place) {
  std::string given;
  for (const char* parameter : kStateNames) {
    if (given.empty()) given = HX_OneLine(block.get(parameter));
  }
  HX_RuleItem item{HX_Rule::eState, ruleType(block), place.path};
  item.variable = !given.empty();
  // Readers and writers of a data store name the store as well.
  if (block.type == "DataStoreRead" || block.type == "DataStoreWrite") return;
  HX_ImportedName* name =
      add(item, "variable", block.id + "#state", block.id, place);
  if (name == nullptr) return;
  name->x = given;
  const char* initial = block.find("InitialCondition");
  if (initial == nullptr) initial = block.find("InitialValue");
  setType(*name,
          {block.get("OutDataTypeStr"), initial == nullptr ? "" : initial, ""},
          place);
}

// By name: the order in the file has no influence. Of equal names the first
// holder counts.
void HX_NameItems::addParameters(const HX_ModelBlock& block,
                                 const Context& place) {
  std::map<std::string_view, std::string_view> found;
  for (const pugi::xml_node holder :
       {block.node, block.node.child("InstanceData"), block.linked}) {
    for (const pugi::xml_node p : holder.children("P")) {
      const std::string_view parameter = p.attribute("Name").value();
      if (m_Rules.parameters().find(parameter) != m_Rules.parameters().end())
        found.emplace(parameter, p.child_value());
    }
  }
  for (const auto& [parameter, text] : found)
    addParameter(block, place, parameter, HX_Trimmed(text));
}

void HX_NameItems::addParameter(const HX_ModelBlock& block,
                                const Context& place,
                                std::string_view parameter,
                                std::string_view text) {
  HX_RuleItem item{HX_Rule::eParameter, ruleType(block), place.path, parameter};
  item.variable = isVariable(text);
  std::string id = block.id + "#" + std::string(parameter);
  // Blocks with the same variable share a name.
  if (item.variable) id = "variable:" + std::string(text);
  if (item.variable && m_Shared.find(id) != m_Shared.end()) return;
  HX_ImportedName* name = add(item, "variable", id, block.id, place);
  if (name == nullptr) return;
  Value value{"", item.variable ? "" : text, ""};
  for (const TypeRow& row : kParameterTypes) {
    if (row.parameter == parameter) value.type = block.get(row.type);
  }
  if (item.variable) return setVariable(*name, std::string(text), value, place);
  name->x = parameter;
  setType(*name, value, place);
}

void HX_NameItems::addChartObject(const HX_ChartObject& object,
                                  const Context& around) {
  Context place = around;
  place.path += "/" + object.name;
  HX_RuleItem item{HX_Rule::eChartData, "Chart", place.path, {}, object.scope};
  switch (object.kind) {
    case HX_ChartObject::eData:
      return addChartData(object, place, item);
    case HX_ChartObject::eEvent:
      item.kind = HX_Rule::eChartEvent;
      add(item, "object", object.id, object.id, place);
      break;
    case HX_ChartObject::eFunction:
      item.kind = HX_Rule::eChartFunction;
      if (HX_ImportedName* name =
              add(item, "function", object.id, object.id, place))
        name->scope = "file";
      break;
    case HX_ChartObject::eState:
      item.kind = HX_Rule::eChartState;
      if (HX_ImportedName* name =
              add(item, "variable", object.id, object.id, place))
        setType(*name, {}, place);
      break;
    case HX_ChartObject::eBox:
      break;  // a group is no item
  }
  for (const HX_ChartObject& inner : object.objects)
    addChartObject(inner, place);
}

void HX_NameItems::addChartData(const HX_ChartObject& object,
                                const Context& place, HX_RuleItem item) {
  item.variable = object.scope == "PARAMETER_DATA" && isVariable(object.name);
  std::string id = object.id;
  if (item.variable) id = "variable:" + object.name;
  if (item.variable && m_Shared.find(id) != m_Shared.end()) return;
  HX_ImportedName* name = add(item, "variable", id, object.id, place);
  if (name == nullptr) return;
  const pugi::xml_node properties = object.node.child("props");
  const Value value{HX_Parameter(object.node, "dataType"),
                    HX_Parameter(properties, "initialValue"),
                    HX_Parameter(properties.child("array"), "size")};
  if (item.variable) return setVariable(*name, object.name, value, place);
  name->x = object.name;
  setType(*name, value, place);
}

// Type and value of a dictionary count more than the block's.
void HX_NameItems::setVariable(HX_ImportedName& name,
                               const std::string& variable, const Value& value,
                               const Context& place) {
  m_Shared.insert(name.id);
  name.x = variable;
  name.task.clear();
  Value stated = value;
  for (const auto kind :
       {HX_DictionaryEntry::eParameter, HX_DictionaryEntry::eSignal}) {
    const HX_DictionaryEntry* entry = m_Dictionary.find(variable, kind);
    if (entry == nullptr) continue;
    name.dd = "dd:" + variable;
    if (!entry->type.empty() && entry->type != "auto")
      stated.type = entry->type;
    if (!entry->value.empty()) stated.number = entry->value;
  }
  setType(name, stated, place);
}

void HX_NameItems::setType(HX_ImportedName& name, const Value& value,
                           const Context& place) {
  const auto numbers = HX_ReadNumbers(value.number);
  int elements = HX_ReadDimensions(value.dimensions);
  if (numbers && numbers->size() > 1)
    elements = HX_ReadDimensions(std::to_string(numbers->size()));
  const HX_TypeUse use =
      m_Types.resolve({value.type, name.rule->type, elements, place.path});
  name.type = use.id;
  name.lsb = use.lsb;
  name.zero = use.zero;
  if (numbers && use.isScalar &&
      numbers->size() <= static_cast<std::size_t>(elements))
    name.initial = *numbers;
}

// The task of the block's sample time, or of the blocks around.
std::string HX_NameItems::taskOf(const HX_ModelBlock& block,
                                 const Context& around) {
  const char* text = block.find("SystemSampleTime");
  if (text == nullptr) text = block.find("SampleTime");
  if (text == nullptr) return around.task;
  const auto times = HX_ReadNumbers(text);
  if (!times || times->size() > 2) {
    const std::string shown = HX_OneLine(HX_Trimmed(text));
    if (shown != "inf" && shown != "Inf")
      m_Notes.add("note",
                  "the sample time '" + shown + "' is no number: no task",
                  around.path + "/" + block.name);
    return around.task;
  }
  const double period = times->front();
  const double offset = times->size() == 2 ? times->back() : 0;
  if (!(period > 0)) return around.task;
  std::string id = "task:" + numberText(period);
  if (offset != 0) id += ":" + numberText(offset);
  if (m_Shared.find(id) != m_Shared.end()) return id;
  HX_ImportedName* name = add({HX_Rule::eTask}, "task", id, "", {});
  if (name == nullptr) return around.task;
  m_Shared.insert(id);
  name->scope = "file";
  name->period = period;
  name->offset = offset;
  return id;
}
