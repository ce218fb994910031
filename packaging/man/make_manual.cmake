# Puts what PROGRAM says of its options and commands into the page IN, and writes OUT.
execute_process(COMMAND ${PROGRAM} --manual OUTPUT_VARIABLE sections RESULT_VARIABLE failed)
if(failed)
  message(FATAL_ERROR "${PROGRAM} --manual: ${failed}")
endif()
file(READ ${IN} page)
string(REPLACE ".\\\" sections\n" "${sections}" page "${page}")
file(WRITE ${OUT} "${page}")
