#include "host/HX_Document.h"

#include <algorithm>
#include <fstream>
#include <iterator>

#include "host/HX_Schema.h"

namespace {

std::string readFile(const std::string& file,
                     const std::filesystem::path& folder) {
  std::ifstream stream(folder / file, std::ios::binary);
  if (!stream.is_open() || std::filesystem::is_directory(folder / file))
    throw HX_DocumentError(file + ": expected a file that can be read");
  return {std::istreambuf_iterator<char>(stream), {}};
}

std::string lineAndColumn(const std::string& text, std::size_t byte) {
  const auto end =
      text.begin() + static_cast<std::ptrdiff_t>(std::min(byte, text.size()));
  const auto line = 1 + std::count(text.begin(), end, '\n');
  const auto start =
      std::find(std::make_reverse_iterator(end), text.rend(), '\n').base();
  return "line " + std::to_string(line) + ", column " +
         std::to_string(std::max<std::ptrdiff_t>(end - start, 1));
}

// The one place where exceptions of the JSON library arrive.
nlohmann::json parse(const std::string& file, const std::string& text) {
  try {
    return nlohmann::json::parse(text);
  } catch (const nlohmann::json::parse_error& error) {
    throw HX_DocumentError(file + ": " + lineAndColumn(text, error.byte) +
                           ": expected well-formed JSON in UTF-8");
  } catch (const nlohmann::json::exception&) {
    throw HX_DocumentError(file + ": expected numbers in the range of double");
  }
}

}  // namespace

std::string HX_DocumentNode::pointer() const {
  if (m_Parent == nullptr) return "/";
  std::string step;
  for (const char c :
       m_Key != nullptr ? std::string(m_Key) : std::to_string(m_Index)) {
    if (c == '~' || c == '/')
      step += c == '~' ? "~0" : "~1";
    else
      step += c;
  }
  const std::string above = m_Parent->pointer();
  return (above == "/" ? above : above + "/") + step;
}

std::string HX_DocumentNode::text(const char* field,
                                  const char* fallback) const {
  const auto found = m_Value.find(field);
  return found == m_Value.end() ? fallback : found->get<std::string>();
}

double HX_DocumentNode::number(const char* field, double fallback) const {
  const auto found = m_Value.find(field);
  return found == m_Value.end() ? fallback : found->get<double>();
}

int HX_DocumentNode::integer(const char* field, int fallback) const {
  const auto found = m_Value.find(field);
  return found == m_Value.end() ? fallback : found->get<int>();
}

bool HX_DocumentNode::flag(const char* field, bool fallback) const {
  const auto found = m_Value.find(field);
  return found == m_Value.end() ? fallback : found->get<bool>();
}

void HX_DocumentNode::fail(const std::string& expectation) const {
  throw HX_DocumentError(m_File + ": " + pointer() + ": expected " +
                         expectation);
}

HX_Document::HX_Document(const std::string& file,
                         const std::filesystem::path& folder)
    : m_File(file) {
  m_Json = parse(file, readFile(file, folder));
  HX_CheckSchema(root());
}
