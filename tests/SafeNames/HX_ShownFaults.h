// The faults of a refused text, for comparison.

#ifndef SAFENAMES_HX_SHOWNFAULTS_H
#define SAFENAMES_HX_SHOWNFAULTS_H

#include <string>

#include "SafeNames/HX_TextFaults.h"

/// "1: text; 3: text", with " of N" if some were not kept.
inline std::string HX_ShownFaults(const HX_TextFaults& faults) {
  std::string text;
  for (int i = 0; i < faults.kept(); ++i)
    text += (i == 0 ? "" : "; ") + std::to_string(faults[i].line) + ": " +
            faults[i].text.cstring();
  if (faults.count() > faults.kept())
    text += " of " + std::to_string(faults.count());
  return text;
}

#endif  // SAFENAMES_HX_SHOWNFAULTS_H
