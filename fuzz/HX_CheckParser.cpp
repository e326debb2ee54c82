// The string parser against plain forms over std::string.
#include <map>
#include <vector>

#include "Strings/HX_StringParser.h"
#include "fuzz/HX_Fuzz.h"

namespace {

std::string lower(std::string text) {
  for (char& c : text) c = static_cast<char>(c >= 'A' && c <= 'Z' ? c + 32 : c);
  return text;
}

std::string trim(std::string text, const std::string& chars, int mode) {
  while (mode != 1 && !text.empty() && chars.find(text[0]) != chars.npos)
    text.erase(0, 1);
  while (mode != 0 && !text.empty() && chars.find(text.back()) != chars.npos)
    text.pop_back();
  return text;
}

// No place for an empty text.
std::size_t find(const std::string& in, const std::string& text) {
  return text.empty() ? in.npos : lower(in).find(lower(text));
}

// The front of \p text up to \p separator, which goes with it.
std::string cut(std::string& text, const std::string& separator) {
  const std::size_t at = find(text, separator);
  const std::string front = text.substr(0, at);
  text = at == text.npos ? "" : text.substr(at + separator.size());
  return front;
}

std::string plainPairs(std::string text, const std::string& keyValueSep,
                       const std::string& pairSep,
                       const std::vector<std::string>& keys,
                       std::map<std::string, std::string>& values) {
  std::string unknown;
  while (!text.empty()) {
    // A key's separator may begin where the pair ends, and reach beyond.
    const std::size_t equals = find(text, keyValueSep);
    const std::string key = lower(trim(text.substr(0, equals), " ", 2));
    std::string item = cut(text, pairSep);
    if (equals > item.size()) {
      item = lower(trim(item, " \t\n\v\f\r", 2));
      if (!item.empty()) unknown = item;
      continue;
    }
    item.erase(0, equals + keyValueSep.size());
    const bool isKnown = std::any_of(keys.begin(), keys.end(),
                                     [&](auto& k) { return lower(k) == key; });
    (isKnown ? values[key] : unknown) = isKnown ? trim(item, " ", 2) : key;
  }
  return unknown;
}

void plainDivide(std::string text, const std::string& start,
                 const std::string& stop, std::string& embedded,
                 std::string& outside) {
  while (!text.empty()) {
    const bool opens = find(text, start) != text.npos;
    outside += cut(text, start);
    if (opens) embedded += cut(text, stop);
  }
}

}  // namespace

void HX_CheckParser(HX_Bytes& bytes) {
  const HX_StringParser parser;
  // Zeros do not come through 8-bit texts.
  const auto next = [&] { return std::string(bytes.line().c_str()); };
  const std::string first = next(), second = next();
  const std::vector<std::string> keys{next(), next()};
  const std::string text = bytes.rest().c_str();

  leda::array<KyCXString> known(2), values(2);
  for (int i = 0; i < 2; ++i) known[i] = keys[std::size_t(i)].c_str();
  std::map<std::string, std::string> plain;
  const KyCXString unknown = parser.parseKeyValuePairs(
      text.c_str(), first.c_str(), second.c_str(), known, values);
  HX_Require(unknown == plainPairs(text, first, second, keys, plain).c_str(),
             "the unknown item");
  HX_Require(values[1] == plain[lower(keys[1])].c_str(), "the last key");
  if (lower(keys[0]) != lower(keys[1]))
    HX_Require(values[0] == plain[lower(keys[0])].c_str(), "the first key");

  KyCXString embedded, outside;
  std::string plainEmbedded, plainOutside;
  parser.divideKeywordEmbeddedString(text.c_str(), first.c_str(),
                                     second.c_str(), embedded, outside);
  plainDivide(text, first, second, plainEmbedded, plainOutside);
  HX_Require(
      embedded == plainEmbedded.c_str() && outside == plainOutside.c_str(),
      "the sections and the text around them");
  for (int mode = 0; mode <= 2; ++mode)
    HX_Require(parser.removeChars(text.c_str(), first.c_str(),
                                  static_cast<HX_StringParser::remove_etp>(
                                      mode)) == trim(text, first, mode).c_str(),
               "trimmed in mode " + std::to_string(mode));
  KyCXString shown;
  parser.processDDPath(text.c_str(), shown);
  HX_Require(shown == text.c_str() || shown.startsWith("User script object "),
             "a path or a description");
}
