#include "Strings/HX_StringParser.h"

#include "support/HX_TestFixture.h"

namespace {

// Everything else is compared with plain forms by fuzz/HX_CheckParser.cpp.
TEST(StringParserTest, ScriptObjectsAreDescribed) {
  const char* const rows[][2] = {
      {"/Pool/CGTmpData/hxscript_Ctrl/3/V",
       "User script object V of block Ctrl"},
      {"CGTmpData/hxscript_Ctrl/V", "User script object V of block Ctrl"},
      {"CGTmpData/hxscript_C/3/a/b/", "User script object a/b/ of block C"},
      {"CGTmpData/hxscript_/x", "User script object x of block "},
      {"CGTmpData/hxscript_C/", "User script object  of block C"},
      {"CGTmpData/hxscript_C", "CGTmpData/hxscript_C"},
      {"cgtmpdata/hxscript_C/3/x", "cgtmpdata/hxscript_C/3/x"},
      {"", ""}};
  for (const auto& [path, description] : rows) {
    KyCXString text(path);
    HX_StringParser().processDDPath(text, text);
    EXPECT_EQ(text, description);
  }
}

}  // namespace
