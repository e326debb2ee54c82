// Writes JSON as it goes: one value on a line, deeper lines indented.
//
//   HX_JsonWriter json(out, 2);
//   json.open('{');
//   json.field("id", "v1");
//   json.key("parts");
//   json.open('[');
//   json.element("a");
//   json.close(']');
//   json.close('}');

#ifndef HOST_BASE_HX_JSONWRITER_H
#define HOST_BASE_HX_JSONWRITER_H

#include <cstddef>
#include <iosfwd>
#include <string>
#include <string_view>

/// Text on the way to a stream, in pieces of 64 KiB.
class HX_TextPieces {
 public:
  explicit HX_TextPieces(std::ostream& out) : m_Out(out) {}
  HX_TextPieces(const HX_TextPieces&) = delete;
  HX_TextPieces& operator=(const HX_TextPieces&) = delete;
  ~HX_TextPieces() { flush(); }

  /// Hands the text on once it is long enough.
  void endPiece() {
    constexpr std::size_t kEnough = 65536;
    if (text.size() >= kEnough) flush();
  }

  std::string text;

 private:
  void flush();

  std::ostream& m_Out;
};

/// REQUIRES: brackets in pairs; a key before each value of an object.
class HX_JsonWriter {
 public:
  /// \param indent  blanks per level; kOneLine for a document on a line
  HX_JsonWriter(std::ostream& out, std::size_t indent)
      : m_Pieces(out), m_Indent(indent) {}

  static constexpr std::size_t kOneLine = static_cast<std::size_t>(-1);

  void open(char bracket);
  void close(char bracket);
  /// Begins a line for an element of a list, or for a key.
  void next();
  void key(std::string_view name);
  /// Appends digits, true, false, or any other JSON.
  void raw(std::string_view json) { m_Pieces.text += json; }
  void text(std::string_view value);
  void element(std::string_view value);
  void field(std::string_view name, std::string_view value);
  void rawField(std::string_view name, std::string_view json);
  /// Ends the document with a line feed.
  void end() { raw("\n"); }

 private:
  void newLine();

  HX_TextPieces m_Pieces;
  std::size_t m_Indent;
  std::size_t m_Depth = 0;
  bool m_IsEmpty = true;  // the innermost list or object
};

#endif  // HOST_BASE_HX_JSONWRITER_H
