#include "host/import/HX_XmlPart.h"

#include "host/import/HX_Archive.h"
#include "host/import/HX_PartText.h"

namespace {

constexpr unsigned kFlags =
    pugi::parse_default | pugi::parse_doctype | pugi::parse_embed_pcdata;

// Parsing overwrites the text, so places are found in a second copy.
[[noreturn]] void failAt(const HX_Archive& archive, const std::string& part,
                         std::size_t offset, const std::string& reason) {
  archive.fail(part + ":" + HX_PlaceOf(archive.read(part), offset), reason);
}

}  // namespace

HX_XmlPart::HX_XmlPart(const HX_Archive& archive, const std::string& part,
                       const char* rootName)
    : m_Text(archive.read(part)) {
  const std::size_t zero = m_Text.find('\0');
  if (zero != std::string::npos)
    failAt(archive, part, zero, "expected text, found a zero byte");
  const std::size_t bad = HX_FindBadUtf8(m_Text);
  if (bad != std::string::npos)
    failAt(archive, part, bad, "expected text in UTF-8");
  const pugi::xml_parse_result result = m_Document.load_buffer_inplace(
      m_Text.data(), m_Text.size(), kFlags, pugi::encoding_utf8);
  if (!result)
    failAt(archive, part, static_cast<std::size_t>(result.offset),
           std::string("expected well-formed XML: ") + result.description());
  for (const pugi::xml_node node : m_Document) {
    if (node.type() == pugi::node_doctype)
      archive.fail(part, "expected no document type (<!DOCTYPE>)");
  }
  if (std::string_view(root().name()) != rootName)
    archive.fail(part, std::string("expected the root element <") + rootName +
                           ">, found <" + HX_OneLine(root().name()) + ">");
}

const char* HX_FindParameter(pugi::xml_node node, std::string_view name) {
  for (pugi::xml_node p = node.first_child(); p; p = p.next_sibling()) {
    if (p.name()[0] == 'P' && p.name()[1] == '\0' &&
        name == p.attribute("Name").value())
      return p.child_value();
  }
  return nullptr;
}

std::string_view HX_Parameter(pugi::xml_node node, std::string_view name) {
  const char* text = HX_FindParameter(node, name);
  return text == nullptr ? std::string_view() : std::string_view(text);
}
