// An XML part of an archive, parsed.

#ifndef HOST_IMPORT_HX_XMLPART_H
#define HOST_IMPORT_HX_XMLPART_H

#include <pugixml.hpp>
#include <string>
#include <string_view>

class HX_Archive;

/// Owns the text behind the nodes, so a part is neither copied nor moved.
class HX_XmlPart {
 public:
  /// Throws HX_ImportError "FILE: PART:LINE:COLUMN: reason" for text
  /// outside well-formed UTF-8 or XML, for a part without the root element
  /// \p rootName, and for a document type: entities make a small part large and
  /// reach further files.
  HX_XmlPart(const HX_Archive& archive, const std::string& part,
             const char* rootName);
  HX_XmlPart(const HX_XmlPart&) = delete;
  HX_XmlPart& operator=(const HX_XmlPart&) = delete;

  pugi::xml_node root() const { return m_Document.document_element(); }

 private:
  std::string m_Text;
  pugi::xml_document m_Document;
};

/// RETURNS: the text of the child <P Name="name"> of \p node; null for none.
const char* HX_FindParameter(pugi::xml_node node, std::string_view name);

/// The same, empty for none.
std::string_view HX_Parameter(pugi::xml_node node, std::string_view name);

#endif  // HOST_IMPORT_HX_XMLPART_H
