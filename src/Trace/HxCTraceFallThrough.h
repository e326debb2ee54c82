// Tells a developer where an operation left early because something unexpected
// happened (it "fell through").
//
//   if (type == nullptr) {
//     return HxCTraceFallThrough().throwError(__FILE__, __LINE__, "no type");
//   }
//
// Despite their names the operations raise no C++ exception: they report an
// internal message and return.

#ifndef TRACE_HXCTRACEFALLTHROUGH_H
#define TRACE_HXCTRACEFALLTHROUGH_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class KyCXString;

/// Holds no data; instances are made on the spot.
///
/// Each level has its message, which always reads "trace fall through - early
/// abortion."; the place is in the internal source reference attached to it:
/// file "file unknown!", line -1 and cause "cause unknown!" where the call does
/// not give them. After its message a report raises a failed debug check "0".
///
/// While verbose() is false, notes, warnings and errors report nothing and
/// take no source reference number; a deadly fall-through fails an internal
/// assertion instead (message 7, fatal error), so that it is never silent.
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
