// Faults of a refused text file with their line numbers.
//
//   HX_TextFaults faults;
//   if (!words.readText("mine", text, length, faults))
//     for (int i = 0; i < faults.kept(); ++i)
//       print(faults[i].line, faults[i].text);

#ifndef SAFENAMES_HX_TEXTFAULTS_H
#define SAFENAMES_HX_TEXTFAULTS_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/strings/KyCXString.h"

/// Keeps the first 20 faults and counts all.
class HX_UTILS_API HX_TextFaults : public HX_Allocated {
 public:
  /// Fault in a line.
  struct Fault {
    int line = 0;     ///< from 1; 0 for the file as a whole
    KyCXString text;  ///< "expected ..., found ..."; empty without memory
  };

  /// Appends a fault.
  void add(int line, const char* text);
  /// The number of faults so far, kept or not.
  int count() const { return m_Count; }
  /// The number of faults that operator[] gives.
  int kept() const { return m_Count < kKept ? m_Count : kKept; }
  /// \p index lies in [0, kept()).
  const Fault& operator[](int index) const { return m_Faults[index]; }

 private:
  static constexpr int kKept = 20;

  int m_Count = 0;
  Fault m_Faults[kKept];
};

#endif  // SAFENAMES_HX_TEXTFAULTS_H
