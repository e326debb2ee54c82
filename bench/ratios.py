"""Measures the rows of bench/*/ratios.json and prints them as a table.

Each row names two benchmarks of one program, ours and its peer:

  {"workload": "copy 25 characters", "program": "bench_Strings",
   "ours": "BM_KyCXString_Copy/25", "peer": "BM_U16String_Copy/25",
   "must": 1.0, "aim": 0.5}

The ratio is time per item of ours through time per item of the peer; 1.5 means
that ours takes half as long again. In a row that watches growth the peer is
our own benchmark at the smaller size.

Each benchmark runs in a process of its own, once per round, so that neither
sees the other's heap and caches, and a slow minute of the machine falls on
all of them. The figure is the median over the rounds.

Run by script/bench, which builds the programs first.
"""

import argparse
import datetime
import json
import os
import pathlib
import platform
import re
import statistics
import subprocess
import sys
import tempfile

ROOT = pathlib.Path(__file__).resolve().parent.parent
NANOSECONDS = {"ns": 1.0, "us": 1e3, "ms": 1e6, "s": 1e9}


class Unmeasurable(Exception):
    """A benchmark that gave no figure; the text says why."""


def read_rows(folders):
    """The rows of the folders, each with its folder; a faulty one ends us."""
    known = {"workload", "program", "ours", "peer", "must", "aim"}
    rows = []
    for folder in folders:
        path = ROOT / "bench" / folder / "ratios.json"
        if not path.exists():
            sys.exit(f"bench/{folder}: no ratios.json")
        try:
            found = json.loads(path.read_text())
        except json.JSONDecodeError as error:
            sys.exit(f"{path}: {error}")
        for row in found:
            if set(row) - known or known - {"aim"} - set(row):
                sys.exit(f"{path}: expected the keys {sorted(known)}: {row}")
            rows.append({"folder": folder, "aim": row["must"], **row})
    return rows


def run_once(programs, program, name, seconds):
    """Nanoseconds per item of one benchmark, measured in a new process."""
    executable = programs / program
    if not executable.exists():
        raise Unmeasurable(f"{program} was not built")
    pattern = "^" + re.sub(r"([.^$*+?()\[{\\|])", r"\\\1", name) + "$"
    with tempfile.NamedTemporaryFile(suffix=".json") as out:
        run = subprocess.run(
            [executable, f"--benchmark_filter={pattern}",
             f"--benchmark_min_time={seconds}", f"--benchmark_out={out.name}",
             "--benchmark_out_format=json"],
            stdout=subprocess.DEVNULL, stderr=subprocess.PIPE, text=True)
        if run.returncode != 0:
            last = (run.stderr.strip().splitlines() or ["no output"])[-1]
            raise Unmeasurable(f"{program} ended with {run.returncode}: {last}")
        text = pathlib.Path(out.name).read_text()
    results = json.loads(text)["benchmarks"] if text.strip() else []
    if len(results) != 1:
        raise Unmeasurable(f"{program} has {len(results)} benchmarks {name}")
    result = results[0]
    if result.get("error_occurred"):
        raise Unmeasurable(result["error_message"])
    if "items_per_second" in result:
        return 1e9 / result["items_per_second"]
    raise Unmeasurable(f"{name} does not count its items")


def measure(programs, rows, rounds, seconds):
    """(program, name) -> list of figures, or the text why there is none."""
    wanted = dict.fromkeys((row["program"], row[side])
                           for row in rows for side in ("ours", "peer"))
    figures = {key: [] for key in wanted}
    for number in range(rounds):
        if sys.stderr.isatty():
            print(f"\rround {number + 1} of {rounds}", end="", file=sys.stderr)
        for key in wanted:
            if isinstance(figures[key], str):
                continue
            try:
                figures[key].append(run_once(programs, *key, seconds))
            except Unmeasurable as reason:
                figures[key] = str(reason)
    if sys.stderr.isatty():
        print("\r", end="", file=sys.stderr)
    return figures


def judge(row, figures):
    """The row with its figures, ratio and verdict."""
    result = dict(row)
    for side in ("ours", "peer"):
        found = figures[(row["program"], row[side])]
        if isinstance(found, str):
            return {**result, "verdict": found}
        result[side + "_ns"] = statistics.median(found)
        # Half the distance between the quartiles, in parts of the median.
        if len(found) > 1:
            low, _, high = statistics.quantiles(found, n=4)
            result[side + "_spread"] = (high - low) / 2 / result[side + "_ns"]
    result["ratio"] = result["ours_ns"] / result["peer_ns"]
    if result["ratio"] <= row["aim"]:
        result["verdict"] = "aim reached"
    elif result["ratio"] <= row["must"]:
        result["verdict"] = "ok"
    else:
        result["verdict"] = "MISSED"
    return result


def print_table(results):
    width = max(len(result["workload"]) for result in results)
    print(f"{'workload':{width}} {'ours ns':>10} {'peer ns':>10} {'ratio':>6} "
          f"{'must':>6} {'aim':>6}  verdict")
    folder = None
    for result in results:
        if result["folder"] != folder:
            folder = result["folder"]
            print(f"-- {folder}")
        cells = [f"{result[key]:{form}}" if key in result else "-".rjust(size)
                 for key, form, size in (("ours_ns", "10.2f", 10),
                                         ("peer_ns", "10.2f", 10),
                                         ("ratio", "6.2f", 6))]
        print(f"{result['workload']:{width}} {' '.join(cells)} "
              f"{result['must']:6.2f} {result['aim']:6.2f}  "
              f"{result['verdict']}")


def describe_machine():
    """What a reader needs to know to judge the figures."""
    cpu = platform.machine()
    try:
        found = re.search(r"^model name\s*: (.*)$",
                          pathlib.Path("/proc/cpuinfo").read_text(), re.M)
        cpu = found.group(1) if found else cpu
    except OSError:
        pass
    commit = subprocess.run(["git", "-C", ROOT, "rev-parse", "HEAD"],
                            capture_output=True, text=True).stdout.strip()
    cache = (ROOT / "build/bench/CMakeCache.txt").read_text()
    compiler = re.search(r"^CMAKE_CXX_COMPILER:\w+=(.*)$", cache, re.M).group(1)
    version = subprocess.run([compiler, "--version"], capture_output=True,
                             text=True).stdout.splitlines()[0]
    return {"cpu": cpu, "cores": os.cpu_count(), "compiler": version,
            "load": os.getloadavg()[0], "commit": commit,
            "date": datetime.datetime.now().isoformat(timespec="seconds")}


def main():
    parser = argparse.ArgumentParser(prog="script/bench")
    parser.add_argument("folder", nargs="*", help="folders of bench/")
    parser.add_argument("--rounds", type=int, default=7)
    parser.add_argument("--seconds", type=float, default=0.1,
                        help="least time of one measurement")
    parser.add_argument("--list", action="store_true",
                        help="only print the programs that are needed")
    arguments = parser.parse_args()

    folders = arguments.folder or sorted(
        path.parent.name for path in ROOT.glob("bench/*/ratios.json"))
    rows = read_rows(folders)
    if not rows:
        sys.exit("script/bench: no rows to measure")
    if arguments.list:
        print(*sorted({row["program"] for row in rows}))
        return 0
    machine = describe_machine()
    figures = {}
    for folder in folders:
        mine = [row for row in rows if row["folder"] == folder]
        figures.update(measure(ROOT / "build/bench/bench" / folder, mine,
                               arguments.rounds, arguments.seconds))
    results = [judge(row, figures) for row in rows]
    print_table(results)
    print(f"\n{machine['cpu']}, {machine['cores']} cores, load "
          f"{machine['load']:.1f}, {machine['compiler']}; medians of "
          f"{arguments.rounds} rounds")
    missing = sorted({result["verdict"] for result in results
                      if result["verdict"].startswith("peer not installed")})
    for line in missing:
        print(line)
    path = ROOT / "build/bench/results.json"
    path.write_text(json.dumps({"machine": machine, "rows": results}, indent=2)
                    + "\n")
    failed = [result for result in results
              if result["verdict"] not in ("ok", "aim reached")]
    if failed:
        print(f"{len(failed)} of {len(results)} rows not reached")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
