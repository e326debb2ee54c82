// Writes C90: a header with the types, one with the declarations, and a source
// with the definitions.
//
//   HX_CWriter writer(model, result);
//   writer.write(output);

#ifndef HOST_WRITE_HX_CWRITER_H
#define HOST_WRITE_HX_CWRITER_H

#include <iosfwd>
#include <map>
#include <string>
#include <vector>

#include "host/base/HX_Output.h"
#include "host/write/HX_NameReport.h"

/// C90 has no integer of 64 bits: one is written as a structure of two words,
/// the low one first.
///
/// Initial values are scaled to steps of the type, rounded and saturated as the
/// simulation does; a value that had to be saturated is remarked on.
class HX_CWriter {
 public:
  /// \p result gets the remarks.
  HX_CWriter(const HX_Model& model, HX_RunResult& result);

  void write(HX_Output& output);

 private:
  void writeTypes(std::ostream& out) const;
  void writeDeclarations(std::ostream& out);
  void writeDefinitions(std::ostream& out);
  void writeLocals(std::ostream& out, const HX_ScopeItem& scope,
                   const std::string& indent);
  std::string definition(const HX_Name& name);
  std::string initializer(const HX_Name& name, const HX_TypeItem& type,
                          std::size_t& at);
  std::string elementValue(const HX_Name& name, const HX_TypeItem& type,
                           double physical);

  const HX_Model& m_Model;
  HX_RunResult& m_Result;
  std::string m_TypesFile;                  // without extension, as below
  std::string m_CodeFile;                   // header and source
  std::vector<const HX_Name*> m_Functions;  // by C name
  // Looked up, never walked.
  std::map<const HX_ScopeItem*, std::vector<const HX_Name*>> m_VariablesIn;
};

#endif  // HOST_WRITE_HX_CWRITER_H
