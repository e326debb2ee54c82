#include "host/model/HX_WordList.h"

#include <fstream>
#include <iterator>

#include "host/base/HX_Faults.h"
#include "host/base/HX_InputFiles.h"
#include "host/base/HX_Text.h"
#include "host/model/HX_Pattern.h"

namespace fs = std::filesystem;

namespace {

// The line without comment and without blanks at the ends.
std::string_view contentOf(std::string_view line) {
  line = line.substr(0, line.find('#'));
  const std::size_t first = line.find_first_not_of(" \t\r");
  if (first == line.npos) return {};
  return line.substr(first, line.find_last_not_of(" \t\r") - first + 1);
}

void throwFaults(const fs::path& file, std::string_view text,
                 const HX_Faults& faults) {
  std::vector<HX_Diagnostic> list;
  for (const auto& [place, fault] : faults.kept()) {
    const HX_TextPlace at = HX_PlaceIn(text, place);
    list.push_back({fault.number, 2,
                    HX_MessageText(fault.number, {fault.found, fault.expected}),
                    "", "", HX_Visible(file.string()), at.line, at.column});
  }
  faults.addRest(list);
  throw HX_DocumentError(list);
}

}  // namespace

bool HX_ReadWordList(const fs::path& file, std::set<std::string>& words) {
  static const HX_Pattern s_Name("[A-Za-z_][A-Za-z_0-9]*");
  std::error_code error;
  std::ifstream stream(file, std::ios::binary);
  if (!stream.is_open() || fs::is_directory(file, error)) return false;
  const std::string text{std::istreambuf_iterator<char>(stream), {}};
  HX_InputFiles().insert(file.string());
  HX_Faults faults;
  bool hasWord = false;
  std::size_t at = text.starts_with("\xEF\xBB\xBF") ? 3 : 0;
  while (at < text.size()) {
    const std::size_t end = std::min(text.find('\n', at), text.size());
    const std::string_view word =
        contentOf(std::string_view(text).substr(at, end - at));
    if (!word.empty() && !s_Name.fits(word))
      faults.add(static_cast<std::size_t>(word.data() - text.data()),
                 HX_Quoted(word), "a C name or a comment behind '#'",
                 kHxBadWordList);
    if (!word.empty()) words.emplace(word);
    hasWord = hasWord || !word.empty();
    at = end + 1;
  }
  if (!hasWord) faults.add(0, "no word", "a C name", kHxBadWordList);
  if (faults.count() > 0) throwFaults(file, text, faults);
  return true;
}
