// Writes C90: a header with the types, a header with the declarations, and a
// source with the definitions.
//
//   HX_CWriter writer(model, result, progress);
//   writer.write(output);

#ifndef HOST_WRITE_HX_CWRITER_H
#define HOST_WRITE_HX_CWRITER_H

#include <iosfwd>
#include <map>
#include <string>
#include <vector>

#include "host/base/HX_Output.h"
#include "host/base/HX_Progress.h"
#include "host/model/HX_Model.h"
#include "host/names/HX_FormedName.h"

/// C90 has no integer of 64 bits: a structure of two words, low word first,
/// stands for the integer.
///
/// Initial values are scaled to steps of the type, rounded and saturated as in
/// the simulation. A saturated value is a warning.
class HX_CWriter {
 public:
  /// Warnings go to \p result.
  HX_CWriter(const HX_Model& model, HX_RunResult& result,
             HX_Progress& progress);

  void write(HX_Output& output);

 private:
  void writeTypes(std::ostream& out) const;
  void writeCode(std::ostream& header, std::ostream& source);
  void writeLocals(std::ostream& out, const HX_ScopeItem& scope,
                   const std::string& indent);
  std::string definition(const HX_FormedName& name);
  std::string initializer(const HX_FormedName& name, const HX_TypeItem& type,
                          std::size_t& at);
  std::string elementValue(const HX_FormedName& name, const HX_TypeItem& type,
                           double physical);
  void warnOfSaturation(const HX_FormedName& name, double physical);

  const HX_Model& m_Model;
  HX_RunResult& m_Result;
  HX_Progress& m_Progress;
  std::string m_TypesFile;                        // without extension, as below
  std::string m_CodeFile;                         // header and source
  std::vector<const HX_FormedName*> m_Functions;  // by C name
  // Looked up by scope, never walked.
  std::map<const HX_ScopeItem*, std::vector<const HX_FormedName*>>
      m_VariablesIn;
};

#endif  // HOST_WRITE_HX_CWRITER_H
