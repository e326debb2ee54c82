#include "SystemServices/ResourceInfo/HxCResourceInfo.h"

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <string>

#include "Trace/HxCTraceFallThrough.h"
#include "platform/os/HX_OsVersion.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kModule[] = "hx_codegen";
constexpr std::uint32_t kMaxPath = 260;

struct FreeBlock {
  void operator()(void* block) const { HX_Free(block); }
};
using Block = std::unique_ptr<void, FreeBlock>;

KyCXString decimal(int value) { return KyCXString(value, false, true); }

int highWord(std::uint32_t word) { return static_cast<int>(word >> 16); }
int lowWord(std::uint32_t word) { return static_cast<int>(word & 0xFFFF); }

// The value at \p path as a T; false if there is none or it is too short.
template <class T>
bool query(const void* block, const char* path, T& value) {
  void* found = nullptr;
  unsigned int length = 0;
  if (VerQueryValueA(block, path, &found, &length) == 0) return false;
  if (length < sizeof value) return false;
  std::memcpy(&value, found, sizeof value);
  return true;
}

// The text at \p path; empty if there is none.
KyCXString queryText(const void* block, const char* path) {
  void* found = nullptr;
  unsigned int length = 0;
  if (VerQueryValueA(block, path, &found, &length) == 0) return "";
  const std::string text(static_cast<const char*>(found), length);
  return text.c_str();  // ends at the text's own zero
}

}  // namespace

bool HxCResourceInfo::retrieveResourceInfo() {
  if (m_IsRetrieved) return true;
  m_IsRetrieved = true;

  char path[kMaxPath] = "";
  GetModuleFileNameA(GetModuleHandleA(kModule), path, sizeof path);
  m_pModuleName = std::make_shared<KyCXString>(path);

  std::uint32_t handle = 0;
  const std::uint32_t size = GetFileVersionInfoSizeA(path, &handle);
  if (size == 0) return HxCTraceFallThrough().throwError(__FILE__, __LINE__);

  const Block block(HX_Allocate(size));
  if (block == nullptr ||
      GetFileVersionInfoA(path, handle, size, block.get()) == 0)
    return HxCTraceFallThrough().throwError(__FILE__, __LINE__);

  VS_FIXEDFILEINFO info{};
  if (!query(block.get(), "\\", info))
    return HxCTraceFallThrough().throwError(__FILE__, __LINE__);

  setVersions(info);
  setTexts(block.get());
  return true;
}

void HxCResourceInfo::setVersions(const VS_FIXEDFILEINFO& info) {
  m_Product = {
      highWord(info.dwProductVersionMS), lowWord(info.dwProductVersionMS),
      highWord(info.dwProductVersionLS), lowWord(info.dwProductVersionLS)};
  m_File = {highWord(info.dwFileVersionMS), lowWord(info.dwFileVersionMS),
            highWord(info.dwFileVersionLS), lowWord(info.dwFileVersionLS)};

  KyCXString product =
      decimal(m_Product.majorPart) + "." + decimal(m_Product.minorPart);
  if (m_Product.subPart > 0 || m_Product.maintenance > 0)
    product += KyCXString(".") + decimal(m_Product.subPart);
  if (m_Product.maintenance > 0)
    product += KyCXString(".") + decimal(m_Product.maintenance);
  m_pProductVersion = std::make_shared<KyCXString>(product);
  m_pFileVersion = std::make_shared<KyCXString>(
      decimal(m_File.majorPart) + "." + decimal(m_File.minorPart) + "." +
      decimal(m_File.subPart) + "." + decimal(m_File.maintenance));
}

void HxCResourceInfo::setTexts(const void* block) {
  std::uint32_t translation = 0;
  const bool isTranslated =
      query(block, "\\VarFileInfo\\Translation", translation);
  const auto text = [&](const char* name) {
    char path[64];
    std::snprintf(path, sizeof path, "StringFileInfo\\%04X%04X\\%s",
                  lowWord(translation), highWord(translation), name);
    return std::make_shared<KyCXString>(isTranslated ? queryText(block, path)
                                                     : KyCXString());
  };
  m_pLegalCopyright = text("LegalCopyright");
  m_pCompanyName = text("CompanyName");
  m_pProductName = text("ProductName");
}
