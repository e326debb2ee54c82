#include "Strings/HX_StringParser.h"

#include <cstring>
#include <utility>

#include "Control/HX_Memory.h"
#include "Control/HX_TextCalls.h"

namespace {

// Folder of the data dictionary for objects of user scripts, up to the name of
// the block.
constexpr char kScriptMarker[] = "CGTmpData/hxscript_";
constexpr int kScriptMarkerLength = sizeof kScriptMarker - 1;

KyCXString lowered(KyCXString text) {
  text.toLower();
  return text;
}

// RETURNS: the position of text at or behind from; missing if in does not hold
// text there or if text is empty.
int findOr(int missing, const KyCXString& in, const KyCXString& text,
           int from) {
  const int found = text.isEmpty() ? -1 : in.find(text, from);
  return found < 0 ? missing : found;
}

// RETURNS: the last index of key; -1 for an unknown key.
int lastIndexOf(const KyCXString& key, const leda::array<KyCXString>& keys) {
  int index = keys.high();
  while (index >= 0 && !(keys[index] == key)) --index;
  return index;
}

bool holds(const KyCXString& chars, unsigned short unit) {
  for (int i = 0; i < chars.length(); ++i)
    if (chars[i] == unit) return true;
  return false;
}

KyCXString stripped(const KyCXString& str, const KyCXString& chars,
                    HX_StringParser::remove_etp mode) {
  using Parser = HX_StringParser;
  int start = 0;
  int end = str.length() - 1;
  if (mode == Parser::eRemoveLeading || mode == Parser::eRemoveBoth)
    while (start <= end && holds(chars, str[start])) ++start;
  if (mode == Parser::eRemoveTrailing || mode == Parser::eRemoveBoth)
    while (end >= start && holds(chars, str[end])) --end;
  return str.sub(start, end);
}

// RETURNS: the last item not recognised. Throws std::bad_alloc.
KyCXString parsePairs(const KyCXString& str, const KyCXString& keyValueSep,
                      const KyCXString& pairSep,
                      const leda::array<KyCXString>& keys,
                      leda::array<KyCXString>& values) {
  const KyCXString lowStr = lowered(str);
  const KyCXString lowKeyValueSep = lowered(keyValueSep);
  const KyCXString lowPairSep = lowered(pairSep);
  leda::array<KyCXString> lowKeys(keys);
  for (int i = 0; i < lowKeys.size(); ++i) lowKeys[i].toLower();

  const auto strippedOfBlanks = [](const KyCXString& text) {
    return stripped(text, " ", HX_StringParser::eRemoveBoth);
  };
  KyCXString unrecognised;
  const int length = lowStr.length();
  for (int pos = 0; pos < length;) {
    const int end = findOr(length, lowStr, lowPairSep, pos);
    const int equals = findOr(-1, lowStr, lowKeyValueSep, pos);
    if (equals < 0 || equals > end) {
      KyCXString item = lowStr.sub(pos, end - 1);
      item.trim(true, true);
      if (!item.isEmpty()) unrecognised = std::move(item);
    } else {
      KyCXString key = strippedOfBlanks(lowStr.sub(pos, equals - 1));
      const int valueStart = equals + keyValueSep.length();
      const int index = lastIndexOf(key, lowKeys);
      if (index < 0)
        unrecognised = std::move(key);
      else
        values[index] = strippedOfBlanks(str.sub(valueStart, end - 1));
    }
    pos = end + pairSep.length();
  }
  return unrecognised;
}

}  // namespace

KyCXString HX_StringParser::parseKeyValuePairs(
    const KyCXString& str, const KyCXString& keyValueSep,
    const KyCXString& pairSep, const leda::array<KyCXString>& keys,
    leda::array<KyCXString>& values) const {
  return HX_WithinMemory(KyCXString(), [&] {
    // Arguments may be texts of values, so values change last.
    leda::array<KyCXString> parsed(values);
    parsed.resize(keys.size());
    KyCXString unrecognised =
        parsePairs(str, keyValueSep, pairSep, keys, parsed);
    values = std::move(parsed);
    return unrecognised;
  });
}

KyCXString HX_StringParser::removeChars(const KyCXString& str,
                                        const KyCXString& chars,
                                        remove_etp mode) const {
  return HX_WithinMemory(KyCXString(),
                         [&] { return stripped(str, chars, mode); });
}

void HX_StringParser::divideKeywordEmbeddedString(
    const KyCXString& str, const KyCXString& startKeyword,
    const KyCXString& endKeyword, KyCXString& embedded,
    KyCXString& outside) const {
  HX_WithinMemory([&] {
    const KyCXString lowStr = lowered(str);
    const KyCXString start = lowered(startKeyword);
    const KyCXString stop = lowered(endKeyword);
    KyCXString inside;
    KyCXString rest;
    const int length = lowStr.length();
    for (int pos = 0; pos < length;) {
      const int open = findOr(length, lowStr, start, pos);
      HX_AppendSub(rest, str, pos, open - 1);
      if (open == length) break;
      const int body = open + start.length();
      const int close = findOr(length, lowStr, stop, body);
      HX_AppendSub(inside, str, body, close - 1);
      pos = close + stop.length();
    }
    embedded = std::move(inside);
    outside = std::move(rest);
  });
}

void HX_StringParser::processDDPath(const KyCXString& path,
                                    KyCXString& text) const {
  HX_WithinMemory([&] {
    const int marker = path.find(kScriptMarker, 0);
    const int block = marker + kScriptMarkerLength;
    const int slash = marker < 0 ? -1 : path.find('/', block);
    if (slash < 0) {
      text = path;
      return;
    }
    const int second = path.find('/', slash + 1);
    const int object = (second < 0 ? slash : second) + 1;
    KyCXString description("User script object ");
    HX_AppendSub(description, path, object, path.length() - 1);
    description += " of block ";
    HX_AppendSub(description, path, block, slash - 1);
    text = std::move(description);
  });
}
