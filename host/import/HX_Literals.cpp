#include "host/import/HX_Literals.h"

#include <algorithm>
#include <charconv>
#include <cmath>

namespace {

constexpr std::string_view kCasts[] = {
    "double", "single", "int8",   "int16",  "int32",   "int64",
    "uint8",  "uint16", "uint32", "uint64", "logical", "boolean"};
constexpr double kMaxElements = 65535;  // of an array in a document

bool isLetter(char c) {
  return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

bool isDigit(char c) { return c >= '0' && c <= '9'; }

bool isBetweenNumbers(char c) {
  return c == ' ' || c == '\t' || c == ',' || c == ';' || c == '\n' ||
         c == '\r';
}

// "single(x)" into "x"; further texts stay.
std::string_view withoutCast(std::string_view text) {
  const std::size_t open = text.find('(');
  if (open == std::string_view::npos || text.back() != ')') return text;
  const std::string_view name = HX_Trimmed(text.substr(0, open));
  if (std::find(std::begin(kCasts), std::end(kCasts), name) == std::end(kCasts))
    return text;
  return HX_Trimmed(text.substr(open + 1, text.size() - open - 2));
}

// Moves `text` behind the number at the start. std::from_chars() takes no '+'
// and takes words such as "inf", here the name of a constant.
bool takeNumber(std::string_view& text, double& value) {
  std::string_view rest = text;
  if (rest.front() == '+') rest.remove_prefix(1);
  const std::size_t digit = rest.starts_with('-') ? 1 : 0;
  if (digit >= rest.size() || !(isDigit(rest[digit]) || rest[digit] == '.'))
    return false;
  const auto [end, error] =
      std::from_chars(rest.data(), rest.data() + rest.size(), value);
  if (error != std::errc()) return false;
  text = rest.substr(static_cast<std::size_t>(end - rest.data()));
  return text.empty() || isBetweenNumbers(text.front());
}

}  // namespace

std::string_view HX_Trimmed(std::string_view text) {
  constexpr char kBlanks[] = " \t\r\n";
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::optional<std::vector<double>> HX_ReadNumbers(std::string_view text) {
  text = withoutCast(HX_Trimmed(text));
  if (text == "true" || text == "false")
    return std::vector<double>{text == "true" ? 1.0 : 0.0};
  const bool isList = text.size() > 1 && text.front() == '[';
  if (isList) {
    if (text.back() != ']') return std::nullopt;
    text = text.substr(1, text.size() - 2);
  }
  std::vector<double> values;
  while (!text.empty()) {
    if (isBetweenNumbers(text.front())) {
      text.remove_prefix(1);
      continue;
    }
    double value = 0;
    if (!takeNumber(text, value)) return std::nullopt;
    values.push_back(value);
  }
  if (values.empty() || (!isList && values.size() > 1)) return std::nullopt;
  return values;
}

std::optional<double> HX_ReadNumber(std::string_view text) {
  const auto values = HX_ReadNumbers(text);
  if (!values || values->size() != 1) return std::nullopt;
  return values->front();
}

int HX_ReadDimensions(std::string_view text) {
  const auto values = HX_ReadNumbers(text);
  if (!values) return 1;
  double product = 1;
  for (const double value : *values) {
    if (value < 1 || value != std::floor(value)) return 1;
    product *= value;
  }
  return product > kMaxElements ? 1 : static_cast<int>(product);
}

bool HX_IsIdentifier(std::string_view text) {
  return !text.empty() && isLetter(text.front()) &&
         std::all_of(text.begin(), text.end(),
                     [](char c) { return isLetter(c) || isDigit(c); });
}
