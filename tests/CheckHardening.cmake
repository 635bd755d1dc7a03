# Holds a built shared object or executable to the hardening of cmake/BuildSettings.cmake, as the file shows it. Run as
#   cmake -DFILE=FILE -DPROTECTIONS="NAME;..." -DFORTIFIED=BOOL -DCOMPILER=... -DREADELF=... -DNM=... -DLDD=...
#       -P THIS
# PROTECTIONS: the compiler's, without the -f.  FORTIFIED: whether the C library's checking functions are in use.

cmake_minimum_required(VERSION 3.20)
include(${CMAKE_CURRENT_LIST_DIR}/../cmake/RunTool.cmake)

# Loaded anywhere in memory.
run_tool(header ${READELF} --file-header --wide ${FILE})
if(NOT header MATCHES "Type: +DYN")
    message(SEND_ERROR "Not position-independent:\n${header}")
endif()

# The tables of addresses are read-only once all symbols are bound, which is before anything runs.
run_tool(segments ${READELF} --program-headers --wide ${FILE})
run_tool(dynamic ${READELF} --dynamic --wide ${FILE})
if(NOT segments MATCHES "GNU_RELRO")
    message(SEND_ERROR "No segment becomes read-only after binding:\n${segments}")
endif()
if(NOT dynamic MATCHES "\\(FLAGS\\)[^\n]* BIND_NOW" OR NOT dynamic MATCHES "\\(FLAGS_1\\)[^\n]* NOW")
    message(SEND_ERROR "Symbols are bound lazily:\n${dynamic}")
endif()

# Nothing is written to code, and nothing written is run.
if(NOT segments MATCHES "GNU_STACK( +0x[0-9a-f]+)+ +RW +0x")
    message(SEND_ERROR "The stack is executable, or it is not said that it is not:\n${segments}")
endif()
if(dynamic MATCHES "TEXTREL")
    message(SEND_ERROR "The loader would write into code:\n${dynamic}")
endif()

# No symbol is missing from what it is linked with.
if(LDD)
    run_tool(relocations ${LDD} -r ${FILE})
    string(REGEX MATCHALL "undefined symbol: [^\n]*" undefined "${relocations}")
    if(undefined)
        message(SEND_ERROR "Missing in its libraries: ${undefined}")
    endif()
endif()

# Stacks are watched. The debug information says what each source was compiled with, for one compiler; the sanitizers'
# own sources in an executable are of another standard.
run_tool(symbols ${NM} --dynamic --undefined-only --format=posix ${FILE})
if("stack-protector-strong" IN_LIST PROTECTIONS AND NOT symbols MATCHES "__stack_chk_fail")
    message(SEND_ERROR "No function watches its stack")
endif()
run_tool(information ${READELF} --debug-dump=info --dwarf-depth=1 ${FILE})
string(REGEX MATCHALL "DW_AT_producer[^\n]*GNU C\\+\\+17[^\n]*" compilations "${information}")
if("stack-protector-strong" IN_LIST PROTECTIONS AND NOT compilations)
    message(SEND_ERROR "No source in the debug information")
endif()
foreach(compilation IN LISTS compilations)
    foreach(protection IN LISTS PROTECTIONS)
        if(NOT compilation MATCHES " -f${protection}")
            message(SEND_ERROR "Compiled without -f${protection}: ${compilation}")
        endif()
    endforeach()
endforeach()

# The functions that print are always the checking ones; copies are where a size is known. Not vsnprintf: the C++
# library passes it around by its address.
string(REGEX MATCHALL "(^|\n)(sn?|f|)printf[@ ]" unchecked "${symbols}")
if(FORTIFIED AND unchecked)
    message(SEND_ERROR "Not the checking functions:${unchecked}")
endif()

# The note that lets a processor watch jumps and returns is there if all that is linked has it. A file with the note and a
# start file without it would end at its first call where they are watched.
if("cf-protection" IN_LIST PROTECTIONS)
    execute_process(COMMAND ${COMPILER} -print-file-name=crti.o OUTPUT_VARIABLE start OUTPUT_STRIP_TRAILING_WHITESPACE)
    run_tool(notes ${READELF} --notes --wide ${FILE})
    run_tool(start_notes ${READELF} --notes --wide ${start})
    foreach(feature IBT SHSTK)
        set(in_file OFF)
        set(in_start OFF)
        if(notes MATCHES "x86 feature:[^\n]*${feature}")
            set(in_file ON)
        endif()
        if(start_notes MATCHES "x86 feature:[^\n]*${feature}")
            set(in_start ON)
        endif()
        if(NOT in_file STREQUAL in_start)
            message(SEND_ERROR "Watched jumps and returns, ${feature}: the file's note ${in_file}, the start files' ${in_start}")
        endif()
    endforeach()
endif()
