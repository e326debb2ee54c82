#include "platform/os/HX_VersionResource.h"

#include <cstdio>
#include <cstring>

#include "platform/os/HX_OsVersion.h"

namespace {

constexpr std::size_t kMaxNodeSize = 0xFFFF;

void pad(std::string& bytes) { bytes.resize((bytes.size() + 3) / 4 * 4, '\0'); }

void setWord(std::string& bytes, std::size_t at, std::size_t value) {
  const auto word = static_cast<std::uint16_t>(value);
  std::memcpy(&bytes[at], &word, sizeof word);
}

// A node with a value and children, nodes already. Empty if the node or a child
// is too large.
std::string node(const std::string& name, const std::string& value,
                 const std::vector<std::string>& children = {}) {
  std::string bytes(4, '\0');
  bytes += name;
  bytes += '\0';
  pad(bytes);
  bytes += value;
  for (const std::string& child : children) {
    if (child.empty()) return {};
    pad(bytes);
    bytes += child;
  }
  if (bytes.size() > kMaxNodeSize) return {};
  setWord(bytes, 0, bytes.size());
  setWord(bytes, 2, value.size());
  return bytes;
}

template <class T>
std::string bytesOf(const T& value) {
  return std::string(reinterpret_cast<const char*>(&value), sizeof value);
}

std::uint32_t twoWords(std::uint16_t high, std::uint16_t low) {
  return std::uint32_t{high} << 16 | low;
}

}  // namespace

void HX_VersionResource::setVersions(const Version& product,
                                     const Version& file) {
  VS_FIXEDFILEINFO info{};
  info.dwSignature = 0xFEEF04BD;
  info.dwStrucVersion = 0x00010000;
  info.dwFileVersionMS = twoWords(file[0], file[1]);
  info.dwFileVersionLS = twoWords(file[2], file[3]);
  info.dwProductVersionMS = twoWords(product[0], product[1]);
  info.dwProductVersionLS = twoWords(product[2], product[3]);
  m_FixedInfo = bytesOf(info);
}

void HX_VersionResource::addTranslation(std::uint16_t language,
                                        std::uint16_t codePage) {
  m_Translations.push_back(twoWords(codePage, language));
}

void HX_VersionResource::setText(std::uint16_t language, std::uint16_t codePage,
                                 const std::string& name,
                                 const std::string& text) {
  char table[9];
  std::snprintf(table, sizeof table, "%04X%04X", language, codePage);
  m_Tables[table][name] = text;
}

std::string HX_VersionResource::block() const {
  std::vector<std::string> tables;
  for (const auto& [table, texts] : m_Tables) {
    std::vector<std::string> nodes;
    for (const auto& [name, text] : texts)
      nodes.push_back(node(name, text + '\0'));
    tables.push_back(node(table, "", nodes));
  }
  std::vector<std::string> children;
  if (!tables.empty()) children.push_back(node("StringFileInfo", "", tables));
  std::string translations;
  for (const std::uint32_t translation : m_Translations)
    translations += bytesOf(translation);
  if (!translations.empty())
    children.push_back(
        node("VarFileInfo", "", {node("Translation", translations)}));
  return node("VS_VERSION_INFO", m_FixedInfo, children);
}
