// The members of HxCControl that need the tracer; they stand here because the
// control switches lie below the trace and do not know it.

#include "Control/HxCControl.h"
#include "Trace/HxCTraceFallThrough.h"

bool HxCControl::traceFallThrough() {
  return s_TraceFallThrough && HxCTraceFallThrough().throwError();
}

bool HxCControl::traceFallThrough(const KyCXString& file, int line) {
  return s_TraceFallThrough && HxCTraceFallThrough().throwError(file, line);
}

bool HxCControl::traceFallThrough(const KyCXString& file, int line,
                                  const KyCXString& reason) {
  return s_TraceFallThrough &&
         HxCTraceFallThrough().throwError(file, line, reason);
}
