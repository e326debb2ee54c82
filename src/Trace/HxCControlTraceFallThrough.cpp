// The members of HxCControl that call the tracer. Here, because the folder
// Control lies below Trace and does not include Trace.

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
