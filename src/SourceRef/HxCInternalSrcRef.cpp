#include "SourceRef/HxCInternalSrcRef.h"

#include <utility>

#include "Control/HX_Memory.h"

namespace {

constexpr char kUnknownFile[] = "file unknown!";
constexpr char kUnknownCause[] = "cause unknown!";
constexpr int kUnknownLine = -1;

// Makes both texts, of KyCXString or C strings, before either is replaced.
template <class File, class Cause>
bool assign(KyCXString& file, const File& newFile, KyCXString& cause,
            const Cause& newCause) {
  return HX_WithinMemory([&] {
    KyCXString fileCopy(newFile);
    KyCXString causeCopy(newCause);
    file = std::move(fileCopy);
    cause = std::move(causeCopy);
  });
}

}  // namespace

HxCInternalSrcRef::HxCInternalSrcRef() : m_Line(kUnknownLine) {
  assign(m_File, kUnknownFile, m_Cause, kUnknownCause);
}

HxCInternalSrcRef::HxCInternalSrcRef(const KyCXString& file, int line)
    : m_Line(line) {
  assign(m_File, file, m_Cause, kUnknownCause);
}

HxCInternalSrcRef::HxCInternalSrcRef(const KyCXString& file, int line,
                                     const KyCXString& cause)
    : m_Line(line) {
  assign(m_File, file, m_Cause, cause);
}

HxCInternalSrcRef::HxCInternalSrcRef(const HxCInternalSrcRef& other)
    : HxCSrcRef(other), m_Line(other.m_Line) {
  assign(m_File, other.m_File, m_Cause, other.m_Cause);
}

HxCInternalSrcRef& HxCInternalSrcRef::operator=(
    const HxCInternalSrcRef& other) {
  if (!assign(m_File, other.m_File, m_Cause, other.m_Cause)) return *this;
  HxCSrcRef::operator=(other);
  m_Line = other.m_Line;
  return *this;
}

HxCInternalSrcRef::~HxCInternalSrcRef() = default;

const HxCInternalSrcRef* HxCInternalSrcRef::isInternal() const { return this; }

void HxCInternalSrcRef::toString(KyCXString& text) const {
  HX_WithinMemory([&] {
    text = "Internal: Module: '" + m_File +
           "', Line: " + KyCXString(m_Line, false, true) +
           " Reason: " + m_Cause;
  });
}

void HxCInternalSrcRef::setFile(const KyCXString& file) {
  HX_WithinMemory([&] { m_File = file; });
}

void HxCInternalSrcRef::setLocation(const KyCXString& file, int line) {
  if (HX_WithinMemory([&] { m_File = file; })) m_Line = line;
}

void HxCInternalSrcRef::setCause(const KyCXString& cause) {
  HX_WithinMemory([&] { m_Cause = cause; });
}
