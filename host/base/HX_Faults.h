// The faults of a text file: a line per fault, in the form of compilers.
//
//   HX_Faults faults;
//   faults.add(place, "7", "a text");
//   if (faults.count() > 0) throw HX_DocumentError(...);

#ifndef HOST_BASE_HX_FAULTS_H
#define HOST_BASE_HX_FAULTS_H

#include <cstddef>
#include <cstdint>
#include <map>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

#include "host/messages/HX_Diagnostic.h"
#include "host/messages/HX_MessageTable.h"

/// The place of a token of a document: the end, in bytes from the start.
using HX_TokenEnd = std::uint32_t;

/// A line about an unreadable file, or about an argument without an item.
class HX_InputError : public std::runtime_error {
 public:
  explicit HX_InputError(const std::string& text,
                         HX_MessageNumber of = kHxUnreadable)
      : std::runtime_error(text), number(of) {}

  const HX_MessageNumber number;
};

/// The faults of a document. The text has a line for each fault, which begins
/// with the file.
class HX_DocumentError : public std::runtime_error {
 public:
  explicit HX_DocumentError(const std::vector<HX_Diagnostic>& list);

  const std::vector<HX_Diagnostic> faults;
};

/// A place as editors count. Both count from 1, columns in characters.
struct HX_TextPlace {
  int line;
  int column;
};
HX_TextPlace HX_PlaceIn(std::string_view text, std::size_t place);
/// RETURNS: "line:column" of \p place in \p text.
std::string HX_LineAndColumn(std::string_view text, std::size_t place);

/// Keeps the first 20 faults by place and counts all faults.
class HX_Faults {
 public:
  /// \param place  in bytes from the start; behind the token for documents
  void add(std::size_t place, const std::string& found,
           const std::string& expected,
           HX_MessageNumber number = kHxBadContent);
  std::size_t count() const { return m_Count; }

  struct Fault {
    std::string found;
    std::string expected;
    HX_MessageNumber number;
  };
  /// The kept faults by place; equal places in the order of add().
  const std::multimap<std::size_t, Fault>& kept() const { return m_Kept; }
  /// Adds what stands behind the kept faults: "... and 3 more".
  void addRest(std::vector<HX_Diagnostic>& list) const;

 private:
  std::multimap<std::size_t, Fault> m_Kept;
  std::size_t m_Count = 0;
};

#endif  // HOST_BASE_HX_FAULTS_H
