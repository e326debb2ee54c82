#include "host/base/HX_JsonWriter.h"

#include <ostream>

#include "host/base/HX_Text.h"

void HX_TextPieces::flush() {
  m_Out.write(text.data(), static_cast<std::streamsize>(text.size()));
  text.clear();
}

void HX_JsonWriter::open(char bracket) {
  m_Pieces.text += bracket;
  ++m_Depth;
  m_IsEmpty = true;
}

void HX_JsonWriter::close(char bracket) {
  --m_Depth;
  if (!m_IsEmpty) newLine();
  m_Pieces.text += bracket;
  m_IsEmpty = false;
  m_Pieces.endPiece();
}

void HX_JsonWriter::next() {
  if (!m_IsEmpty) m_Pieces.text += ',';
  newLine();
  m_IsEmpty = false;
}

void HX_JsonWriter::newLine() {
  if (m_Indent == kOneLine) return;
  m_Pieces.text += '\n';
  m_Pieces.text.append(m_Depth * m_Indent, ' ');
}

void HX_JsonWriter::key(std::string_view name) {
  next();
  text(name);
  raw(": ");
}

void HX_JsonWriter::text(std::string_view value) {
  HX_AppendJson(m_Pieces.text, value);
}

void HX_JsonWriter::element(std::string_view value) {
  next();
  text(value);
  m_Pieces.endPiece();
}

void HX_JsonWriter::field(std::string_view name, std::string_view value) {
  key(name);
  text(value);
}

void HX_JsonWriter::rawField(std::string_view name, std::string_view json) {
  key(name);
  raw(json);
}
