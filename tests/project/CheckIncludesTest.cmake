# Runs CheckIncludes.cmake on a sound tree of three files and on trees with one
# fault of each kind.
#
#   cmake -DCHECKER=<CheckIncludes.cmake> -DWORK=<folder> -P CheckIncludesTest.cmake
cmake_minimum_required(VERSION 3.25)

set(table "platform/low: Mid\nup platform/low Mid: prints it\nMid: platform/low\n")

# expect(<why> <table> <include of src/Mid/M.h> <expected output, a regex>)
function(expect why table include expected)
  file(REMOVE_RECURSE ${WORK})
  file(WRITE ${WORK}/platform/low/L.cpp "#include \"Mid/M.h\"\n")
  file(WRITE ${WORK}/src/Mid/M.h
       "#include \"HX_Export.h\"\n#include \"Mid/implMid/I.h\"\n#include \"platform/low/L.h\"\n#include \"${include}\"\n")
  file(WRITE ${WORK}/src/High/implHigh/I.h "")
  file(WRITE ${WORK}/table.txt "# comment\n\n${table}")
  execute_process(
    COMMAND ${CMAKE_COMMAND} -DROOT=${WORK} -DTABLE=${WORK}/table.txt -P ${CHECKER}
    RESULT_VARIABLE result ERROR_VARIABLE output)
  if(expected STREQUAL "" AND NOT result EQUAL 0)
    message(SEND_ERROR "${why}: refused:\n${output}")
  elseif(result EQUAL 0 AND NOT expected STREQUAL "")
    message(SEND_ERROR "${why}: not found")
  elseif(NOT output MATCHES "${expected}")
    message(SEND_ERROR "${why}: wrong line:\n${output}")
  endif()
endfunction()

expect("sound" "${table}" "Mid/N.h" "")
expect("edge not in the table" "${table}" "High/H.h"
       "src/Mid/M.h: \"High/H.h\": Mid may not include High")
expect("top of src/" "${table}" "FLAG.h" "Mid may not include src")
expect("edge that nothing uses" "${table}Low: High\n" "Mid/N.h"
       "Low -> High: no file needs it")
expect("target without a line" "platform/low: Mid\n" "Mid/N.h"
       "platform/low -> Mid: Mid has no line")
expect("relative include" "${table}" "../Mid/N.h"
       "\"../Mid/N.h\" is not written from src/ or the root")
expect("private folder of another" "${table}" "High/implHigh/I.h"
       "\"High/implHigh/I.h\" is private to High/")
expect("upward edge without reason" "platform/low: Mid\nMid: platform/low\n"
       "Mid/N.h" "platform/low -> Mid: goes up and has no reason")
expect("reason for a downward edge" "${table}up Mid platform/low: why\n"
       "Mid/N.h" "Mid -> platform/low: does not go up")
expect("reason without an edge" "${table}up Mid High: why\n" "Mid/N.h"
       "Mid -> High: a reason without an edge")
expect("line of no known form" "${table}Mid -> High\n" "Mid/N.h"
       "not understood: Mid -> High")
