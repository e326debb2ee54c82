#include "host/import/HX_Notes.h"

void HX_Notes::add(const char* severity, const std::string& text,
                   const std::string& place) {
  const std::string line = std::string(severity) + ": " + text;
  const auto [known, isNew] = m_Known.try_emplace(line, m_Notes.size());
  if (isNew)
    m_Notes.push_back({line, place, 1});
  else
    ++m_Notes[known->second].count;
}

std::vector<std::string> HX_Notes::lines() const {
  std::vector<std::string> lines;
  for (const Note& note : m_Notes) {
    std::string line = note.text;
    if (!note.firstPlace.empty()) line += " (" + note.firstPlace;
    if (note.count > 1)
      line += (note.firstPlace.empty() ? " (" : " and ") +
              std::to_string(note.count - 1) + " more";
    if (line.size() > note.text.size()) line += ")";
    lines.push_back(line);
  }
  return lines;
}
