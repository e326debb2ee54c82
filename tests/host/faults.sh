#!/bin/sh
# The faults of HX_FaultTest.cpp: faults.sh NAME runs the program in a world that
# stops the program. The test prepares the world: $P the program, $M the demo
# model, $B a document with a name map larger than a pipe, $f an empty file, $d
# an empty folder, $p a pipe, $n a new name. The exit code is that of the
# program. The words of $P are separate arguments.
# shellcheck disable=SC2086,SC2154,SC2016

# Reads one byte of the pipe, then does the argument, then reads the rest: the
# program has written all files and not yet moved them.
between() {
  { head -c 1 && eval "$1" && cat; } <"$p" >/dev/null &
}

generate_into() { $P generate "$B" --json --out "$1" >"$p"; }

# Whether an old name map is back in its place; removes the map.
is_old_map_back() {
  grep -qx old "$d/name_map.json" && rm "$d/name_map.json"
}

case $1 in
  full_device) $P names "$M" >/dev/full ;;
  full_device_for_summary) $P generate "$M" --out "$n" >/dev/full ;;
  full_device_for_summary_over_old_files)
    echo old >"$d/name_map.json"
    $P generate "$M" --out "$d" >/dev/full
    code=$?
    is_old_map_back
    exit $code
    ;;
  closed_output) $P names "$M" >&- ;;
  reader_leaves)
    head -c 1 <"$p" >/dev/null &
    $P names "$B" --json >"$p"
    ;;
  file_for_folder) $P generate "$M" --out "$f" ;;
  full_disk)
    # Without a table of its own the mount would stay.
    export d M P
    unshare -m sh -c 'mount -t tmpfs -o size=16k none "$d" &&
      $P generate "$M" --out "$d"; code=$?; ls -A "$d"; exit $code'
    ;;
  read_only_folder)
    export d M P
    unshare -m sh -c 'mount --bind -o ro "$d" "$d" &&
      $P generate "$M" --out "$d"'
    ;;
  profile_nowhere) $P names "$M" --profile /proc/hx ;;
  profile_of_refused_document) $P names "$f" --profile "$n" ;;
  profile_of_refused_document_over_old_one)
    echo old >"$d/HX_Trace.json"
    $P names "$f" --profile "$d"
    code=$?
    grep -qx old "$d/HX_Trace.json" && rm "$d/HX_Trace.json"
    exit $code
    ;;
  files_may_not_grow)
    # The counters of a coverage build are files, too.
    ulimit -f 4
    GCOV_PREFIX=/tmp/hx_gcov $P generate "$M" --out "$n/o"
    ;;
  working_folder_removed)
    cd "$d" && mkdir x && cd x && rmdir ../x && $P names "$M"
    ;;
  trace_is_folder)
    mkdir "$d/HX_Trace.json"
    $P generate "$M" --quiet --out "$n" --profile "$d"
    code=$?
    rmdir "$d/HX_Trace.json"
    exit $code
    ;;
  folder_removed)
    between 'rm -rf "$n"'
    generate_into "$n"
    ;;
  file_cannot_be_placed)
    echo old >"$d/name_map.json"
    between 'rm "$d"/.hx*/new/synthetic.c'
    generate_into "$d"
    code=$?
    is_old_map_back
    exit $code
    ;;
  temporary_folder_removed)
    echo old >"$d/name_map.json"
    between 'rm -r "$d"/.hx*'
    generate_into "$d"
    code=$?
    is_old_map_back
    exit $code
    ;;
  folder_in_the_way)
    between 'mkdir "$d/name_map.csv" && rm "$d"/.hx*/new/synthetic.c'
    generate_into "$d"
    code=$?
    cd "$d"/.hx*/old && rmdir name_map.csv
    cd "$d" && rmdir .hx*/old .hx* && rm name_map.csv
    exit $code
    ;;
  terminated)
    between 'kill -TERM $(ls -A "$n" | cut -d- -f2)'
    generate_into "$n"
    ;;
  terminated_without_reader)
    between 'kill -TERM $(ls -A "$d" | cut -d- -f2) && sleep 1'
    generate_into "$d"
    ;;
  two_runs)
    # The first run waits for the pipe while the second run is refused.
    { head -c 1 >/dev/null && $P generate "$M" --out "$d"; echo $? >"$n"
      cat >/dev/null; } <"$p" &
    generate_into "$d"
    first=$?
    wait
    rm -r "$d"
    mkdir "$d"
    second=$(cat "$n")
    rm "$n"
    [ $first = 0 ] && exit "$second"
    ;;
esac
