// Pieces of C: comments, numbers, and lines that no compiler finds too long.

#ifndef HOST_WRITE_HX_CTEXT_H
#define HOST_WRITE_HX_CTEXT_H

#include <cstdint>
#include <iosfwd>
#include <string>

/// \p text as the inside of a comment: the comment does not end early, has no
/// trigraph, no control characters, and none that turn the direction of text.
std::string HX_CommentText(const std::string& text);

/// A comment on lines of its own.
std::string HX_Comment(const std::string& text);

/// Breaks the lines of \p text at blanks. C90 compilers need to take lines of
/// 509 characters only.
/// \param indent  put in front of the second line and the lines behind
std::string HX_Wrapped(const std::string& text, const std::string& indent);

/// The shortest decimal with exactly this value, in any locale.
std::string HX_FloatText(float value);
std::string HX_DoubleText(double value);

/// C has no literal for the smallest integer.
std::string HX_SignedText(std::int64_t value);

/// Two words of 32 bits, low word first.
std::string HX_WordsText(std::uint64_t bits, bool isSigned);

/// A file that counts its lines.
class HX_CFile {
 public:
  explicit HX_CFile(std::ostream& out) : m_Out(out) {}
  HX_CFile& operator<<(const std::string& text);
  HX_CFile& operator<<(const char* text) { return *this << std::string(text); }
  /// The line that the next character goes to, from 1.
  int line() const { return m_Line; }

 private:
  std::ostream& m_Out;
  int m_Line = 1;
};

#endif  // HOST_WRITE_HX_CTEXT_H
