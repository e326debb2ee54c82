// Version resource of the main module of the generator, "hx_codegen".
//
//   HxCResourceInfo info;
//   if (info.retrieveResourceInfo())
//     use(*info.getProductVersion(), *info.getLegalCopyright());

#ifndef SYSTEMSERVICES_RESOURCEINFO_HXCRESOURCEINFO_H
#define SYSTEMSERVICES_RESOURCEINFO_HXCRESOURCEINFO_H

#include <memory>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class KyCXString;

/// Reads the resource once. Until then numbers are -1 and texts null.
/// OWNERSHIP: object and copies share the texts; a text is released with the
/// last object that holds the text.
class HX_UTILS_API HxCResourceInfo : public HX_Allocated {
 public:
  /// Reads the resource of the module "hx_codegen"; without a loaded module of
  /// this name, the resource of the executable.
  ///
  /// Missing or unreadable version information is traced as an error
  /// fall-through. The call then sets only the module name, as without memory
  /// (not even the name, if the name finds no memory). A text missing in the
  /// first language of the resource is empty.
  /// RETURNS: true if the resource was read, and in every later call, even
  /// after a first call without success.
  bool retrieveResourceInfo();

  /// The parts of the version of the product and of the file.
  int getProdMajor() const { return m_Product.majorPart; }
  int getProdMinor() const { return m_Product.minorPart; }
  int getProdSub() const { return m_Product.subPart; }
  int getProdMaintenance() const { return m_Product.maintenance; }
  int getFileMajor() const { return m_File.majorPart; }
  int getFileMinor() const { return m_File.minorPart; }
  int getFileSub() const { return m_File.subPart; }
  int getFileMaintenance() const { return m_File.maintenance; }

  /// Without zeros at the end, but never shorter than major.minor: "2.2",
  /// "2.2.1", "2.2.0.4".
  KyCXString* getProductVersion() const { return m_pProductVersion.get(); }
  /// Always all four parts: "2.2.0.0".
  KyCXString* getFileVersion() const { return m_pFileVersion.get(); }

  /// The texts in the first language of the resource.
  KyCXString* getLegalCopyright() const { return m_pLegalCopyright.get(); }
  KyCXString* getCompanyName() const { return m_pCompanyName.get(); }
  KyCXString* getProductName() const { return m_pProductName.get(); }
  /// The full path of the module file, cut to 259 characters.
  KyCXString* getModuleName() const { return m_pModuleName.get(); }

 private:
  using Text = std::shared_ptr<KyCXString>;
  struct Version {
    int majorPart = -1;
    int minorPart = -1;
    int subPart = -1;
    int maintenance = -1;
  };

  bool readResource();
  void setVersions(const Version& product, const Version& file);
  void setTexts(const void* block);

  bool m_IsRetrieved = false;
  Version m_Product;
  Version m_File;
  Text m_pLegalCopyright;
  Text m_pProductName;
  Text m_pCompanyName;
  Text m_pModuleName;
  Text m_pProductVersion;
  Text m_pFileVersion;
};

#endif  // SYSTEMSERVICES_RESOURCEINFO_HXCRESOURCEINFO_H
