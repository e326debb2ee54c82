#include "SourceRef/HxCInternalSrcRef.h"

namespace {

constexpr char kUnknownFile[] = "file unknown!";
constexpr char kUnknownCause[] = "cause unknown!";
constexpr int kUnknownLine = -1;

}  // namespace

HxCInternalSrcRef::HxCInternalSrcRef()
    : HxCInternalSrcRef(kUnknownFile, kUnknownLine) {}

HxCInternalSrcRef::HxCInternalSrcRef(const KyCXString& file, int line)
    : HxCInternalSrcRef(file, line, kUnknownCause) {}

HxCInternalSrcRef::HxCInternalSrcRef(const KyCXString& file, int line,
                                     const KyCXString& cause)
    : m_File(file), m_Line(line), m_Cause(cause) {}

HxCInternalSrcRef::~HxCInternalSrcRef() = default;

const HxCInternalSrcRef* HxCInternalSrcRef::isInternal() const { return this; }

void HxCInternalSrcRef::toString(KyCXString& text) const {
  text = "Internal: Module: '" + m_File +
         "', Line: " + KyCXString(m_Line, false, true) + " Reason: " + m_Cause;
}

void HxCInternalSrcRef::setLocation(const KyCXString& file, int line) {
  m_File = file;
  m_Line = line;
}
