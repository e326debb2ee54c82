// The version resource of the generator's main module, "hx_codegen".
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
struct VS_FIXEDFILEINFO;

/// Reads the resource once. Numbers are -1 and texts null until they are read;
/// texts belong to the object and are shared with its copies, the last of which
/// releases them.
class HX_UTILS_API HxCResourceInfo : public HX_Allocated {
 public:
  /// Reads the resource of the module "hx_codegen" or, if no module of that
  /// name is loaded, of the process's executable.
  ///
  /// Where the version information or its fixed part is missing or cannot be
  /// read, this is traced as an error fall-through and the module name is all
  /// that is set. A text that the resource does not hold in its first language
  /// is empty.
  /// \return true if the resource was read or this is not the first call,
  ///     whatever the first one gave
  bool retrieveResourceInfo();

  /// The parts of the product's, and of the file's, version.
  int getProdMajor() const { return m_Product.majorPart; }
  int getProdMinor() const { return m_Product.minorPart; }
  int getProdSub() const { return m_Product.subPart; }
  int getProdMaintenance() const { return m_Product.maintenance; }
  int getFileMajor() const { return m_File.majorPart; }
  int getFileMinor() const { return m_File.minorPart; }
  int getFileSub() const { return m_File.subPart; }
  int getFileMaintenance() const { return m_File.maintenance; }

  /// Without the zeros at its end, but never shorter than major.minor: "2.2",
  /// "2.2.1", "2.2.0.4".
  KyCXString* getProductVersion() const { return m_pProductVersion.get(); }
  /// Always all four parts: "2.2.0.0".
  KyCXString* getFileVersion() const { return m_pFileVersion.get(); }

  /// The texts of these names in the resource's first language.
  KyCXString* getLegalCopyright() const { return m_pLegalCopyright.get(); }
  KyCXString* getCompanyName() const { return m_pCompanyName.get(); }
  KyCXString* getProductName() const { return m_pProductName.get(); }
  /// The full path of the module's file, cut to 259 characters.
  KyCXString* getModuleName() const { return m_pModuleName.get(); }

 private:
  using Text = std::shared_ptr<KyCXString>;
  struct Version {
    int majorPart = -1;
    int minorPart = -1;
    int subPart = -1;
    int maintenance = -1;
  };

  void setVersions(const VS_FIXEDFILEINFO& info);
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
