# Writes a source that holds the revision of the checkout SOURCE to OUT, and leaves OUT alone where
# it says so already. Run at each build.
set(revision "unknown")
find_program(GIT git)
if(GIT)
  # A copy of the sources within another checkout is none of its own.
  execute_process(COMMAND ${GIT} rev-parse --show-prefix WORKING_DIRECTORY ${SOURCE}
    OUTPUT_VARIABLE prefix RESULT_VARIABLE failed ERROR_QUIET OUTPUT_STRIP_TRAILING_WHITESPACE)
  if(NOT failed AND prefix STREQUAL "")
    execute_process(COMMAND ${GIT} describe --always --dirty --abbrev=7 --exclude=*
      WORKING_DIRECTORY ${SOURCE}
      OUTPUT_VARIABLE described RESULT_VARIABLE failed ERROR_QUIET OUTPUT_STRIP_TRAILING_WHITESPACE)
    if(NOT failed AND described)
      set(revision "${described}")
    endif()
  endif()
endif()
set(text "#include \"revision/revision.h\"\n\nstd::string_view kora::Revision() { return \"${revision}\"; }\n")
if(EXISTS ${OUT})
  file(READ ${OUT} before)
endif()
if(NOT "${before}" STREQUAL "${text}")
  file(WRITE ${OUT} "${text}")
endif()
