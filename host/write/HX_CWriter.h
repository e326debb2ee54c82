// Writes C90: a header with the types, a header with the declarations, and a
// source with the definitions.
//
//   HX_CWriter writer(model, result, HX_CFiles::ofModel(), "", progress);
//   writer.writeTypes(output);
//   writer.writeCode(output);

#ifndef HOST_WRITE_HX_CWRITER_H
#define HOST_WRITE_HX_CWRITER_H

#include <iosfwd>
#include <map>
#include <string>
#include <vector>

#include "host/base/HX_FileSink.h"
#include "host/base/HX_Progress.h"
#include "host/model/HX_Model.h"
#include "host/names/HX_CFiles.h"
#include "host/names/HX_FormedName.h"

class HX_CFile;

/// C90 has no integer of 64 bits: a structure of two words, low word first,
/// stands for the integer. A saturated initial value is a warning.
///
/// The code of every document compiles as C90, C99, C11 and C23 without a
/// warning, and the headers as C++.
class HX_CWriter {
 public:
  /// Warnings go to \p result, and the places of declarations to its names.
  /// \param banner  further text for the head of each file; may be empty
  HX_CWriter(const HX_Model& model, HX_RunResult& result,
             const HX_CFiles& files, const std::string& banner,
             HX_Progress& progress);

  void writeTypes(HX_FileSink& output) const;
  void writeCode(HX_FileSink& output);

 private:
  std::string head(const char* what) const;
  std::string comment(const HX_FormedName& name) const;
  void writeTypes(HX_CFile file) const;
  void writeCode(HX_CFile header, HX_CFile source);
  void writeBody(HX_CFile& file, const HX_FormedName& function);
  void writeLocals(HX_CFile& file, const HX_ScopeItem& scope,
                   const std::string& indent);
  void writeBlocks(HX_CFile& file, const HX_ScopeItem& scope,
                   const std::string& indent);
  void writeUses(HX_CFile& file, const HX_ScopeItem& scope,
                 const std::string& indent);
  std::string definition(const HX_FormedName& name, const std::string& indent);
  bool hasContent() const;
  void warnOfSaturation(const HX_FormedName& name, double physical);

  const HX_Model& m_Model;
  HX_RunResult& m_Result;
  const std::string m_Banner;
  HX_Progress& m_Progress;
  const HX_CFiles m_Files;
  std::vector<const HX_FormedName*> m_Functions;  // by C name
  // Looked up by scope, never walked.
  std::map<const HX_ScopeItem*, std::vector<const HX_FormedName*>>
      m_VariablesIn;
};

#endif  // HOST_WRITE_HX_CWRITER_H
