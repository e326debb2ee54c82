#include "host/model/HX_Document.h"

#include <fstream>

#include "host/model/HX_Schema.h"

namespace fs = std::filesystem;

namespace {

// The one place where exceptions of the JSON library arrive.
HX_Json parse(const std::string& file, const fs::path& folder) {
  std::ifstream stream(folder / file, std::ios::binary);
  if (!stream.is_open() || fs::is_directory(folder / file))
    throw HX_DocumentError(file + ": expected a file that can be read");
  try {
    return HX_Json::parse(stream);
  } catch (const HX_Json::parse_error& error) {
    // "[...] parse error at line 2, column 13: ..."
    const std::string text = error.what();
    const std::size_t place = std::min(text.find("line "), text.size());
    throw HX_DocumentError(file + ": " +
                           text.substr(place, text.find(':', place) - place) +
                           ": expected well-formed JSON in UTF-8");
  } catch (const HX_Json::exception&) {
    throw HX_DocumentError(file + ": expected numbers in the range of double");
  }
}

// Moves \p place from that of \p node to that of \p value in or below it.
bool locate(const HX_Json& node, const HX_Json& value,
            HX_Json::json_pointer& place) {
  if (&node == &value) return true;
  for (auto it = node.begin(); node.is_structured() && it != node.end(); ++it) {
    if (node.is_object())
      place /= it.key();
    else
      place /= static_cast<std::size_t>(it - node.begin());
    if (locate(*it, value, place)) return true;
    place.pop_back();
  }
  return false;
}

}  // namespace

HX_Document::HX_Document(const std::string& name, const fs::path& folder)
    : file(name), root(parse(name, folder)) {
  HX_CheckSchema(*this);
}

void HX_Document::fail(const HX_Json& value,
                       const std::string& expectation) const {
  HX_Json::json_pointer place;
  locate(root, value, place);
  throw HX_DocumentError(file + ": " +
                         (place.empty() ? "/" : place.to_string()) +
                         ": expected " + expectation);
}

const HX_Json& HX_FieldOrEmpty(const HX_Json& node, const char* field) {
  static const HX_Json none = HX_Json::object();
  const auto found = node.find(field);
  return found == node.end() ? none : *found;
}
