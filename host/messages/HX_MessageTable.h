// The messages of the program: number, severity, text, cause and cure.
//
// A new message is a new row in HX_MessageTable.cpp and a new enumerator here.
//
//   HX_MessageText(kHxTooLong, {"31"});
//   // "The name is longer than 31 characters, and its template does ..."

#ifndef HOST_MESSAGES_HX_MESSAGETABLE_H
#define HOST_MESSAGES_HX_MESSAGETABLE_H

#include <initializer_list>
#include <string>
#include <string_view>

/// Numbers of the program, [100, 999]. No number is also a row or an id of the
/// library's catalogue: a number alone tells the message.
enum HX_MessageNumber : int {
  kHxBadCommandLine = 101,
  kHxUnknownNumber = 102,
  kHxUnknownName = 103,
  kHxUnknownComponent = 104,
  kHxUnreadable = 201,
  kHxUnwritable = 202,
  kHxOutOfMemory = 203,
  kHxSystemFailure = 204,
  kHxBadSyntax = 301,
  kHxBadContent = 302,
  kHxUnknownId = 303,
  kHxTakenId = 304,
  kHxReservedType = 305,
  kHxBadWordList = 306,
  kHxBadLock = 307,
  kHxMoreFaults = 308,
  kHxEmptyName = 411,
  kHxTooLong = 412,
  kHxTaken = 413,
  kHxMacrosInMacros = 414,
  kHxManyParts = 415,
  kHxNotInLock = 421,
  kHxSaturated = 511,
  kHxOutdated = 521,
  kHxImportRefused = 601,
  kHxImportWarning = 602,
  kHxImportNote = 603
};

struct HX_MessageRow {
  int number;
  int severity;      ///< 0 note, 1 warning, 2 error
  const char* text;  ///< "{}" for each argument
  const char* cause;
  const char* cure;
};

/// Cause and cure of a message of the library, by its row.
struct HX_LibraryHelp {
  int row;
  const char* cause;
  const char* cure;
};

/// RETURNS: the row; null for a number of no message of the program.
const HX_MessageRow* HX_FindMessage(int number);

/// The text with \p arguments in place of "{}".
/// REQUIRES: as many arguments as places.
std::string HX_MessageText(HX_MessageNumber number,
                           std::initializer_list<std::string_view> arguments);

/// What "hx_codegen help NUMBER" prints: number, severity, text, cause, cure.
/// \param number  of the program, or row or id of the library's catalogue
/// RETURNS: empty for an unknown number.
std::string HX_MessageHelp(int number);

/// The same of all messages, those of the program first, with an empty line
/// between messages.
std::string HX_AllMessageHelp();

/// Text, cause and cure of a message, as rules of a log need them.
struct HX_MessageFacts {
  int severity = 2;
  std::string text;
  std::string cause;
  std::string cure;
};
/// RETURNS: the facts of \p number; empty texts for an unknown number.
HX_MessageFacts HX_FactsOf(int number);

#endif  // HOST_MESSAGES_HX_MESSAGETABLE_H
