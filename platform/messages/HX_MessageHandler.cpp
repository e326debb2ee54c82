#include "platform/messages/HX_MessageHandler.h"

#include <locale.h>

#if defined(_WIN32)
#include <intrin.h>
#endif

#include <algorithm>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <new>

#include "Control/ERR_Catalogue.h"
#include "SourceRef/HxCSrcRef.h"
#include "platform/HX_NeverDestroyed.h"
#include "platform/messages/ERR_MessageHandler.h"
#include "platform/strings/KyCXString.h"

namespace {

// Numbers are written with a decimal point in every locale of the process, as
// long as an object of the class lives.
#if defined(_WIN32)
class PlainNumbers {
 public:
  PlainNumbers()
      : m_OldMode(_configthreadlocale(_ENABLE_PER_THREAD_LOCALE)),
        m_Old(setlocale(LC_NUMERIC, nullptr)) {
    setlocale(LC_NUMERIC, "C");
  }
  PlainNumbers(const PlainNumbers&) = delete;
  PlainNumbers& operator=(const PlainNumbers&) = delete;
  ~PlainNumbers() {
    setlocale(LC_NUMERIC, m_Old.c_str());
    _configthreadlocale(m_OldMode);
  }

 private:
  int m_OldMode;
  std::string m_Old;
};
#else
class PlainNumbers {
 public:
  PlainNumbers() {
    static const locale_t s_plain = newlocale(LC_ALL_MASK, "C", nullptr);
    m_Old = uselocale(s_plain);
  }
  PlainNumbers(const PlainNumbers&) = delete;
  PlainNumbers& operator=(const PlainNumbers&) = delete;
  ~PlainNumbers() { uselocale(m_Old); }

 private:
  locale_t m_Old;
};
#endif

std::string format(const char* text, std::va_list arguments) {
  const PlainNumbers plain;
  std::va_list again;
  va_copy(again, arguments);
  const int length = std::vsnprintf(nullptr, 0, text, arguments);
  std::string result(static_cast<std::size_t>(std::max(length, 0)), '\0');
  std::vsnprintf(result.data(), result.size() + 1, text, again);
  va_end(again);
  return result;
}

}  // namespace

HX_MessageHandler& HX_MessageHandler::instance() {
  static HX_NeverDestroyed<HX_MessageHandler> s_handler;
  return s_handler.value;
}

void HX_MessageHandler::clear() {
  m_Messages.clear();
  m_Status = 0;
}

void HX_MessageHandler::emit(int severity, const HxCSrcRef* srcRef, int row,
                             std::va_list arguments) {
  m_Status = std::max(m_Status, severity & 3);
  const ERR_CatalogueRow* entry = ERR_FindRow(row);
  HX_Message message;
  message.row = row;
  message.id = entry == nullptr ? 0 : entry->id;
  message.severity = severity;
  message.srcRef = srcRef;
  try {
    if (srcRef != nullptr) {
      KyCXString source;
      srcRef->toString(source);
      message.source = source.cstring();
    }
    if (entry != nullptr) message.text = format(entry->text, arguments);
    m_Messages.push_back(message);
  } catch (const std::bad_alloc&) {
    // The sink still hears of the message, with the texts that are there.
  }
  if (m_Sink) m_Sink(message);
}

void HX_MessageHandler::writeToStandardError(const HX_Message& message) {
  std::fprintf(stderr, "%d %s: %s%s%s%s\n", message.id,
               severityName(message.severity), message.text.c_str(),
               message.source.empty() ? "" : " [", message.source.c_str(),
               message.source.empty() ? "" : "]");
}

int HX_MessageHandler::debugReport(const char* file, int line,
                                   const char* expression) {
  if (m_DebugReport) return m_DebugReport(file, line, expression);
  std::fprintf(stderr, "%s:%d: check failed: %s\n", file, line, expression);
  return 0;
}

const char* HX_MessageHandler::severityName(int severity) {
  static constexpr const char* kNames[] = {
      "note",           "warning",
      "error",          "fatal error",
      "internal note",  "internal warning",
      "internal error", "internal fatal error"};
  return kNames[severity & 7];
}

void ERR_EmitErrorMessage(int severity, const HxCSrcRef* srcRef,
                          int messageNumber, ...) {
  std::va_list arguments;
  va_start(arguments, messageNumber);
  HX_MessageHandler::instance().emit(severity, srcRef, messageNumber,
                                     arguments);
  va_end(arguments);
}

int ERR_get_errstatus() { return HX_MessageHandler::instance().errorStatus(); }

bool ShowInternalInfo() {
  return HX_MessageHandler::instance().showInternalInfo();
}

int HX_DebugReport(const char* file, int line, const char* expression) {
  return HX_MessageHandler::instance().debugReport(file, line, expression);
}

void HX_DebugBreak() {
#if defined(_WIN32)
  __debugbreak();
#else
  std::raise(SIGTRAP);
#endif
}
