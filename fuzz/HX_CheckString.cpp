// The string class against a plain class over std::wstring.
#include <climits>
#include <map>
#include <regex>
#include <sstream>

#include "fuzz/HX_Fuzz.h"

namespace {

constexpr wchar_t kNameUnits[] =
    L"_0123456789abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ";

// The operations of KyCXString in the plainest form. What may be a part of the
// text itself is taken as a copy.
struct PlainString : std::wstring {
  PlainString() = default;
  PlainString(std::wstring units) : std::wstring(std::move(units)) {}
  PlainString(const KyCXString& text) {
    for (int i = 0; i < text.length(); ++i) push_back(text[i]);
  }
  PlainString(const char* text) : PlainString(KyCXString(text)) {}
  PlainString(char character) : PlainString(KyCXString(character)) {}

  int length() const { return static_cast<int>(size()); }
  int operator[](int at) const {
    return at < 0 || at >= length() ? 0 : data()[at];
  }
  const char* cstring() const {
    m_Narrow.clear();
    for (const wchar_t unit : *this)
      m_Narrow += static_cast<char>(unit > 0xFF ? '?' : unit);
    return m_Narrow.c_str();
  }
  void operator+=(const PlainString& text) { append(text); }
  int find(const PlainString& text, int from) const {
    const auto start = static_cast<std::size_t>(std::max(from, 0));
    return static_cast<int>(std::wstring::find(text, start));
  }
  bool startsWith(const PlainString& text) const { return starts_with(text); }
  int compareWith(const PlainString& text) const { return compare(text); }
  PlainString sub(int from, int to) const {
    PlainString part;
    for (int i = std::max(from, 0); i <= std::min(to, length() - 1); ++i)
      part.push_back(data()[i]);
    return part;
  }
  PlainString head(int count) const { return sub(0, std::max(count, 0) - 1); }
  void appendSub(const PlainString& text, int from, int to) {
    *this += text.sub(from, to);
  }

  void replace(PlainString what, PlainString by) {
    int at = what.empty() ? -1 : find(what, 0);
    for (; at >= 0; at = find(what, at + by.length()))
      std::wstring::replace(static_cast<std::size_t>(at), what.size(), by);
  }
  void trim(bool leading, bool trailing) {
    if (leading) edit(L"^[ \t\n\v\f\r]+", L"");
    if (trailing) edit(L"[ \t\n\v\f\r]+$", L"");
  }
  void replaceWhiteSpace(char by, bool collapse) {
    edit(collapse ? L"[ \t\n\v\f\r]+" : L"[ \t\n\v\f\r]", PlainString(by));
  }
  void filterAngleBrackets() {
    if (size() >= 2 && front() == L'<' && back() == L'>')
      *this = sub(1, length() - 2);
  }
  void makeCIdentifier(bool collapse) {
    edit(collapse ? L"[^A-Za-z0-9_]+" : L"[^A-Za-z0-9_]", L"_");
    edit(L"^[0-9]", L"_$&");
  }
  bool isValidCIdentifier() const {
    return !empty() && (front() < L'0' || front() > L'9') &&
           find_first_not_of(kNameUnits) == npos;
  }
  void toLower() {
    for (wchar_t& unit : *this)
      if (unit >= L'A' && unit <= L'Z') unit += L'a' - L'A';
  }
  void toUpper() {
    for (wchar_t& unit : *this)
      if (unit >= L'a' && unit <= L'z') unit -= L'a' - L'A';
  }
  void shortenString(int limit, int marks, char fill,
                     KyCXString::ScEPosition position) {
    limit = std::max(limit, 0);
    marks = std::max(marks, 0);
    if (length() <= limit) return;
    const int room = limit - marks;
    const int tails[] = {room, room / 2, 0};
    const int tail = room > 0 ? tails[position] : limit;
    if (room <= 0) marks = 0;
    *this = head(room - tail) +
            std::wstring(static_cast<std::size_t>(marks),
                         PlainString(fill).front()) +
            sub(length() - tail, length());
  }

 private:
  void edit(const wchar_t* pattern, const std::wstring& by) {
    static std::map<std::wstring, std::wregex> s_compiled;
    const auto& compiled =
        s_compiled.try_emplace(pattern, pattern).first->second;
    assign(std::regex_replace(*this, compiled, by));
  }

  mutable std::string m_Narrow;
};

void read(KyCXString& text, HX_Bytes& bytes) { text = bytes.text(); }

// Not through the class under check.
void read(PlainString& text, HX_Bytes& bytes) {
  for (const char c : bytes.line()) text.push_back(HX_Bytes::unitOf(c));
}

// What a change or a question is given.
template <class Text>
struct Arguments {
  const Text &one, &two;  // each may be the changed text itself
  Text given;
  int from, to;
  char character;
  bool first, second;
  KyCXString::ScEPosition position;
};

// Every change works on both classes; a moved text is empty.
template <class Text>
constexpr void (*kChanges[])(Text& t, const Arguments<Text>& a) = {
    [](auto& t, auto& a) { t = a.given; },
    [](auto& t, auto& a) { t = a.one; },
    [](auto& t, auto& a) { t += a.one; },
    [](auto& t, auto& a) { t += a.one.cstring(); },
    [](auto& t, auto& a) { t += a.character; },
    [](auto& t, auto&) { t = t.cstring() + std::min(t.length(), 3); },
    [](auto& t, auto&) {
      Text moved(std::move(t));
      t += moved;
    },
    [](auto& t, auto& a) { t = t.sub(a.from, a.to); },
    [](auto& t, auto& a) { t = t.head(a.from); },
    [](auto& t, auto& a) { t.appendSub(a.one, a.from, a.to); },
    [](auto& t, auto& a) { t.replace(a.one, a.two); },
    [](auto& t, auto& a) { t.trim(a.first, a.second); },
    [](auto& t, auto& a) { t.replaceWhiteSpace(a.character, a.first); },
    [](auto& t, auto&) { t.filterAngleBrackets(); },
    [](auto& t, auto& a) { t.makeCIdentifier(a.first); },
    [](auto& t, auto&) { t.toLower(); },
    [](auto& t, auto&) { t.toUpper(); },
    [](auto& t, auto& a) {
      t.shortenString(a.from, a.to % 4, a.character, a.position);
    },
};

// What can be asked of a text.
template <class Text>
std::string answers(const Text& t, const Arguments<Text>& a) {
  std::ostringstream out;
  for (int i = -1; i <= t.length(); ++i) out << t[i] << ' ';
  out << t[INT_MIN] << t[INT_MAX] << ' ' << t.find(a.one, a.from) << ' '
      << t.find(a.character, a.from) << ' ' << t.isValidCIdentifier()
      << t.startsWith(a.one) << (t == a.one) << (t < a.one)
      << (t.compareWith(a.one) > 0) << Text(t + a.one).cstring()
      << std::string(t.cstring(), static_cast<std::size_t>(t.length()) + 1);
  return out.str();
}

int position(HX_Bytes& bytes) {
  const int number = bytes.number();
  return number < 2 ? (number == 0 ? INT_MIN : INT_MAX) : number % 50 - 5;
}

// Changes the first or the second text; gives the answers of the text.
template <class Text>
std::string step(Text* texts, HX_Bytes& bytes) {
  const int change = bytes.below(static_cast<int>(std::size(kChanges<Text>)));
  const int choice = bytes.number();
  Text given;
  if (change == 0) read(given, bytes);
  const Arguments<Text> arguments{
      texts[choice % 2],
      texts[choice / 2 % 2],
      given,
      position(bytes),
      position(bytes),
      static_cast<char>(bytes.number()),
      choice / 4 % 2 != 0,
      choice / 8 % 2 != 0,
      static_cast<KyCXString::ScEPosition>(choice / 16 % 3)};
  Text& text = texts[choice / 64 % 2];
  kChanges<Text>[change](text, arguments);
  const std::string result = answers(text, arguments);
  if (text.length() > 100) text = "";
  return result;
}

void checkSplit(const KyCXString& text, char separator) {
  leda::array<KyCXString> parts;
  text.split(separator, parts);
  KyCXString joined;
  for (const KyCXString& part : parts) {
    HX_Require(part.find(separator) < 0, "no separator in a part");
    joined += part;
    joined += separator;
  }
  HX_Require(joined == text + KyCXString(separator), "parts joined");
}

}  // namespace

void HX_CheckString(HX_Bytes& bytes) {
  KyCXString texts[2];
  PlainString plain[2];
  while (!bytes.isEmpty()) {
    HX_Bytes same(bytes);
    const std::string expected = step(plain, same);
    const std::string result = step(texts, bytes);
    HX_Require(result == expected, result + " is " + expected);
    checkSplit(texts[0], '_');
  }
}
