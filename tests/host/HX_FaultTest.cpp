// What the program does where it cannot write or is stopped: one line, and
// nothing is left behind.
#include <fcntl.h>

#include <cerrno>
#include <climits>
#include <csignal>
#include <set>

#include "host/HX_HostTest.h"
#include "host/HX_Output.h"

namespace fs = std::filesystem;
using testing::HasSubstr;

namespace {

int s_RenamesThatWork = INT_MAX;

}  // namespace

// The standard library's calls come here.
extern "C" [[gnu::visibility("default")]] int rename(const char* from,
                                                     const char* to) noexcept {
  if (s_RenamesThatWork-- > 0) return renameat(AT_FDCWD, from, AT_FDCWD, to);
  errno = EIO;
  return -1;
}

namespace {

struct FaultCase {
  const char* why;
  const char* command;  // for the shell, see below
  const char* message;  // null for none
  int code = 2;
};

// $P is the program, $M the demo model, $B a document of which the name map
// fills more than a pipe, $f an empty file, $d an empty folder, $p a pipe, $n a
// new name.
const FaultCase kFaults[] = {
    {"full device", "$P names $M >/dev/full", "standard output"},
    {"full device for the name map",
     "$P generate $M --json --out $n >/dev/full", "standard output"},
    {"full device for the summary", "$P generate $M --out $n >/dev/full",
     "standard output"},
    {"closed output", "$P names $M >&-", "standard output"},
    {"closed output for the help", "$P --help >&-", "standard output"},
    {"reader that leaves", "head -c 1 <$p >/dev/null & $P names $B --json >$p",
     "standard output"},
    {"file in place of the folder", "$P generate $M --out $f",
     "cannot be written: "},
    {"file on the way to the folder", "$P generate $M --out $f/a/b",
     "cannot be written: "},
    {"folder where no one may write", "$P generate $M --out /proc/hx/out",
     "cannot be written: "},
    {"profile where no one may write", "$P names $M --profile /proc/hx", ""},
    {"files may not grow", "ulimit -f 4; $P generate $M --out $n/o",
     "cannot be written: File too large"},
    {"files may not grow in a folder", "ulimit -f 4; $P generate $M --out $d",
     "cannot be written: File too large"},
    {"folder removed between writing and placing",
     "{ head -c 1; rm -rf $n; cat; } <$p >/dev/null & "
     "$P generate $B --json --out $n >$p",
     "cannot be written: "},
    {"full disk",
     "unshare -m sh -c 'mount -t tmpfs -o size=16k none $d && $P generate $M "
     "--out $d; code=$?; ls -A $d; exit $code'",
     "cannot be written: No space left"},
    {"read-only folder",
     "unshare -m sh -c 'mount --bind -o ro $d $d && $P generate $M --out $d'",
     "cannot be written: Read-only"},
    {"working folder removed", "cd $d; mkdir x; cd x; rmdir ../x; $P names $M",
     ""},
    {"trace in whose place is a folder",
     "mkdir $d/HX_Trace.json; $P generate $M --quiet --out $n --profile $d; "
     "code=$?; rm -r $d/*; exit $code",
     "HX_Trace.json: cannot be written: Is a directory"},
    {"terminated between writing and placing",
     "{ head -c 1; kill -TERM $(ls -A $n | cut -d- -f2); cat; } <$p >/dev/null "
     "& $P generate $B --json --out $n >$p; exit $?",
     nullptr, 128 + SIGTERM},
    {"terminated, and nobody reads what is printed",
     "{ head -c 1; kill -TERM $(ls -A $d | cut -d- -f2); sleep 1; } <$p "
     ">/dev/null & $P generate $B --json --out $d >$p; exit $?",
     nullptr, 128 + SIGTERM},
};

class FaultTest : public HX_HostTest {};

TEST_F(FaultTest, OneLineTellsWhatCannotBeWrittenAndNothingIsLeft) {
  const std::string big = m_Folder / "big.json";
  const std::string work = m_Folder / "work";
  write(big, codegen("synthesize --blocks 400").out);
  const bool mayMount =
      shell("unshare -m mount -t tmpfs none " + m_Folder.string()).code == 0;
  for (const FaultCase& row : kFaults) {
    SCOPED_TRACE(row.why);
    if (!mayMount &&
        std::string(row.command).find("mount") != std::string::npos) {
      GTEST_LOG_(INFO) << "may not mount, skipped: " << row.why;
      continue;
    }
    fs::remove_all(work);
    shell("mkdir -p " + work + "/d; cd " + work + "; : >f; mkfifo p");
    const Result result =
        shell("(export P='" HX_CODEGEN_COMMAND "' M='" HX_DEMO_MODEL "' B='" +
              big + "' d=" + work + "/d f=" + work + "/f p=" + work +
              "/p n=" + work + "/n; " + row.command + ")");
    EXPECT_EQ(row.code, result.code);
    EXPECT_EQ("", result.out);
    // After the messages about the model.
    const std::size_t line = result.err.rfind("hx_codegen: ");
    EXPECT_EQ(row.message == nullptr, line == std::string::npos) << result.err;
    if (row.message != nullptr && line != std::string::npos) {
      EXPECT_EQ(result.err.find("hx_codegen: "), line) << result.err;
      EXPECT_EQ(result.err.find('\n', line), result.err.size() - 1);
      EXPECT_THAT(result.err.substr(line), HasSubstr(row.message));
    }
    std::set<std::string> left;
    for (const auto& entry : fs::recursive_directory_iterator(work))
      left.insert(entry.path().filename());
    EXPECT_THAT(left, testing::ElementsAre("d", "f", "p"));
  }
}

TEST_F(FaultTest, OldFileThatCannotBePutBackStaysAndIsNamed) {
  std::string message;
  {
    HX_Output output(m_Folder);
    for (const char* name : {"a", "b"}) {
      write(m_Folder / name, "old");
      output.open(name) << "new";
    }
    output.finish();
    s_RenamesThatWork = 1;
    try {
      output.commit();
    } catch (const HX_OutputError& error) {
      message = error.what();
    }
  }
  s_RenamesThatWork = INT_MAX;
  const std::string expected = (m_Folder / "b").string() +
                               ": cannot be written: Input/output error; "
                               "old files are in ";
  ASSERT_THAT(message, testing::StartsWith(expected));
  const fs::path place = message.substr(expected.size());
  EXPECT_EQ("old", read(place / "a"));
}

}  // namespace
