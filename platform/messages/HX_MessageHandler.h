// The message handler for a host: the messages so far, and where messages go.
//
//   HX_MessageHandler& handler = HX_MessageHandler::instance();
//   handler.setSink([](const HX_Message& m) { log << m.text << '\n'; });
//   ...
//   for (const HX_Message& m : handler.messages()) ...

#ifndef PLATFORM_MESSAGES_HX_MESSAGEHANDLER_H
#define PLATFORM_MESSAGES_HX_MESSAGEHANDLER_H

#include <cstdarg>
#include <functional>
#include <string>
#include <vector>

#include "platform/HX_PlatformExport.h"

class HxCSrcRef;
template <class>
union HX_NeverDestroyed;

/// A reported message. Texts are ISO-8859-1.
struct HX_Message {
  int row = 0;       ///< row of the catalogue
  int id = 0;        ///< the number a user sees; 0 if the row is not known
  int severity = 0;  ///< 0 to 7, as for ERR_EmitErrorMessage()
  const HxCSrcRef* srcRef = nullptr;  ///< not owned, may be gone by now
  std::string source;                 ///< the reference's text, or empty
  std::string text;                   ///< formatted
};

/// Records every message and hands the message on. Records are kept until
/// clear().
class HX_PLATFORM_API HX_MessageHandler {
 public:
  /// Receives a message; the message is valid during the call only.
  using Sink = std::function<void(const HX_Message&)>;
  /// Receives file, line and expression; answers 1 to debug.
  using DebugReport = std::function<int(const char*, int, const char*)>;

  /// The handler of the process. Destructors of static objects may still
  /// report: the end of the process does not destroy the handler.
  static HX_MessageHandler& instance();

  /// Every message since the last clear(), in the order of reporting.
  const std::vector<HX_Message>& messages() const { return m_Messages; }
  /// Forgets the messages and the error status.
  void clear();
  /// See ERR_get_errstatus().
  int errorStatus() const { return m_Status; }

  /// Every message goes to \p sink once, after the record. The default writes a
  /// line to standard error; an empty sink drops messages.
  void setSink(Sink sink) { m_Sink = std::move(sink); }
  static void writeToStandardError(const HX_Message& message);

  /// The answer of ShowInternalInfo(): whether debug checks report.
  void setShowInternalInfo(bool show) { m_ShowInternalInfo = show; }
  bool showInternalInfo() const { return m_ShowInternalInfo; }

  /// Replaces the line of a debug report on standard error.
  void setDebugReport(DebugReport report) { m_DebugReport = std::move(report); }
  int debugReport(const char* file, int line, const char* expression);

  /// Formats and records a message; see ERR_EmitErrorMessage(). Numbers have a
  /// decimal point in every locale. Without memory the message is not recorded;
  /// status and sink take the message, whose texts may be missing then.
  void emit(int severity, const HxCSrcRef* srcRef, int row,
            std::va_list arguments);

  /// "note", "warning", "error", "fatal error", or the same after "internal ".
  static const char* severityName(int severity);

 private:
  template <class>
  friend union HX_NeverDestroyed;
  HX_MessageHandler() = default;

  std::vector<HX_Message> m_Messages;
  Sink m_Sink = &HX_MessageHandler::writeToStandardError;
  DebugReport m_DebugReport;
  int m_Status = 0;
  bool m_ShowInternalInfo = false;
};

#endif  // PLATFORM_MESSAGES_HX_MESSAGEHANDLER_H
