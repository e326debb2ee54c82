// A text file to which the transformation steps of the code generator append
// one record each.
//
//   HxCTransformationTracer::boot("transformations.txt");
//   HxCTransformationTracer::logTransformation("fold constants");
//   HxCTransformationTracer::shutdown();
//
// A record is the caller's text, a blank, a line feed and a blank, nothing
// else; so each record after the first begins with a blank.

#ifndef TRACE_HXCTRANSFORMATIONTRACER_H
#define TRACE_HXCTRANSFORMATIONTRACER_H

#include <cstdio>

#include "HX_Export.h"

/// One trace per process, closed at load.
class HX_UTILS_API HxCTransformationTracer {
 public:
  /// Opens \p fileName for appending, as text; a trace that is still open is
  /// closed first. Null stands for the empty name, which cannot be opened.
  /// \return whether the trace is open; if not, message 90 (fatal error) tells
  ///   the name, and nothing is logged until a later boot() succeeds.
  static bool boot(const char* fileName);

  /// Closes the trace, if it is open. \return true
  static bool shutdown();

  /// Appends a record to an open trace; otherwise, and for null, nothing
  /// happens. Records are buffered and on disk after shutdown().
  /// \param text  ISO-8859-1, written as it is.
  static void logTransformation(const char* text);

 private:
  static std::FILE* m_pTraceFile;  // owned, or null
};

#endif  // TRACE_HXCTRANSFORMATIONTRACER_H
