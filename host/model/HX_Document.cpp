#include "host/model/HX_Document.h"

#include <fstream>
#include <vector>

#include "host/base/HX_InputFiles.h"
#include "host/base/HX_JsonReader.h"
#include "host/base/HX_Text.h"

namespace fs = std::filesystem;

namespace {

std::string readFile(const std::string& file, const fs::path& folder) {
  std::error_code error;
  std::ifstream stream(folder / file, std::ios::binary);
  if (!stream.is_open() || fs::is_directory(folder / file, error))
    throw HX_InputError(HX_Visible(file) + ": cannot be read: expected a file");
  std::string text;
  const auto size = fs::file_size(folder / file, error);
  if (!error) text.reserve(static_cast<std::size_t>(size));
  char part[65536];
  while (stream.read(part, sizeof part), stream.gcount() > 0)
    text.append(part, static_cast<std::size_t>(stream.gcount()));
  return text;
}

/// Finds the pointers of tokens by their ends.
class Locator : public HX_JsonEvents {
 public:
  Locator(const std::string& text, const HX_Faults& faults) : m_Text(text) {
    for (const auto& [place, fault] : faults.kept()) places[place] = {};
    m_Next = places.begin();
  }

  bool value(const HX_JsonValue&, std::size_t end) override {
    beginValue();
    return note(end);
  }
  bool key(std::string_view text, std::size_t end) override {
    m_Path.back().key = text;
    m_Path.back().hasPart = true;
    return note(end);
  }
  bool beginObject(std::size_t end) override {
    beginValue();
    const bool goesOn = note(end);
    m_Path.push_back({false});
    return goesOn;
  }
  bool beginList(std::size_t end) override {
    beginValue();
    const bool goesOn = note(end);
    m_Path.push_back({true});
    return goesOn;
  }
  bool endObject(std::size_t end) override { return leave(end); }
  bool endList(std::size_t end) override { return leave(end); }

  /// Gives the remaining place, a fault of the syntax, the current pointer.
  void endInside() {
    if (m_Next != places.end()) m_Next->second = {m_Next->first, pointer()};
  }

  std::map<std::size_t, HX_Document::Place> places;

 private:
  struct Level {
    bool isList;
    bool hasPart = false;  // an element or a key was read
    std::size_t index = 0;
    std::string key = {};
  };

  void beginValue() {
    if (m_Path.empty() || !m_Path.back().isList) return;
    if (m_Path.back().hasPart) ++m_Path.back().index;
    m_Path.back().hasPart = true;
  }
  bool leave(std::size_t end) {
    m_Path.pop_back();
    m_LastEnd = end;
    return true;
  }
  bool note(std::size_t end) {
    if (end == m_Next->first) {
      const std::size_t begin =
          m_Text.find_first_not_of(" \t\r\n,:", m_LastEnd);
      m_Next->second = {begin, pointer()};
      ++m_Next;
    }
    m_LastEnd = end;
    return m_Next != places.end();
  }

  std::string pointer() const {
    std::string text;
    for (const Level& level : m_Path) {
      if (!level.hasPart) continue;
      text += '/';
      if (level.isList)
        text += std::to_string(level.index);
      else
        appendKey(text, level.key);
    }
    return text.empty() ? "/" : text;
  }
  // RFC 6901: "~0" stands for '~', "~1" for '/'.
  static void appendKey(std::string& pointer, const std::string& key) {
    const std::string quoted = HX_Quoted(key);
    for (const char c : quoted.substr(1, quoted.size() - 2)) {
      if (c == '~')
        pointer += "~0";
      else if (c == '/')
        pointer += "~1";
      else
        pointer += c;
    }
  }

  const std::string& m_Text;
  std::map<std::size_t, HX_Document::Place>::iterator m_Next;
  std::vector<Level> m_Path;
  std::size_t m_LastEnd = 0;
};

}  // namespace

HX_Document::HX_Document(const std::string& name, const fs::path& folder)
    : file(name), text(readFile(name, folder)) {
  HX_InputFiles().insert(name);
}

HX_Document HX_Document::ofText(const std::string& name, std::string text) {
  HX_Document document;
  document.file = name;
  document.text = std::move(text);
  return document;
}

std::map<std::size_t, HX_Document::Place> HX_Document::locate(
    const HX_Faults& list) const {
  Locator locator(text, list);
  HX_ReadJson(text, locator);
  locator.endInside();
  return locator.places;
}

std::string HX_Document::placeText(HX_TokenEnd end) const {
  HX_Faults only;
  only.add(end, "", "");
  return shown(locate(only).at(end));
}

std::string HX_Document::shown(const Place& place) const {
  return HX_Visible(file) + ":" + HX_LineAndColumn(text, place.begin) + ": " +
         place.pointer;
}

void HX_Document::throwIfFaulty() const {
  if (faults.count() == 0) return;
  std::vector<HX_Diagnostic> list;
  const auto places = locate(faults);
  for (const auto& [end, fault] : faults.kept()) {
    const Place& place = places.at(end);
    const HX_TextPlace at = HX_PlaceIn(text, place.begin);
    list.push_back({fault.number, 2,
                    HX_MessageText(fault.number, {fault.found, fault.expected}),
                    "", place.pointer, HX_Visible(file), at.line, at.column});
  }
  faults.addRest(list);
  throw HX_DocumentError(list);
}
