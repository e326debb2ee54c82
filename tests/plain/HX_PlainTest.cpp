// The library answers as the plain form: random cases, and every short
// template.
#include "Naming/HxCNames.h"
#include "plain/HX_PlainCase.h"
#include "plain/HX_PlainNames.h"
#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_TestFixture.h"

namespace {

// HX_PLAIN_CASES=100000 makes a long run.
int caseCount(int usual) {
  const char* const text = std::getenv("HX_PLAIN_CASES");
  return text != nullptr ? std::atoi(text) : usual;
}

class PlainTest : public HX_TestFixture {
 protected:
  using Id = HxCCIdentifier;
  using Names = plain::Names;

  // Formal and actual name.
  static std::string shown(const Id& id) {
    return std::string(id.getCookedName(Id::eFormalName).cstring()) + ":" +
           id.getCookedName(Id::eActualName).cstring();
  }
  static std::string shown(const plain::Identifier& id) {
    return plain::narrow(id.getCookedName(plain::Identifier::eFormalName) +
                         u":" +
                         id.getCookedName(plain::Identifier::eActualName));
  }

  plain::Model m_Model;
  plain::Messages m_Messages;
  Names m_Plain{m_Model, m_Messages};
  HxCNames m_Names;
};

TEST_F(PlainTest, NamesAnswerAsThePlainForm) {
  const std::string difference = plain::smallestDifference(
      HX_Seed(), caseCount(2'000), 400, plain::differenceOfNames);
  EXPECT_TRUE(difference.empty()) << difference;
}

TEST_F(PlainTest, SourceReferencesAnswerAsThePlainForm) {
  const std::string difference = plain::smallestDifference(
      HX_Seed(), caseCount(1'500), 400, plain::differenceOfSrcRefs);
  EXPECT_TRUE(difference.empty()) << difference;
}

// Every text of 1 to \p length characters out of \p letters.
std::vector<std::string> textsUpTo(std::size_t length,
                                   const std::string& letters) {
  std::vector<std::string> texts{""};
  for (std::size_t i = 0; i < texts.size() && texts[i].size() < length; ++i)
    for (const char letter : letters) texts.push_back(texts[i] + letter);
  texts.erase(texts.begin());
  return texts;
}

TEST_F(PlainTest, EveryShortTemplateExpandsPlainly) {
  for (const std::string& form : textsUpTo(5, "$B()Qx")) {
    Id id(form.c_str());
    plain::Identifier plainId(plain::wide(form));
    m_Names.createNameFromForm(id, nullptr, 0, 0, false);
    m_Plain.createNameFromForm(plainId, plain::kNone, 0, 0, false);
    ASSERT_EQ(shown(id), shown(plainId)) << form;
    ASSERT_EQ(messages().size(), m_Messages.size()) << form;
    clearMessages();
    m_Messages.clear();
  }
}

// The kind 3 counts as exact.
TEST_F(PlainTest, EveryShortTemplateIsSubstitutedPlainly) {
  std::vector<std::string> forms = textsUpTo(5, "$nN(E)");
  std::erase_if(forms, [](const std::string& form) { return form[0] != '$'; });
  for (const std::string& group : textsUpTo(6, "()'"))
    forms.push_back("$E" + group + "$n");
  const Id value("aZ$n:aZ$n");
  const plain::Identifier plainValue(u"aZ$n:aZ$n");
  for (const char* macro : {"n", "N", "nN", "(N)"}) {
    for (int kind = 0; kind <= 3; ++kind) {
      for (const std::string& form : forms) {
        Id id((form + ":").c_str());
        plain::Identifier plainId(plain::wide(form + ":"));
        const bool isReplaced = m_Names.substAllDollarZByValue(
            id, macro, value, static_cast<HxCNames::tagMacroKindEnum>(kind));
        ASSERT_EQ(isReplaced,
                  m_Plain.substAllDollarZByValue(
                      plainId, plain::wide(macro), plainValue,
                      static_cast<Names::tagMacroKindEnum>(kind % 3)))
            << form;
        ASSERT_EQ(shown(id), shown(plainId)) << form << " kind " << kind;
      }
    }
  }
}

}  // namespace
