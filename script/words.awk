# Counts the pointers in comments and documents: words in place of a noun. For
# each pointer a reader must look back.
#
#   awk -f script/words.awk LIMIT FILE...        one line per file over LIMIT
#   awk -v TOTAL=src -f script/words.awk LIMIT FILE...   all files as one text
#
# LIMIT is in pointers per 100 words. Of sources, scripts (script/NAME) and CMake
# files only comment lines count, of Markdown only text outside code blocks.
# Texts below 60 words are too short to judge. Exit code 1 if a line was printed.

BEGIN {
  limit = ARGV[1]
  ARGV[1] = ""
  list = "it its them they their those that which whose what one ones other " \
         "others so such there each"
  count = split(list, words, " ")
  for (i = 1; i <= count; i++) pointer[words[i]] = 1
}

function judge(name) {
  if (total >= 60 && 100 * found / total > limit) {
    printf "%s: %.1f pointers in 100 words, at most %s\n", name,
           100 * found / total, limit
    faults = 1
  }
  total = found = 0
}

FNR == 1 {
  if (NR > 1 && TOTAL == "") judge(last)
  last = FILENAME
  prose = FILENAME ~ /\.md$/
  hashed = FILENAME ~ /CMakeLists\.txt$|\.cmake$|^script\//
  fenced = 0
}

prose && /^ *```/ {
  fenced = !fenced
  next
}
prose && fenced { next }
!prose && !hashed && !/^[ \t]*\/\// { next }
hashed && !/^[ \t]*#[^!]/ { next }

{
  text = tolower($0)
  if (prose)
    gsub(/`[^`]*`|\]\([^)]*\)/, " ", text)
  gsub(/[^a-z]+/, " ", text)
  n = split(text, word, " ")
  total += n
  for (i = 1; i <= n; i++) found += word[i] in pointer
}

END {
  judge(TOTAL != "" ? TOTAL : last)
  exit faults
}
