// Fall-through trace: tells a developer where an operation left early because
// something unexpected happened (the operation "fell through").
//
//   if (type == nullptr) {
//     return HxCTraceFallThrough().throwError(__FILE__, __LINE__, "no type");
//   }
//
// The names say "throw", but no operation raises a C++ exception: each reports
// an internal message and returns false.

#ifndef TRACE_HXCTRACEFALLTHROUGH_H
#define TRACE_HXCTRACEFALLTHROUGH_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class KyCXString;

/// Class without data; callers make objects on the spot.
///
/// Every level has a message of its own with one text: "trace fall through -
/// early abortion." The place stands in the internal source reference attached
/// to the message: file "file unknown!", line -1 and cause "cause unknown!" if
/// the call does not give them. After the message a failed debug check "0"
/// follows.
///
/// If memory runs out, the report goes on with an empty file and cause.
///
/// While verbose() is false, notes, warnings and errors report nothing and draw
/// no source reference number. A deadly fall-through is never silent: while
/// verbose() is false, an internal assertion fails (message 7, fatal error).
class HX_UTILS_API HxCTraceFallThrough : public HX_Allocated {
 public:
  HxCTraceFallThrough() = default;

  /// Message 1272, severity 4 (internal note). \return false, always
  bool throwNote() const;
  bool throwNote(const KyCXString& file, int line) const;
  bool throwNote(const KyCXString& file, int line,
                 const KyCXString& reason) const;

  /// Message 1273, severity 5 (internal warning). \return false, always
  bool throwWarning() const;
  bool throwWarning(const KyCXString& file, int line) const;
  bool throwWarning(const KyCXString& file, int line,
                    const KyCXString& reason) const;

  /// Message 1274, severity 6 (internal error). \return false, always
  bool throwError() const;
  bool throwError(const KyCXString& file, int line) const;
  bool throwError(const KyCXString& file, int line,
                  const KyCXString& reason) const;

  /// Message 1275, severity 7 (internal fatal error). \return false, always
  bool throwDeadly() const;
  bool throwDeadly(const KyCXString& file, int line) const;
  bool throwDeadly(const KyCXString& file, int line,
                   const KyCXString& reason) const;

  /// Whether fall-throughs are reported; off at load.
  static bool verbose() { return m_Verbose; }
  static void setVerbose(bool on) { m_Verbose = on; }

 private:
  static bool m_Verbose;
};

#endif  // TRACE_HXCTRACEFALLTHROUGH_H
