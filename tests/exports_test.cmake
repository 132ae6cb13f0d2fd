# Compares the dynamic symbols that LIBRARY defines with the names listed in EXPECTED.
execute_process(COMMAND ${NM} --dynamic --defined-only --format=posix ${LIBRARY}
                OUTPUT_VARIABLE symbols COMMAND_ERROR_IS_FATAL ANY)
string(REGEX MATCHALL "[^\n]+" symbols "${symbols}")
list(TRANSFORM symbols REPLACE " .*" "")
list(SORT symbols)

file(STRINGS ${EXPECTED} expected REGEX "^[^#]")
list(SORT expected)

set(extra ${symbols})
list(REMOVE_ITEM extra ${expected})
set(missing ${expected})
list(REMOVE_ITEM missing ${symbols})
list(LENGTH symbols count)
message(STATUS "${count} names exported by ${LIBRARY}")
if(count EQUAL 0)
  message(FATAL_ERROR " ${LIBRARY} exports nothing, and ${EXPECTED} lists nothing")
endif()
if(extra OR missing)
  message(FATAL_ERROR "exported but not listed: ${extra}\nlisted but not exported: ${missing}")
endif()
