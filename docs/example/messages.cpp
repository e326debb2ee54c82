// The messages of the platform layer, the generator's own way: counted, and
// written without ids. Implements platform/messages/ERR_MessageHandler.h.
#include "messages.h"

#include <algorithm>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>

#include "Control/ERR_Catalogue.h"
#include "platform/messages/ERR_MessageHandler.h"

namespace {

int s_Problems = 0;
int s_Status = 0;

}  // namespace

int reportedProblems() { return s_Problems; }

void ERR_EmitErrorMessage(int severity, const HxCSrcRef*, int messageNumber,
                          ...) {
  ++s_Problems;
  s_Status = std::max(s_Status, severity & 3);
  const ERR_CatalogueRow* row = ERR_FindRow(messageNumber);
  if (row == nullptr) return;
  std::va_list arguments;
  va_start(arguments, messageNumber);
  std::vfprintf(stderr, row->text, arguments);
  va_end(arguments);
  std::fputc('\n', stderr);
}

int ERR_get_errstatus() { return s_Status; }
bool ShowInternalInfo() { return false; }
int HX_DebugReport(const char*, int, const char*) { return 0; }
void HX_DebugBreak() { std::abort(); }
