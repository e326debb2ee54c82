// Compares the substitution of environment variables with a regular expression.
#include <cstdlib>
#include <regex>

#include "SystemServices/HX_SystemCall.h"
#include "fuzz/HX_Fuzz.h"
#include "support/HX_Environment.h"

namespace {

std::string plainStep(const std::string& text) {
  static const std::regex s_reference("%([^%]*)%");
  std::smatch found;
  if (!std::regex_search(text, found, s_reference)) return text;
  const char* value = std::getenv(found.str(1).c_str());
  return value == nullptr ? text : value + found.suffix().str();
}

}  // namespace

// The first lines define variables; a value may refer to any of the variables.
// Texts have 8-bit characters without zeros, because the environment has no
// wider texts.
void HX_CheckEnvironment(HX_Bytes& bytes) {
  constexpr int kSteps = 20;
  for (const char* name : {"HX_A", "HX_B", "X"})
    HX_SetVariable(name, bytes.line().c_str());
  std::string plain = bytes.line().c_str();
  KyCXString text(plain.c_str());
  for (int i = 0; i < kSteps && plain.size() < 1000; ++i) {
    plain = plainStep(plain);
    HX_Require(HX_SystemCall().substituteEnvVariable(text), "the answer");
    HX_Require(text == plain.c_str(), "substituted as " + plain);
  }
}
