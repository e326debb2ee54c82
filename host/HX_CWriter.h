// Writes C90: a header with the types, one with the declarations, and a source
// with the definitions.
//
//   HX_CWriter writer(model, result);
//   for (const auto& [name, text] : writer.files()) output.add(name, text);

#ifndef HOST_HX_CWRITER_H
#define HOST_HX_CWRITER_H

#include <map>
#include <string>

#include "host/HX_NameReport.h"

/// C90 has no integer of 64 bits: one is written as a structure of two words,
/// the low one first.
///
/// Initial values are scaled to steps of the type, rounded and saturated as the
/// simulation does; a value that had to be saturated is remarked on.
class HX_CWriter {
 public:
  /// \p result gets the remarks.
  HX_CWriter(const HX_Model& model, HX_RunResult& result);

  /// File name without folder -> text.
  std::map<std::string, std::string> files();

 private:
  std::string typesHeader() const;
  std::string declarationsHeader() const;
  std::string definitions();
  std::string function(const HX_FormedName& name);
  std::string locals(const HX_ScopeItem* scope, int depth);
  std::string definition(const HX_FormedName& name);
  std::string initializer(const HX_FormedName& name);
  std::string initializer(const HX_FormedName& name, const HX_TypeItem& type,
                          std::size_t& at);
  std::string elementValue(const HX_FormedName& name, const HX_TypeItem& type,
                           double physical);

  const HX_Model& m_Model;
  HX_RunResult& m_Result;
  std::string m_TypesFile;                        // without extension, as below
  std::string m_DeclarationsFile;                 // also that of the source
  std::vector<const HX_FormedName*> m_Functions;  // by C name
  // What stands where; looked up, never walked.
  std::map<const HX_ScopeItem*, std::vector<const HX_FormedName*>>
      m_VariablesOf;
  std::map<const HX_ScopeItem*, std::map<std::string, const HX_ScopeItem*>>
      m_BlocksOf;  // by id
  std::map<const HX_NameItem*, const HX_ScopeItem*> m_BodyOf;
};

#endif  // HOST_HX_CWRITER_H
