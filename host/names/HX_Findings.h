// What a user is told about a model: messages of the library and remarks of
// the program.
//
//   std::vector<HX_Finding> findings;
//   {
//     const HX_MessageCollector collector(findings);
//     names.isStringValidCVariableName("int");
//   }
//   // findings[0].text == "C keyword int used as identifier."

#ifndef HOST_NAMES_HX_FINDINGS_H
#define HOST_NAMES_HX_FINDINGS_H

#include <initializer_list>
#include <string>
#include <string_view>
#include <vector>

#include "host/messages/HX_MessageTable.h"

/// Texts are UTF-8.
struct HX_Finding {
  /// The first two severities of the library; higher values exist.
  enum HxESeverityTag { eNote = 0, eWarning = 1, eError = 2 };

  int id;  ///< number of the message, of the library or of the program
  int severity;
  std::string text;
  std::string source;  // may be empty

  bool isError() const { return severity % 4 >= eError; }
};

/// A remark of the program.
HX_Finding HX_Remark(HX_MessageNumber number,
                     std::initializer_list<std::string_view> arguments,
                     const std::string& source);

/// Collects the messages that the library reports during the life of the
/// collector. A collector inside the life of an outer collector takes the
/// messages alone. The message handler keeps no message.
class HX_MessageCollector {
 public:
  /// Messages are appended to \p findings.
  explicit HX_MessageCollector(std::vector<HX_Finding>& findings);
  HX_MessageCollector(const HX_MessageCollector&) = delete;
  HX_MessageCollector& operator=(const HX_MessageCollector&) = delete;
  ~HX_MessageCollector();

 private:
  static void direct(HX_MessageCollector* collector);

  static HX_MessageCollector* s_Current;
  std::vector<HX_Finding>& m_Findings;
  HX_MessageCollector* m_Outer;
};

#endif  // HOST_NAMES_HX_FINDINGS_H
