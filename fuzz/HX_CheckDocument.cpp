// The program run over an arbitrary document. Accepted documents give files,
// and a sample of the C compiles.
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iostream>
#include <iterator>
#include <sstream>

#include "fuzz/HX_DocumentGrammar.h"
#include "fuzz/HX_Fuzz.h"

/// The main() of hx_codegen under another name.
extern "C" int HX_CodegenMain(int argc, const char* const* argv);

namespace {

namespace fs = std::filesystem;

// In memory, and gone with the object.
struct Folder {
  Folder() { fs::create_directory(path); }
  ~Folder() { fs::remove_all(path); }
  fs::path path = "/dev/shm/hx_fuzz_" + std::to_string(getpid());
};

// Bytes behind a byte 1 choose by the grammar of the schema; other bytes are
// the document.
std::string documentOf(HX_Bytes& bytes) {
  std::string text = bytes.rest();
  if (!text.starts_with('\1')) return text;
  HX_Bytes choices(text.substr(1));
  return HX_DocumentFrom(choices);
}

// A compiler takes as long as 20 documents.
bool isSampled(const std::string& document) {
  return std::hash<std::string>()(document) % 32 == 0;
}

void requireCompiles(const fs::path& out, const std::string& document) {
  const std::string command = "cd " + out.string() +
                              " && cc -std=c90 -pedantic-errors -fsyntax-only "
                              "*.c 2>errors";
  if (std::system(command.c_str()) == 0) return;
  std::ifstream errors(out / "errors");
  HX_Require(false,
             "C90 that compiles: " +
                 std::string(std::istreambuf_iterator<char>(errors), {}) +
                 document);
}

}  // namespace

void HX_CheckDocument(HX_Bytes& bytes) {
  static const Folder s_folder;
  const fs::path model = s_folder.path / "model.json";
  const fs::path out = s_folder.path / "out";
  const std::string document = documentOf(bytes);
  std::ofstream(model, std::ios::binary) << document;
  const char* const arguments[] = {
      "hx_codegen",      "generate", model.c_str(), "--keywords",
      HX_KEYWORD_FOLDER, "--json",   "--out",       out.c_str()};

  std::ostringstream output, errors;
  std::streambuf* const oldOutput = std::cout.rdbuf(output.rdbuf());
  std::streambuf* const oldErrors = std::cerr.rdbuf(errors.rdbuf());
  const int code = HX_CodegenMain(std::size(arguments), arguments);
  std::cout.rdbuf(oldOutput);
  std::cerr.rdbuf(oldErrors);
  const std::string text = errors.str();
  HX_Require(code >= 0 && code <= 2, "an exit code");
  HX_Require(fs::exists(out) == (code == 0), "files if and only if it is done");
  HX_Require(output.str().empty() == (code != 0), "the same for the output");
  if (code == 2)
    HX_Require(text.starts_with(model.string() + ":"),
               "lines that name the document: " + text);
  if (code == 0 && isSampled(document)) requireCompiles(out, document);
  fs::remove_all(out);
}
