// One run over a model: everything between a document and what is printed or
// written.
//
//   HX_Profile profile("");
//   const HX_Document document("cruise_control.json");
//   HX_Generator generator(document, "host/keywords", profile);
//   const HX_RunResult& result = generator.run(HX_Generator::eById, progress);

#ifndef HOST_HX_GENERATOR_H
#define HOST_HX_GENERATOR_H

#include <filesystem>
#include <memory>
#include <string>

#include "host/HX_Document.h"
#include "host/HX_Keywords.h"
#include "host/HX_NameReport.h"
#include "host/HX_Profile.h"

class HX_Generator {
 public:
  enum Order { eAsInDocument, eById };

  /// Throws HX_DocumentError; a list of keywords that is not in
  /// \p keywordFolder is an error of the document.
  HX_Generator(const HX_Document& document,
               const std::filesystem::path& keywordFolder, HX_Profile& profile);
  ~HX_Generator();

  /// Orders types, forms names, orders variables. After a cycle among the types
  /// no names are formed.
  /// \param order  of the names in the result
  HX_RunResult& run(Order order, const HX_NameRun::Progress& progress);

  const HX_Model& model() const { return m_Model; }

  /// After run(); null if there is no name with this id.
  const HX_FormedName* find(const std::string& id) const;
  std::vector<HX_ExplainedMacro> explain(const HX_FormedName& name);

 private:
  void loadKeywords(const HX_Document& document,
                    const std::filesystem::path& folder);
  void enterTypeNames();
  void takeMessages();

  HX_Profile& m_Profile;
  HX_Model m_Model;
  HX_Keywords m_Keywords;
  std::unique_ptr<HX_NameSpaces> m_Spaces;
  std::unique_ptr<HX_NameRun> m_NameRun;
  HX_RunResult m_Result;
};

#endif  // HOST_HX_GENERATOR_H
