// Transformation trace: a text file to which every transformation step of the
// code generator appends one record.
//
//   HxCTransformationTracer::boot("transformations.txt");
//   HxCTransformationTracer::logTransformation("fold constants");
//   HxCTransformationTracer::shutdown();
//
// A record is the text of the caller, a blank, a line feed and a blank; hence
// every record after the first begins with a blank.

#ifndef TRACE_HXCTRANSFORMATIONTRACER_H
#define TRACE_HXCTRANSFORMATIONTRACER_H

#include <cstdio>

#include "HX_Export.h"

/// One trace per process, closed at load.
class HX_UTILS_API HxCTransformationTracer {
 public:
  /// Opens \p fileName for appending, as text; closes a trace that is still
  /// open first. Null stands for the empty name, which no file has. RETURNS:
  /// true if the trace is open. After false nothing is logged until a later
  /// boot() succeeds, and message 90 (fatal error) tells the name.
  static bool boot(const char* fileName);

  /// Closes an open trace. \return true
  static bool shutdown();

  /// Appends a record to an open trace. Without an open trace, and for null,
  /// nothing happens. Records are buffered and on disk after shutdown().
  /// \param text  ISO-8859-1, written unchanged
  static void logTransformation(const char* text);

 private:
  static std::FILE* m_pTraceFile;  // owned, or null
};

#endif  // TRACE_HXCTRANSFORMATIONTRACER_H
