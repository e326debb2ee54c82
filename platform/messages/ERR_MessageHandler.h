// The calls of the library to the message handler of the generator.

#ifndef PLATFORM_MESSAGES_ERR_MESSAGEHANDLER_H
#define PLATFORM_MESSAGES_ERR_MESSAGEHANDLER_H

#include "platform/HX_PlatformExport.h"

class HxCSrcRef;

/// Reports the catalogue row \p messageNumber.
///
/// \param severity  0 note, 1 warning, 2 error, 3 fatal error; 4 to 7 the
///   same for messages to developers.
/// \param srcRef  the item concerned, null for none; read during the call only.
/// The further arguments are formatted by the text of the row. Always
/// returns, whatever the severity.
HX_PLATFORM_API void ERR_EmitErrorMessage(int severity, const HxCSrcRef* srcRef,
                                          int messageNumber, ...);

/// The highest severity reported so far: 0 nothing or notes, 1 warning,
/// 2 error, 3 fatal error. Severities 4 to 7 count as 0 to 3.
HX_PLATFORM_API int ERR_get_errstatus();

/// True while internal information is to be shown to a developer.
HX_PLATFORM_API bool ShowInternalInfo();

/// Shows a developer the failed \p expression of \p file and \p line.
/// \return 1 if the developer asks to debug, else 0.
HX_PLATFORM_API int HX_DebugReport(const char* file, int line,
                                   const char* expression);

/// Stops in the debugger of the process.
HX_PLATFORM_API void HX_DebugBreak();

#endif  // PLATFORM_MESSAGES_ERR_MESSAGEHANDLER_H
