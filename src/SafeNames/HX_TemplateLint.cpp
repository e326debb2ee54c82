#include "SafeNames/HX_TemplateLint.h"

#include <cstring>
#include <iterator>
#include <new>

#include "Control/HX_Memory.h"
#include "SafeNames/HX_ReservedNames.h"
#include "implContainers/HX_Vector.h"

namespace {

constexpr int kUnknownMessage = 1203;

// Longest value of the macros whose values have a bound: a count of times is a
// 32-bit number, "ACYCLIC" is shorter than any pair of counts.
struct BoundRow {
  const char* head;  // begin of the macro
  int longest;
};
constexpr BoundRow kBounds[] = {
    {"$$", 1},         {"$R", 0},      {"$(Time)", 25},  {"$(Period)", 12},
    {"$(Offset)", 12}, {"$(Time", 21}, {"$(Period", 10}, {"$(Offset", 10},
};

// Macros that mark a name changeable.
constexpr const char* kChanging[] = {"$R", "$S", "$C"};

// Samples of macro values: a pattern that matches with all samples depends on
// literal text alone.
constexpr const char* kValues[] = {"", "a", "Q", "_1", "z_q", "x0"};

int boundOf(const HX_TemplateLint::Macro& macro) {
  // Text of an unknown macro stays in the name.
  if (macro.row == nullptr) return macro.text.length();
  for (const BoundRow& row : kBounds)
    if (std::strncmp(macro.row->text, row.head, std::strlen(row.head)) == 0)
      return row.longest;
  return -1;
}

bool isChanging(const HX_TemplateLint::Macro& macro) {
  if (macro.row == nullptr) return false;
  for (const char* const text : kChanging)
    if (std::strcmp(macro.row->text, text) == 0) return true;
  return false;
}

// The length of the group in parentheses at \p from, 0 for none; parentheses
// between single quotes do not count, an unclosed group ends with the text.
int groupLength(const KyCXString& text, int from) {
  if (text[from] != '(') return 0;
  int depth = 0;
  bool isQuoted = false;
  int at = from;
  do {
    const unsigned short unit = text[at];
    if (unit == '\'') isQuoted = !isQuoted;
    if (!isQuoted && unit == '(') ++depth;
    if (!isQuoted && unit == ')') --depth;
    ++at;
  } while (depth > 0 && at < text.length());
  return at - from;
}

}  // namespace

struct HX_TemplateLint::Content : HX_Allocated {
  // Literal text or a macro of the actual template.
  struct Piece {
    KyCXString literal;
    int macro;  // index; -1 for literal text
  };

  void readPart(const KyCXString& part, int position, bool isFormal);
  int readMacro(const KyCXString& part, int at, Macro& macro);

  HX_Vector<Macro> macros;
  HX_Vector<Piece> actual;
  bool isUnclosed = false;
};

// RETURNS: the number of characters; all of the rest for an unclosed "$(".
int HX_TemplateLint::Content::readMacro(const KyCXString& part, int at,
                                        Macro& macro) {
  macro.row = HX_FindMacro(part, at);
  macro.message = macro.row == nullptr ? kUnknownMessage : macro.row->message;
  if (part[at + 1] == '(') {
    const int close = part.find(KyCXString(")"), at);
    return close < 0 ? -1 : close + 1 - at;
  }
  if (part[at + 1] == 'E') return 2 + groupLength(part, at + 2);
  return at + 1 < part.length() ? 2 : 1;
}

void HX_TemplateLint::Content::readPart(const KyCXString& part, int position,
                                        bool isFormal) {
  const auto addLiteral = [&](int from, int to) {
    if (!isFormal && from <= to) actual.push_back({part.sub(from, to), -1});
  };
  int from = 0;
  while (from < part.length()) {
    const int dollar = part.find(KyCXString("$"), from);
    if (dollar < 0) break;
    Macro macro;
    const int length = readMacro(part, dollar, macro);
    if (length < 0) {
      isUnclosed = true;
      break;
    }
    addLiteral(from, dollar - 1);
    macro.text = part.sub(dollar, dollar + length - 1);
    macro.position = position + dollar;
    macro.isFormal = isFormal;
    macros.push_back(macro);
    if (!isFormal)
      actual.push_back({KyCXString(), static_cast<int>(macros.size()) - 1});
    from = dollar + length;
  }
  addLiteral(from, part.length() - 1);
}

HX_TemplateLint::HX_TemplateLint() : m_pContent(new Content) {}

HX_TemplateLint::~HX_TemplateLint() { delete m_pContent; }

bool HX_TemplateLint::read(const KyCXString& form) {
  m_PartCount = 1;
  m_FixedLength = 0;
  m_Longest = 0;
  m_IsUnclosed = false;
  m_MayChange = true;
  if (m_pContent == nullptr) return false;
  m_pContent->macros.clear();
  m_pContent->actual.clear();
  m_pContent->isUnclosed = false;
  const bool isRead = HX_WithinMemory([&] {
    const KyCXString colon(":");
    const int first = form.find(colon, 0);
    if (first < 0) return m_pContent->readPart(form, 0, false);
    for (int at = first; at >= 0; at = form.find(colon, at + 1)) ++m_PartCount;
    int end = form.find(colon, first + 1);
    if (end < 0) end = form.length();
    m_pContent->readPart(form.head(first), 0, true);
    m_pContent->readPart(form.sub(first + 1, end - 1), first + 1, false);
    m_MayChange = false;
  });
  if (!isRead) {
    m_pContent->macros.clear();
    m_pContent->actual.clear();
    m_PartCount = 1;
    return false;
  }
  m_IsUnclosed = m_pContent->isUnclosed;
  for (const Content::Piece& piece : m_pContent->actual) {
    if (piece.macro < 0) {
      m_FixedLength += piece.literal.length();
      if (m_Longest >= 0) m_Longest += piece.literal.length();
      continue;
    }
    const Macro& used = macro(piece.macro);
    const int bound = boundOf(used);
    if (used.row == nullptr) m_FixedLength += bound;
    m_Longest = bound < 0 || m_Longest < 0 ? -1 : m_Longest + bound;
    m_MayChange = m_MayChange || isChanging(used);
  }
  return true;
}

int HX_TemplateLint::macroCount() const {
  return m_pContent == nullptr ? 0
                               : static_cast<int>(m_pContent->macros.size());
}

const HX_TemplateLint::Macro& HX_TemplateLint::macro(int index) const {
  return m_pContent->macros[HX_ToSize(index)];
}

unsigned int HX_TemplateLint::alwaysMatching(unsigned int patterns,
                                             bool isAtFileScope) const {
  if (m_pContent == nullptr) return 0;
  return HX_WithinMemory(0U, [&] {
    for (const char* const value : kValues) {
      KyCXString name;
      for (const Content::Piece& piece : m_pContent->actual) {
        if (piece.macro < 0)
          name += piece.literal;
        else if (macro(piece.macro).row == nullptr)
          name += macro(piece.macro).text;
        else if (std::strcmp(macro(piece.macro).row->text, "$$") == 0)
          name += "$";
        else if (boundOf(macro(piece.macro)) != 0)
          name += value;
      }
      name.makeCIdentifier(false);
      unsigned int matched = 0;
      for (unsigned int bit = 1; bit != 0 && bit <= patterns; bit <<= 1)
        if ((patterns & bit) != 0)
          matched |= HX_ReservedNames::matching(name, bit, isAtFileScope);
      patterns = matched;
    }
    return patterns;
  });
}
