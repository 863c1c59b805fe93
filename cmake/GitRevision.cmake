# Writes HEADER with the revision that SOURCE is checked out at, "" where it is no checkout of its own. The file
# keeps its time while nothing has changed, so that nothing is compiled again.
set(revision "")
if(EXISTS "${SOURCE}/.git")
  execute_process(COMMAND git -C "${SOURCE}" describe --always --abbrev=12 --dirty "--exclude=*"
    OUTPUT_VARIABLE revision OUTPUT_STRIP_TRAILING_WHITESPACE ERROR_QUIET RESULT_VARIABLE result)
  if(NOT result EQUAL 0)
    set(revision "")
  endif()
endif()
set(text "#define TESSAL_GIT_REVISION \"${revision}\"\n")
set(present "")
if(EXISTS "${HEADER}")
  file(READ "${HEADER}" present)
endif()
if(NOT text STREQUAL present)
  file(WRITE "${HEADER}" "${text}")
endif()
