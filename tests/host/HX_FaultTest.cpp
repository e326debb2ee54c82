// Failed writes, signals and missing memory: the program prints a line and
// leaves nothing behind.
#include <algorithm>
#include <csignal>
#include <set>

#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
using testing::MatchesRegex;

namespace {

struct FaultCase {
  const char* name;     // of the fault in faults.sh
  const char* message;  // null for none
  int code = 2;
};

const FaultCase kFaults[] = {
    {"full_device", "standard output"},
    {"full_device_for_summary", "standard output"},
    {"full_device_for_summary_over_old_files", "standard output"},
    {"closed_output", "standard output"},
    {"reader_leaves", "standard output"},
    {"file_for_folder", "cannot be written: "},
    {"full_disk", "cannot be written: No space left"},
    {"read_only_folder", "cannot be written: Read-only"},
    {"profile_nowhere", "/proc/hx: cannot be written: "},
    {"files_may_not_grow", "cannot be written: File too large"},
    {"working_folder_removed", ""},
    {"trace_is_folder", "HX_Trace.json: cannot be written: Is a directory"},
    {"folder_removed", "cannot be written: "},
    {"file_cannot_be_placed",
     "synthetic.c: cannot be written: No such file or directory"},
    {"temporary_folder_removed", "cannot be written: "},
    {"folder_in_the_way",
     "synthetic.c: cannot be written: No such file or directory; old files are "
     "in "},
    {"terminated", nullptr, 128 + SIGTERM},
    {"terminated_without_reader", nullptr, 128 + SIGTERM},
    {"two_runs", "cannot be written: process [0-9]+ writes into the folder"},
};

class FaultTest : public HX_HostTest {
 protected:
  // The world of faults.sh.
  std::string prepared(const std::string& command) const {
    return "mkdir -p " + (m_Work / "d").string() + "; cd " + m_Work.string() +
           "; : >f; mkfifo p; export P='" HX_CODEGEN_COMMAND
           "' M='" HX_DEMO_MODEL
           "' B=$PWD/../big.json d=$PWD/d f=$PWD/f p=$PWD/p n=$PWD/n; "
           "(" +
           command + ")";
  }
  std::string leftovers() const {
    return shell("find " + m_Work.string() +
                 " -mindepth 1 -printf '%P\\n' | sort")
        .out;
  }

  const fs::path m_Work = m_Folder / "work";
};

TEST_F(FaultTest, OneLineTellsWhatCannotBeWrittenAndNothingIsLeft) {
  write(m_Folder / "big.json", codegen("synthesize --blocks 400").out);
  const bool mayMount =
      shell("unshare -m mount -t tmpfs none " + m_Folder.string()).code == 0;
  if (!mayMount) GTEST_LOG_(INFO) << "may not mount: no full disk is tried";
  for (const FaultCase& row : kFaults) {
    const std::string name = row.name;
    if (!mayMount && (name == "full_disk" || name == "read_only_folder"))
      continue;
    SCOPED_TRACE(name);
    fs::remove_all(m_Work);
    const Result result = shell(prepared(HX_TEST_FOLDER "/faults.sh " + name));
    EXPECT_EQ(row.code, result.code);
    EXPECT_EQ("", result.out);
    std::string line;
    if (row.message != nullptr)
      line = "hx_codegen: [^\n]*" + std::string(row.message) + "[^\n]*\n";
    // After the messages about the model.
    const std::size_t at = result.err.find("hx_codegen: ");
    EXPECT_THAT(result.err.substr(std::min(at, result.err.size())),
                MatchesRegex(line));
    EXPECT_EQ("d\nf\np\n", leftovers());
  }
}

TEST_F(FaultTest, RefusedDocumentsLeaveNoProfile) {
  for (const std::string name : {"profile_of_refused_document",
                                 "profile_of_refused_document_over_old_one"}) {
    SCOPED_TRACE(name);
    fs::remove_all(m_Work);
    const Result result = shell(prepared(HX_TEST_FOLDER "/faults.sh " + name));
    EXPECT_EQ(2, result.code);
    EXPECT_EQ((m_Work / "f").string() +
                  ":1:1: /: found the end of the file, expected a JSON "
                  "document\n",
              result.err);
    EXPECT_EQ("d\nf\np\n", leftovers());
  }
}

// Memory that ends anywhere gives a line, and no file is written; with enough
// memory the files are the same as ever.
TEST_F(FaultTest, MissingMemoryIsOneLine) {
  // Sanitizers and emulators need far more addresses than the program.
  if (shell("ulimit -v 300000; " HX_CODEGEN_COMMAND " --version").code != 0)
    GTEST_SKIP() << "addresses cannot be limited here";
  const std::string model = m_Folder / "big.json";
  write(model, codegen("synthesize --blocks 2000").out);
  ASSERT_EQ(0, generate(model).code);
  const Files whole = filesIn(m_Out);

  const auto run = [&](int kilobytes, const std::string& arguments) {
    fs::remove_all(m_Out);
    return shell("ulimit -v " + std::to_string(kilobytes) + "; " +
                 HX_CODEGEN_COMMAND " " + arguments);
  };
  // About the smallest limit with which a command succeeds.
  const auto enoughFor = [&](const std::string& arguments) {
    int low = 1000;
    int high = 300000;
    while (high - low > 200) {
      const int middle = (low + high) / 2;
      (run(middle, arguments).code == 0 ? high : low) = middle;
    }
    return high;
  };
  const std::string generate =
      "generate --quiet " + model + " --out " + m_Out.string();
  // The loader of programs, and what runs before main(), report otherwise.
  const int start = enoughFor("--version");
  const int end = enoughFor(generate);
  constexpr int kSteps = 20;
  std::set<int> codes;
  for (int step = 0; step <= kSteps + 1; ++step) {
    const int kilobytes = start + (end - start) * step / kSteps;
    SCOPED_TRACE(kilobytes);
    if (run(kilobytes, "--version").code != 0) continue;
    const Result result = run(kilobytes, generate);
    codes.insert(result.code);
    if (result.code == 0) {
      EXPECT_EQ(whole, filesIn(m_Out));
      continue;
    }
    EXPECT_EQ(2, result.code);
    EXPECT_THAT(result.err, MatchesRegex("hx_codegen: out of memory[^\n]*\n"));
    EXPECT_FALSE(fs::exists(m_Out));
  }
  EXPECT_EQ((std::set<int>{0, 2}), codes);
}

}  // namespace
