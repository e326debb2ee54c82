// Warnings and notes of an import, by first occurrence.
//
//   notes.add("warning", "the model 'ekf2' was not found", "Controller/ekf2");
//   notes.add("warning", "the model 'ekf2' was not found", "Backup/ekf2");
//   // warning: the model 'ekf2' was not found (Controller/ekf2 and 1 more)

#ifndef HOST_IMPORT_HX_NOTES_H
#define HOST_IMPORT_HX_NOTES_H

#include <map>
#include <string>
#include <vector>

class HX_Notes {
 public:
  /// Equal texts become a single line with the first place and the number of
  /// further places.
  void add(const char* severity, const std::string& text,
           const std::string& place);

  /// A line per text.
  std::vector<std::string> lines() const;

 private:
  struct Note {
    std::string text;  // with the severity
    std::string firstPlace;
    int count;
  };

  std::vector<Note> m_Notes;
  std::map<std::string, std::size_t> m_Known;
};

#endif  // HOST_IMPORT_HX_NOTES_H
