// Reads the parts of a document into a model; private to the sources of
// HX_Model.

#ifndef HOST_HX_MODELREADER_H
#define HOST_HX_MODELREADER_H

#include <set>
#include <string>
#include <unordered_map>

#include "host/HX_Document.h"
#include "host/HX_Model.h"

/// The ids of one kind, and what they stand for.
template <class Item>
class HX_Ids {
 public:
  HX_Ids(const HX_Document& document, const char* what)
      : m_Document(document), m_What(what) {}

  /// Enters the item of \p node, whose id must be new.
  void enter(const HX_Json& node, Item* item) {
    const HX_Json& id = node["id"];
    if (!m_Items.emplace(id, item).second)
      m_Document.fail(id, "an id that is not taken yet, found " + id.dump());
  }

  Item* find(const HX_Json& id) const {
    const auto found = m_Items.find(id.get_ref<const std::string&>());
    if (found == m_Items.end())
      m_Document.fail(
          id, std::string("the id of ") + m_What + ", found " + id.dump());
    return found->second;
  }

  /// Null for a field that is missing.
  Item* findIn(const HX_Json& node, const char* field) const {
    const auto id = node.find(field);
    return id == node.end() ? nullptr : find(*id);
  }

 private:
  const HX_Document& m_Document;
  const char* m_What;
  std::unordered_map<std::string, Item*> m_Items;
};

class HX_ModelReader {
 public:
  HX_ModelReader(HX_Document& document, HX_Model& model)
      : m_Document(document), m_Model(model) {}
  void read(const std::string& keywordFolder);

 private:
  using Json = const HX_Json&;

  void readModel(Json model);
  void readOptions(Json options, const std::string& keywordFolder);
  void readBlock(Json node, HX_Block* parent);
  void readChart(Json node, HX_StateflowBlock& block);
  void readChartObject(Json node, SC_State& chart, const KyCXString& path,
                       const KyCXString& hierarchy);
  SC_State& addState(Json node, const KyCXString& name, SC_Chart& chart,
                     const KyCXString& path, const KyCXString& hierarchy);
  void readDdObjects(Json objects);
  void readComponents(Json components);
  void readScope(Json node, const HX_ScopeItem* parent);
  void completeScope(Json node, std::size_t& index);
  void readTypes(Json types);
  void completeType(Json node, HX_TypeItem& item);
  HX_TypeItem* findNamedType(Json id) const;
  void takeCodeName(Json name);
  void readNames(HX_Json& names);
  void readName(Json node, HX_Name& name);
  void readSymbol(Json node, HX_Name& name);
  void readMultirate(Json node, HX_Name& name);
  void readVariable(Json node, HX_Name& name);

  HX_Document& m_Document;
  HX_Model& m_Model;
  HX_Ids<const HxCSrcRef> m_Sources{
      m_Document, "a block, a chart object or a dictionary object"};
  HX_Ids<HX_TypeItem> m_Types{m_Document, "a type"};
  HX_Ids<HX_ScopeItem> m_Scopes{m_Document, "a scope"};
  HX_Ids<HX_Name> m_Names{m_Document, "a name"};
  std::set<std::string> m_CodeNames;  // of types and constants
  std::set<const HX_Name*> m_Bodies;  // functions that have a scope
  const HX_ScopeItem* m_FileScope = nullptr;
};

#endif  // HOST_HX_MODELREADER_H
