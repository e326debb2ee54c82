#include "Trace/HxCTraceFallThrough.h"

#include "Control/ERR_Messages.h"
#include "Control/HX_SelfCheck.h"
#include "SourceRef/HxCInternalSrcRef.h"

namespace {

constexpr char kFallThroughErrorCode[] = __FILE__ "_";
constexpr char kText[] = "trace fall through - early abortion";

using Emitter = void (*)(const HxCSrcRef*, const char*);

// place: nothing, (file, line) or (file, line, reason).
template <class... Place>
bool report(Emitter emit, const Place&... place) {
  if (!HxCTraceFallThrough::verbose()) return false;
  const HxCInternalSrcRef source(place...);
  emit(&source, kText);
  HX_DebugCheck(false, "0");
  return false;
}

template <class... Place>
bool reportDeadly(const Place&... place) {
  if (HxCTraceFallThrough::verbose()) return report(ERR_Msg1275, place...);
  HX_Assert(false, kFallThroughErrorCode);
  return false;
}

}  // namespace

bool HxCTraceFallThrough::m_Verbose = false;

bool HxCTraceFallThrough::throwNote() const { return report(ERR_Msg1272); }

bool HxCTraceFallThrough::throwNote(const KyCXString& file, int line) const {
  return report(ERR_Msg1272, file, line);
}

bool HxCTraceFallThrough::throwNote(const KyCXString& file, int line,
                                    const KyCXString& reason) const {
  return report(ERR_Msg1272, file, line, reason);
}

bool HxCTraceFallThrough::throwWarning() const { return report(ERR_Msg1273); }

bool HxCTraceFallThrough::throwWarning(const KyCXString& file, int line) const {
  return report(ERR_Msg1273, file, line);
}

bool HxCTraceFallThrough::throwWarning(const KyCXString& file, int line,
                                       const KyCXString& reason) const {
  return report(ERR_Msg1273, file, line, reason);
}

bool HxCTraceFallThrough::throwError() const { return report(ERR_Msg1274); }

bool HxCTraceFallThrough::throwError(const KyCXString& file, int line) const {
  return report(ERR_Msg1274, file, line);
}

bool HxCTraceFallThrough::throwError(const KyCXString& file, int line,
                                     const KyCXString& reason) const {
  return report(ERR_Msg1274, file, line, reason);
}

bool HxCTraceFallThrough::throwDeadly() const { return reportDeadly(); }

bool HxCTraceFallThrough::throwDeadly(const KyCXString& file, int line) const {
  return reportDeadly(file, line);
}

bool HxCTraceFallThrough::throwDeadly(const KyCXString& file, int line,
                                      const KyCXString& reason) const {
  return reportDeadly(file, line, reason);
}
