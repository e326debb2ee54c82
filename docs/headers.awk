# What doxygen reads instead of a header, line for line:
# - the comment at the top is that of the file, and the examples in it are code;
#   the comment of the class that the file is named after begins with it;
# - a comment stands for all declarations from there to the next empty line or
#   comment: they become a group that shares it;
# - copying, moving and destroying are told by the comment of the class, and
#   so is a default constructor that is left to the compiler.

# Changes the depth of braces by those in a line, outside of comments and texts.
function follow(line) {
  gsub(/'[{}]'|"[^"]*"|\/\/.*/, "", line)
  depth += gsub(/[{(]/, "", line) - gsub(/[})]/, "", line)
}

# Prints the line before this one: a group may yet begin at its end.
function out(line) {
  if (printed++) print last
  last = line
}

# Prints the comment and the declarations below it, with a group around them if
# they are several.
function flush(   i) {
  if (ends > 1) {
    last = last (last ~ /\/\// ? "\n" : " ") "/*!@{*/"
    lines[count] = lines[count] " /*!@}*/"
    # Not each of them has each parameter.
    for (i = 1; i <= count; ++i) sub(/\\param(\[[a-z,]*\])? +/, "\\b ", lines[i])
  }
  for (i = 1; i <= count; ++i) out(lines[i])
  count = ends = depth = 0
}

function hold() {
  lines[++count] = $0
  if ($0 ~ /^ *\/\/\//) return
  follow($0)
  if (depth == 0 && $0 ~ /[;}] *(\/\/.*)?$/) ++ends
}

NR == 1 { out("/// \\file"); top = 1 }
top && /^$/ { top = 0; next }
top { if (!sub(/^\/\/   /, "///       ")) sub(/^\/\//, "///"); out($0); next }

count == 0 && (\
    /^ *(virtual )?~[A-Za-z_]+\(\)( = default| override)?(;| \{.*\})$/ ||
    /^ *[A-Za-z_]+\(\) = (default|delete);$/ ||
    /^ *([A-Za-z_]+& operator=|[A-Za-z_]+)\((const [A-Za-z_]+&|[A-Za-z_]+&&)( other)?\)( noexcept)?( = (default|delete)|( \{.*\}))?;?$/) {
  $0 = "//"
}

# ... and one that stands in a group ends it.
count && ends && depth == 0 && /^ *[A-Za-z_& ]+(=)?\((const [A-Za-z_]+&)?\) = (default|delete);$/ {
  flush()
  $0 = "//"
}

depth == 0 && /^ *\/\/\/([^<]|$)/ && (count == 0 || ends) {
  flush()
  hold()
  next
}
count && depth == 0 && (/^ *(\/\/([^\/]|$)|$|#|public:|private:|protected:|}|template.*(class|struct)|class|struct|enum|namespace|friend)/) {
  if (ends || /^ *(#|}|template.*(class|struct)|class|struct|enum|namespace)/) {
    if (!ends && match(FILENAME, /[^\/]*$/) &&
        $0 ~ "^class .*" substr(FILENAME, RSTART, RLENGTH - 2) " ?[:{]")
      sub(/\/\/\//, "/// \\intro{" substr(FILENAME, RSTART) "}", lines[1])
    flush()
    out($0)
    next
  }
}
count { hold(); next }
{ out($0) }
END {
  flush()
  out("")
}
