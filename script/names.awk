# Checks names of files, guards and classes. Prints one line per wrong name;
# exit code 1 if a line was printed. Runs in the root of the tree.
#
#   awk -f script/names.awk src/FLAG.h ...
#
# - A file included with quotes exists under exactly this name, below src/,
#   tests/, bench/ or the root, or beside the including file.
# - The guard of a header is its include path in capitals; headers of tests that
#   stand for headers of a host keep guards of their own.
# - A header of src/ defines at most one class and is named after the class.

function report(text) {
  print FILENAME ":" FNR ": " text
  faults = 1
}

function exists(path,   line, known) {
  known = (getline line < path) >= 0
  close(path)
  return known
}

FNR == 1 {
  finish()
  guard = "missing"
  class = ""
  folder = FILENAME
  sub(/[^\/]*$/, "", folder)
  header = FILENAME ~ /\.h$/ ? FILENAME : ""
  wanted = FILENAME
  sub(/^(src|tests|bench|docs)\//, "", wanted)
  wanted = toupper(wanted)
  gsub(/[^A-Z0-9]/, "_", wanted)
}

# At the end of a header.
function finish() {
  if (header != "" && guard != "defined" &&
      header !~ /^tests\/(consumer\/foreign|Naming\/folding)\//) {
    print header ": the guard is not " wanted
    faults = 1
  }
}

# The peers of a benchmark may be missing.
/^# *include +"/ && !/"absl\// {
  split($0, parts, "\"")
  if (!exists("src/" parts[2]) && !exists("tests/" parts[2]) &&
      !exists("bench/" parts[2]) && !exists(parts[2]) &&
      !exists(folder parts[2]))
    report("no file is called \"" parts[2] "\"")
}

header != "" && guard == "missing" && $1 == "#ifndef" {
  guard = $2 == wanted ? "asked" : "wrong"
}
header != "" && guard == "asked" && $1 == "#define" {
  guard = $2 == wanted ? "defined" : "wrong"
}

header ~ /^src\// && /^class [^;]*$/ {
  name = $2 ~ /_API$/ ? $3 : $2
  base = header
  gsub(/.*\/|\.h$/, "", base)
  if (class != "") report("a second class, " name)
  else if (name != base) report("the class is called " name)
  class = name
}

END {
  finish()
  exit faults
}
