#include "SystemServices/ResourceInfo/HxCResourceInfo.h"

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <string>
#include <utility>

#include "SystemServices/implSystemServices/HX_SharedText.h"
#include "Trace/HxCTraceFallThrough.h"
#include "platform/os/HX_OsVersion.h"

namespace {

constexpr char kSourceFile[] = "SystemServices/ResourceInfo/HxCResourceInfo";
constexpr char kModule[] = "hx_codegen";
constexpr std::uint32_t kMaxPath = 260;

struct FreeBlock {
  void operator()(void* block) const { HX_Free(block); }
};
using Block = std::unique_ptr<void, FreeBlock>;

int highWord(std::uint32_t word) { return static_cast<int>(word >> 16); }
int lowWord(std::uint32_t word) { return static_cast<int>(word & 0xFFFF); }

// Reads the value at \p path as a T; false for a missing or too short value.
template <class T>
bool query(const void* block, const char* path, T& value) {
  void* found = nullptr;
  unsigned int length = 0;
  if (VerQueryValueA(block, path, &found, &length) == 0) return false;
  if (length < sizeof value) return false;
  std::memcpy(&value, found, sizeof value);
  return true;
}

// Returns the text at \p path up to the first zero; empty for a missing text.
KyCXString queryText(const void* block, const char* path) {
  void* found = nullptr;
  unsigned int length = 0;
  if (VerQueryValueA(block, path, &found, &length) == 0) return "";
  const std::string text(static_cast<const char*>(found), length);
  return text.c_str();
}

}  // namespace

bool HxCResourceInfo::retrieveResourceInfo() {
  if (m_IsRetrieved) return true;
  m_IsRetrieved = true;
  return HX_WithinMemory(false, [this] { return readResource(); });
}

bool HxCResourceInfo::readResource() {
  char path[kMaxPath] = "";
  GetModuleFileNameA(GetModuleHandleA(kModule), path, sizeof path);
  m_pModuleName = HX_SharedText(path);

  const HxCTraceFallThrough trace;
  std::uint32_t handle = 0;
  const std::uint32_t size = GetFileVersionInfoSizeA(path, &handle);
  if (size == 0) return trace.throwError(kSourceFile, __LINE__);

  const Block block(HX_Allocate(size));
  if (block == nullptr ||
      GetFileVersionInfoA(path, handle, size, block.get()) == 0)
    return trace.throwError(kSourceFile, __LINE__);

  VS_FIXEDFILEINFO info{};
  if (!query(block.get(), "\\", info))
    return trace.throwError(kSourceFile, __LINE__);

  // All or nothing: a copy takes the numbers and texts first.
  HxCResourceInfo read(*this);
  read.setVersions(
      {highWord(info.dwProductVersionMS), lowWord(info.dwProductVersionMS),
       highWord(info.dwProductVersionLS), lowWord(info.dwProductVersionLS)},
      {highWord(info.dwFileVersionMS), lowWord(info.dwFileVersionMS),
       highWord(info.dwFileVersionLS), lowWord(info.dwFileVersionLS)});
  read.setTexts(block.get());
  *this = std::move(read);
  return true;
}

void HxCResourceInfo::setVersions(const Version& product, const Version& file) {
  m_Product = product;
  m_File = file;

  KyCXString shown =
      HX_Decimal(m_Product.majorPart) + "." + HX_Decimal(m_Product.minorPart);
  if (m_Product.subPart > 0 || m_Product.maintenance > 0)
    shown += KyCXString(".") + HX_Decimal(m_Product.subPart);
  if (m_Product.maintenance > 0)
    shown += KyCXString(".") + HX_Decimal(m_Product.maintenance);
  m_pProductVersion = HX_SharedText(shown);
  m_pFileVersion = HX_SharedText(
      HX_Decimal(m_File.majorPart) + "." + HX_Decimal(m_File.minorPart) + "." +
      HX_Decimal(m_File.subPart) + "." + HX_Decimal(m_File.maintenance));
}

void HxCResourceInfo::setTexts(const void* block) {
  std::uint32_t translation = 0;
  const bool isTranslated =
      query(block, "\\VarFileInfo\\Translation", translation);
  const auto text = [&](const char* name) {
    char path[64];
    std::snprintf(path, sizeof path, "StringFileInfo\\%04X%04X\\%s",
                  lowWord(translation), highWord(translation), name);
    return HX_SharedText(isTranslated ? queryText(block, path) : KyCXString());
  };
  m_pLegalCopyright = text("LegalCopyright");
  m_pCompanyName = text("CompanyName");
  m_pProductName = text("ProductName");
}
