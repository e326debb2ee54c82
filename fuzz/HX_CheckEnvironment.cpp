// The substitution of environment variables against its description.
#include <cstdlib>
#include <vector>

#include "SystemServices/HX_SystemCall.h"
#include "fuzz/HX_Fuzz.h"

namespace {

std::string plainStep(const std::string& text) {
  const std::size_t open = text.find('%');
  const std::size_t close = text.find('%', open + 1);
  if (open == std::string::npos || close == std::string::npos) return text;
  const char* value =
      std::getenv(text.substr(open + 1, close - open - 1).c_str());
  return value == nullptr ? text : value + text.substr(close + 1);
}

}  // namespace

// The first lines define variables that may refer to each other and to
// themselves; texts are 8-bit ones without zeros, as the environment's are.
void HX_CheckEnvironment(HX_Bytes& bytes) {
  constexpr int kSteps = 20;
  std::vector<std::string> definitions;
  for (const char* name : {"HX_A=", "HX_B=", "X="})
    definitions.push_back(name + bytes.line());
  for (std::string& definition : definitions) putenv(definition.data());

  const std::string start = bytes.line();
  std::string plain = start.c_str();
  KyCXString text(plain.c_str());
  for (int i = 0; i < kSteps && plain.size() < 10000; ++i) {
    plain = plainStep(plain);
    HX_Require(HX_SystemCall().substituteEnvVariable(text), "the answer");
    HX_Require(text == plain.c_str(), "substituted as described");
  }
  for (const char* name : {"HX_A", "HX_B", "X"}) unsetenv(name);
}
