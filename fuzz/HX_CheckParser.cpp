// The string parser against plain forms over std::string.
#include <map>

#include "Strings/HX_StringParser.h"
#include "fuzz/HX_Fuzz.h"

namespace {

std::string lower(std::string text) {
  for (char& c : text) c = static_cast<char>(c >= 'A' && c <= 'Z' ? c + 32 : c);
  return text;
}

std::string trim(std::string text, const std::string& chars, int mode = 2) {
  const std::size_t from = text.find_first_not_of(chars);
  if (mode == 0 || mode == 2) text.erase(0, from);
  const std::size_t to = text.find_last_not_of(chars);
  if (mode == 1 || mode == 2) text.erase(to + 1);
  return text;
}

// RETURNS: npos for an empty text.
std::size_t find(const std::string& in, const std::string& text) {
  return text.empty() ? in.npos : lower(in).find(lower(text));
}

// Removes the front of \p text up to and with \p separator.
// RETURNS: the front without the separator.
std::string cut(std::string& text, const std::string& separator) {
  const std::size_t at = find(text, separator);
  const std::string front = text.substr(0, at);
  text = at == text.npos ? "" : text.substr(at + separator.size());
  return front;
}

// Key -> value; a key that does not occur keeps its value.
using Values = std::map<std::string, std::string>;

std::string plainPairs(std::string text, const std::string& keyValueSep,
                       const std::string& pairSep, Values& known) {
  std::string unknown;
  while (!text.empty()) {
    // A key's separator may begin where the pair ends, and reach beyond.
    const std::size_t equals = find(text, keyValueSep);
    const std::string key = lower(trim(text.substr(0, equals), " "));
    std::string item = cut(text, pairSep);
    if (equals > item.size()) {
      item = lower(trim(item, " \t\n\v\f\r"));
      if (!item.empty()) unknown = item;
    } else if (known.contains(key)) {
      known[key] = trim(item.erase(0, equals + keyValueSep.size()), " ");
    } else {
      unknown = key;
    }
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
  const std::string keys[] = {next(), next()};
  const std::string text = bytes.rest().c_str();
  const auto agree = [](const KyCXString& result, const std::string& plain) {
    HX_Require(result == plain.c_str(), result.cstring() + (" is " + plain));
  };

  leda::array<KyCXString> known{keys[0].c_str(), keys[1].c_str()};
  leda::array<KyCXString> values{"-", "-"};
  Values plain{{lower(keys[0]), "-"}, {lower(keys[1]), "-"}};
  const KyCXString unknown = parser.parseKeyValuePairs(
      text.c_str(), first.c_str(), second.c_str(), known, values);
  agree(unknown, plainPairs(text, first, second, plain));
  agree(values[1], plain[lower(keys[1])]);
  const bool areEqual = plain.size() == 1;
  agree(values[0], areEqual ? "-" : plain[lower(keys[0])]);

  KyCXString embedded, outside(text.c_str());
  std::string plainEmbedded, plainOutside;
  parser.divideKeywordEmbeddedString(outside, first.c_str(), second.c_str(),
                                     embedded, outside);
  plainDivide(text, first, second, plainEmbedded, plainOutside);
  agree(embedded, plainEmbedded);
  agree(outside, plainOutside);
  for (const int mode : {-1, 0, 1, 2, 3})
    agree(parser.removeChars(text.c_str(), first.c_str(),
                             static_cast<HX_StringParser::remove_etp>(mode)),
          trim(text, first, mode));
  KyCXString shown(text.c_str());
  parser.processDDPath(shown, shown);
  HX_Require(shown == text.c_str() || shown.startsWith("User script object "),
             "a path or a description");
}
