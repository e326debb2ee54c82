# hx_embed_text(<text> <array> <result variable>)
#
# C++ source of `const char* const <array>[]` and `<array>Count`. The array holds
# the text in pieces, because MSVC limits a literal to 16,380 characters.
function(hx_embed_text text array result)
  set(source "const char* const ${array}[] = {\n")
  string(LENGTH "${text}" length)
  set(at 0)
  set(count 0)
  while(at LESS length)
    string(SUBSTRING "${text}" ${at} 8000 piece)
    string(APPEND source "R\"hx~(${piece})hx~\",\n")
    math(EXPR at "${at} + 8000")
    math(EXPR count "${count} + 1")
  endwhile()
  string(APPEND source "};\nconst std::size_t ${array}Count = ${count};\n")
  set(${result} "${source}" PARENT_SCOPE)
endfunction()
