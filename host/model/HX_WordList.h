// A file of reserved words: one C name on a line, '#' begins a comment.

#ifndef HOST_MODEL_HX_WORDLIST_H
#define HOST_MODEL_HX_WORDLIST_H

#include <filesystem>
#include <set>
#include <string>

/// Adds the words of the file to \p words. Blanks around words, blank lines,
/// line ends of Windows and a byte order mark are allowed. Throws
/// HX_DocumentError for lines that are no names and for a file without words.
/// \return false if the file cannot be read
bool HX_ReadWordList(const std::filesystem::path& file,
                     std::set<std::string>& words);

#endif  // HOST_MODEL_HX_WORDLIST_H
