// Uses the platform layer from the destructor of a static object older than
// everything in the layer.
//
// Prints:
//   INTERNAL: from main,INTERNAL: from end 1 window 2 module call
#include <cstdio>
#include <string>

#include "platform/datadictionary/HX_DdTree.h"
#include "platform/matlab/HX_MatlabSession.h"
#include "platform/matlab/HX_MexInterface.h"
#include "platform/messages/ERR_MessageHandler.h"
#include "platform/messages/HX_MessageHandler.h"
#include "platform/model/HxCGlobal.h"
#include "platform/os/HX_OsVersion.h"
#include "platform/os/HX_VersionResource.h"

namespace {

constexpr char kModel[] = "a name too long for the inside of a text object";
constexpr char kObject[] = "//DD0/Pool/Variables/a_name_of_some_length";

void report(const char* text) { ERR_EmitErrorMessage(1, nullptr, 1292, text); }

struct UsesPlatformAtEnd {
  ~UsesPlatformAtEnd() {
    report("from end");
    std::string seen;
    for (const HX_Message& message : HX_MessageHandler::instance().messages())
      seen += (seen.empty() ? "" : ",") + message.text;
    std::printf("%s %d ", seen.c_str(), ERR_get_errstatus());
    mexPrintf("%s", "window");
    mxArray* result = nullptr;
    std::printf("%d ", MEXCallMATLAB(1, &result, 0, nullptr, "two"));
    char path[8] = "";
    GetModuleFileNameA(GetModuleHandleA("module"), path, sizeof path);
    std::printf("%s ", path);
    const bool found = HX_DdTree::instance().find(kObject) == 4 &&
                       GLB_GetModelName() == kModel;
    std::printf("%s\n", found ? "call" : "lost");
  }
} s_atEnd;

}  // namespace

int main() {
  HX_MessageHandler::instance().setSink({});
  report("from main");
  HX_SetCommandWindow([](const char* text) { std::printf("%s ", text); });
  HX_RegisterMatlabFunction("two",
                            [](int, mxArray**, int, mxArray**) { return 2; });
  HX_LoadModule("module", "module", "");
  HX_DdTree::instance().add(kObject);
  GLB_SetModelName(kModel);
  return 0;
}
