// Version information of modules, set by a host.
//
//   HX_VersionResource resource;
//   resource.setVersions({6, 1, 0, 0}, {6, 1, 0, 17});
//   resource.addTranslation(0x0409, 0x04B0);
//   resource.setText(0x0409, 0x04B0, "ProductName", "Generator");
//   HX_LoadModule("hx_codegen", "/opt/generator/bin/hx_codegen",
//                 resource.block());
//
// The block is the 8-bit form of a version resource: a tree of nodes of
//
//   bytes of the node with the children   16 bits
//   bytes of the value                    16 bits
//   name                                  zero-terminated
//   value, children                       all at multiples of four bytes
//
// with the root VS_VERSION_INFO and below the root StringFileInfo (a table of
// texts per language and code page) and VarFileInfo.

#ifndef PLATFORM_OS_HX_VERSIONRESOURCE_H
#define PLATFORM_OS_HX_VERSIONRESOURCE_H

#include <array>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "platform/HX_PlatformExport.h"

/// A value type. The block holds only what was set.
class HX_PLATFORM_API HX_VersionResource {
 public:
  /// The four parts of a version, the most significant first.
  using Version = std::array<std::uint16_t, 4>;

  /// Sets the fixed part of the resource.
  void setVersions(const Version& product, const Version& file);
  /// Readers take the first translation.
  void addTranslation(std::uint16_t language, std::uint16_t codePage);
  /// \p text is of ISO-8859-1; an earlier text of the name is replaced.
  void setText(std::uint16_t language, std::uint16_t codePage,
               const std::string& name, const std::string& text);

  /// The bytes of the resource; empty if a node has more than 65535.
  std::string block() const;

 private:
  std::string m_FixedInfo;
  std::vector<std::uint32_t> m_Translations;
  // "040904B0" -> name -> text
  std::map<std::string, std::map<std::string, std::string>> m_Tables;
};

/// Makes \p name a loaded module with the file \p path, in place of an earlier
/// module of the same name. The file itself is not looked at.
/// \param versionBlock  of HX_VersionResource::block(); empty for a file that
///     has no version information
HX_PLATFORM_API void HX_LoadModule(const std::string& name,
                                   const std::string& path,
                                   const std::string& versionBlock);
HX_PLATFORM_API void HX_UnloadModule(const std::string& name);

#endif  // PLATFORM_OS_HX_VERSIONRESOURCE_H
