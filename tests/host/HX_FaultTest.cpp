// What the program does where it cannot write or is stopped: one line, and
// nothing is left behind.
#include <algorithm>
#include <csignal>

#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
using testing::MatchesRegex;

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
    {"full device for the summary", "$P generate $M --out $n >/dev/full",
     "standard output"},
    {"closed output", "$P names $M >&-", "standard output"},
    {"reader that leaves", "head -c 1 <$p >/dev/null & $P names $B --json >$p",
     "standard output"},
    {"file in place of the folder", "$P generate $M --out $f",
     "cannot be written: "},
    {"full disk",
     "unshare -m sh -c 'mount -t tmpfs -o size=16k none $d && $P generate $M "
     "--out $d; code=$?; ls -A $d; exit $code'",
     "cannot be written: No space left"},
    {"read-only folder",
     "unshare -m sh -c 'mount --bind -o ro $d $d && $P generate $M --out $d'",
     "cannot be written: Read-only"},
    {"profile where no one may write", "$P names $M --profile /proc/hx", ""},
    // The counters of a coverage build are files, too.
    {"files may not grow",
     "ulimit -f 4; GCOV_PREFIX=/tmp/hx_gcov $P generate $M --out $n/o",
     "cannot be written: File too large"},
    {"working folder removed", "cd $d; mkdir x; cd x; rmdir ../x; $P names $M",
     ""},
    {"trace in whose place is a folder",
     "mkdir $d/HX_Trace.json; $P generate $M --quiet --out $n --profile $d; "
     "code=$?; rm -r $d/*; exit $code",
     "HX_Trace.json: cannot be written: Is a directory"},
    {"folder removed between writing and placing",
     "{ head -c 1; rm -rf $n; cat; } <$p >/dev/null & "
     "$P generate $B --json --out $n >$p",
     "cannot be written: "},
    {"file that cannot be placed, after one that was: its old form is back",
     "echo old >$d/name_map.json; "
     "{ head -c 1; rm $d/.hx*/new/synthetic.c; cat; } <$p >/dev/null & "
     "$P generate $B --json --out $d >$p; code=$?; "
     "grep -qx old $d/name_map.json && rm $d/name_map.json; exit $code",
     "synthetic.c: cannot be written: No such file or directory"},
    {"temporary folder removed: old files stay",
     "echo old >$d/name_map.json; "
     "{ head -c 1; rm -r $d/.hx*; cat; } <$p >/dev/null & "
     "$P generate $B --json --out $d >$p; code=$?; "
     "grep -qx old $d/name_map.json && rm $d/name_map.json; exit $code",
     "cannot be written: "},
    {"folder that came in the way and cannot be put back: it is kept",
     "{ head -c 1; mkdir $d/name_map.csv; rm $d/.hx*/new/synthetic.c; cat; } "
     "<$p >/dev/null & $P generate $B --json --out $d >$p; code=$?; "
     "cd $d/.hx*/old && rmdir name_map.csv; cd $d; "
     "rmdir .hx*/old .hx* && rm name_map.csv; exit $code",
     "synthetic.c: cannot be written: No such file or directory; old files are "
     "in "},
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
  const fs::path work = m_Folder / "work";
  write(m_Folder / "big.json", codegen("synthesize --blocks 400").out);
  const std::string prepare =
      "mkdir -p " + (work / "d").string() + "; cd " + work.string() +
      "; : >f; mkfifo p; export P='" HX_CODEGEN_COMMAND "' M='" HX_DEMO_MODEL
      "' B=$PWD/../big.json d=$PWD/d f=$PWD/f p=$PWD/p n=$PWD/n; ";
  const std::string leftovers =
      "find " + work.string() + " -mindepth 1 -printf '%P\\n' | sort";
  const bool mayMount =
      shell("unshare -m mount -t tmpfs none " + m_Folder.string()).code == 0;
  if (!mayMount) GTEST_LOG_(INFO) << "may not mount: no full disk is tried";
  for (const FaultCase& row : kFaults) {
    if (!mayMount && std::string(row.command).starts_with("unshare")) continue;
    SCOPED_TRACE(row.why);
    fs::remove_all(work);
    const Result result = shell(prepare + "(" + row.command + ")");
    EXPECT_EQ(row.code, result.code);
    EXPECT_EQ("", result.out);
    std::string line;
    if (row.message != nullptr)
      line = "hx_codegen: [^\n]*" + std::string(row.message) + "[^\n]*\n";
    // After the messages about the model.
    const std::size_t at = result.err.find("hx_codegen: ");
    EXPECT_THAT(result.err.substr(std::min(at, result.err.size())),
                MatchesRegex(line));
    EXPECT_EQ("d\nf\np\n", shell(leftovers).out);
  }
}

}  // namespace
