"""Runs bench/ratios.py on programs that answer with prepared figures.

  python3 ratios_test.py <bench/ratios.py> <scratch folder>
"""

import json
import pathlib
import shutil
import subprocess
import sys

# A program that finds its answer by the name it is asked for, and stores it in
# the form of the benchmark library.
PROGRAM = '''#!/bin/sh
for option in "$@"; do
  case $option in
    --benchmark_filter=*) name=${option#*=} ;;
    --benchmark_out=*) out=${option#*=} ;;
  esac
done
case $name in
  '^BM_Ours/1\\.5$') answer='{"items_per_second": 1e9}' ;;
  ^BM_Slow\\$) answer='{"items_per_second": 5e8}' ;;
  ^BM_NoItems\\$) answer='{"real_time": 1}' ;;
  ^BM_NoPeer\\$) answer='{"error_occurred": true,
                        "error_message": "peer not installed: libx-dev"}' ;;
  ^BM_Crash\\$) echo "bad luck" >&2; exit 3 ;;
  *) answer= ;;
esac
echo "{\\"benchmarks\\": [$answer]}" >"$out"
'''

# workload, program, ours, peer, must, aim -> verdict
CASES = [
    ("half the time", "BM_Ours/1.5", "BM_Slow", 0.5, 0.5, "aim reached"),
    ("between both", "BM_Ours/1.5", "BM_Slow", 0.5, 0.4, "ok"),
    ("twice the time", "BM_Slow", "BM_Ours/1.5", 1.9, 1.0, "MISSED"),
    ("no items", "BM_Slow", "BM_NoItems", 9, 9,
     "BM_NoItems does not count its items"),
    ("no peer", "BM_Slow", "BM_NoPeer", 9, 9, "peer not installed: libx-dev"),
    ("crash", "BM_Crash", "BM_Slow", 9, 9,
     "bench_X ended with 3: bad luck"),
    ("unknown name", "BM_Ours/1x5", "BM_Slow", 9, 9,
     "bench_X has 0 benchmarks BM_Ours/1x5"),
]


def run(root, rows):
    """Exit code, printed text and results of one run over the rows."""
    (root / "bench/Folder/ratios.json").write_text(json.dumps(rows))
    done = subprocess.run(
        [sys.executable, root / "bench/ratios.py", "--rounds", "2"],
        capture_output=True, text=True)
    path = root / "build/bench/results.json"
    results = json.loads(path.read_text())["rows"] if path.exists() else []
    return done.returncode, done.stdout + done.stderr, results


def main():
    root = pathlib.Path(sys.argv[2])
    shutil.rmtree(root, ignore_errors=True)
    programs = root / "build/bench/bench/Folder"
    programs.mkdir(parents=True)
    (root / "bench/Folder").mkdir(parents=True)
    shutil.copy(sys.argv[1], root / "bench/ratios.py")
    (root / "build/bench/CMakeCache.txt").write_text(
        "CMAKE_CXX_COMPILER:FILEPATH=/usr/bin/c++\n")
    (programs / "bench_X").write_text(PROGRAM)
    (programs / "bench_X").chmod(0o755)

    rows = [{"workload": case[0], "program": "bench_X", "ours": case[1],
             "peer": case[2], "must": case[3], "aim": case[4]}
            for case in CASES]
    code, text, results = run(root, rows)
    faults = [f"{result['workload']}: {result['verdict']}"
              for case, result in zip(CASES, results, strict=True)
              if result["verdict"] != case[5]]
    if (results[0]["ours_ns"], results[0]["peer_ns"]) != (1, 2):
        faults.append(f"wrong times per item: {results[0]}")
    if code != 1:
        faults.append(f"rows not reached gave exit code {code}")
    if "\npeer not installed: libx-dev\n" not in text:
        faults.append("the missing package is not named")
    if run(root, rows[:2])[0] != 0:
        faults.append("rows that are all reached gave an error")
    code, text, _ = run(root, [{"workload": "x", "must": 1}])
    if code != 1 or "expected the keys" not in text:
        faults.append(f"a row without its keys gave {code}: {text}")
    for fault in faults:
        print(fault)
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
