#include "host/base/HX_ResponseFile.h"

#include <filesystem>
#include <fstream>
#include <iterator>

#include "host/base/HX_Faults.h"
#include "host/base/HX_Text.h"

namespace {

using Words = std::vector<std::string>;

bool isBlank(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }

Words wordsOf(const std::string& text) {
  Words words;
  bool isInside = false;  // of a word
  char quote = 0;
  for (std::size_t i = 0; i < text.size(); ++i) {
    const char c = text[i];
    if (quote == 0 && isBlank(c)) {
      isInside = false;
      continue;
    }
    if (!isInside) words.emplace_back();
    isInside = true;
    if (c == '\\' && i + 1 < text.size())
      words.back() += text[++i];
    else if (c == quote)
      quote = 0;
    else if (quote == 0 && (c == '"' || c == '\''))
      quote = c;
    else
      words.back() += c;
  }
  return words;
}

void add(const std::string& word, int depth, Words& words) {
  constexpr int kDeepest = 10;
  const std::string file = word.substr(word.starts_with('@') ? 1 : 0);
  std::error_code error;
  if (!word.starts_with('@') || !std::filesystem::is_regular_file(file, error))
    return words.push_back(word);
  if (depth == kDeepest)
    throw HX_InputError(HX_Visible(file) +
                        ": files of arguments name each other");
  std::ifstream stream(file, std::ios::binary);
  for (const std::string& inner :
       wordsOf({std::istreambuf_iterator<char>(stream), {}}))
    add(inner, depth + 1, words);
}

}  // namespace

Words HX_ExpandArguments(int argc, const char* const* argv) {
  Words words;
  for (int i = 1; i < argc; ++i) add(argv[i], 0, words);
  return words;
}
