# Writes OUTPUT, the header that says what was built out of SOURCE: run before each build, it changes the header only when
# something in it has changed. There is no date in it, so that the same sources give the same programs.
#   cmake -D SOURCE=… -D OUTPUT=… -D VERSION=… -D BUILD=… -P WriteBuildHeader.cmake
set(commit "unknown")

# A git repository that begins further up is not this tree's.
execute_process(COMMAND git -C ${SOURCE} rev-parse --show-toplevel
    OUTPUT_VARIABLE top OUTPUT_STRIP_TRAILING_WHITESPACE RESULT_VARIABLE failed ERROR_QUIET)
get_filename_component(source "${SOURCE}" REALPATH)
if(failed STREQUAL "0" AND top STREQUAL source)
    execute_process(COMMAND git -C ${SOURCE} describe --always --exclude=* --abbrev=12 --dirty=+changes
        OUTPUT_VARIABLE described OUTPUT_STRIP_TRAILING_WHITESPACE RESULT_VARIABLE failed ERROR_QUIET)
    if(failed STREQUAL "0")
        set(commit "${described}")
    endif()
else()
    file(STRINGS ${SOURCE}/cmake/archive-commit archived LIMIT_COUNT 1)
    if(archived MATCHES "^[0-9a-f]+$")
        string(SUBSTRING "${archived}" 0 12 commit)
    endif()
endif()

set(header "#pragma once
// Written by cmake/WriteBuildHeader.cmake.
#define KELVO_VERSION \"${VERSION}\"
#define KELVO_COMMIT \"${commit}\"
#define KELVO_BUILD \"${BUILD}\"
")
set(before "")
if(EXISTS ${OUTPUT})
    file(READ ${OUTPUT} before)
endif()
if(NOT header STREQUAL before)
    file(WRITE ${OUTPUT} "${header}")
endif()
