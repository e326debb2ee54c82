#include "host/import/HX_Dictionary.h"

#include "host/import/HX_Archive.h"
#include "host/import/HX_Notes.h"
#include "host/import/HX_PartText.h"
#include "host/import/HX_XmlPart.h"

namespace {

constexpr char kPart[] = "data/chunk0.xml";

struct KindRow {
  std::string_view ending;  // of the class of the entry's value
  HX_DictionaryEntry::Kind kind;
};

constexpr KindRow kKinds[] = {
    {"EnumTypeDefinition", HX_DictionaryEntry::eEnumeration},
    {".Bus", HX_DictionaryEntry::eBus},
    {".Parameter", HX_DictionaryEntry::eParameter},
    {".Signal", HX_DictionaryEntry::eSignal},
    {".AliasType", HX_DictionaryEntry::eAlias},
};

// Some writers add "_internal" to the name of a property.
std::string property(pugi::xml_node object, const std::string& name) {
  const char* text = HX_FindParameter(object, name + "_internal");
  if (text == nullptr) text = HX_FindParameter(object, name);
  return HX_OneLine(text == nullptr ? "" : text);
}

pugi::xml_node parameterNode(pugi::xml_node object, std::string_view name) {
  for (const pugi::xml_node p : object.children("P")) {
    if (name == p.attribute("Name").value()) return p;
  }
  return {};
}

void readMembers(pugi::xml_node list, HX_DictionaryEntry& entry) {
  for (const pugi::xml_node element : list.children("Element"))
    entry.members.push_back(
        {property(element, "Name"), property(element, "DataType"),
         property(element, "Dimensions"), property(element, "Value")});
}

}  // namespace

void HX_Dictionary::read(const std::filesystem::path& file) {
  const HX_Archive archive(file, m_Limits);
  const HX_XmlPart part(archive, kPart, "DataSource");
  const std::string dictionary = HX_OneLine(file.stem().string());
  for (const pugi::xml_node object : part.root().children("Object")) {
    if (std::string_view(object.attribute("Class").value()) == "DD.ENTRY")
      readEntry(object, dictionary);
  }
}

void HX_Dictionary::readEntry(pugi::xml_node object,
                              const std::string& dictionary) {
  const pugi::xml_node value = parameterNode(object, "Value");
  const pugi::xml_node element = value.child("Element");
  HX_DictionaryEntry entry;
  entry.name = HX_OneLine(HX_Parameter(object, "Name"));
  entry.dictionary = dictionary;
  // A plain value, such as a number, is a parameter without properties.
  entry.kind =
      element ? HX_DictionaryEntry::eOther : HX_DictionaryEntry::eParameter;
  const std::string_view className = element.attribute("Class").value();
  for (const KindRow& row : kKinds) {
    if (className.ends_with(row.ending)) entry.kind = row.kind;
  }
  entry.type =
      property(element, entry.kind == HX_DictionaryEntry::eAlias ? "BaseType"
                                                                 : "DataType");
  entry.value =
      element ? property(element, "Value") : HX_OneLine(value.child_value());
  entry.isPrefixed = property(element, "AddClassNameToEnumNames") == "1";
  for (const char* list : {"Enumerals", "Elements", "Elements_internal"})
    readMembers(parameterNode(element, list), entry);
  if (entry.name.empty()) return;
  const auto [known, isNew] = m_Entries.try_emplace(entry.name, entry);
  if (!isNew)
    m_Notes.add("warning",
                "'" + entry.name + "' of the dictionary '" + dictionary +
                    "' is not used: '" + known->second.dictionary +
                    "' has an entry of this name",
                "");
}

const HX_DictionaryEntry* HX_Dictionary::find(
    std::string_view name, HX_DictionaryEntry::Kind kind) const {
  const auto found = m_Entries.find(name);
  return found == m_Entries.end() || found->second.kind != kind
             ? nullptr
             : &found->second;
}
