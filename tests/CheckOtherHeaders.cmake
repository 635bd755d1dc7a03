# Compiles the sources that include CMPI headers against headers that differ from the project's own as a broker's may,
# each kind in one property: without any `const`, and so with names that are char*; without the type CMPIVersion; with
# functions of threads that name a calling convention; and with more slots at the end of each table. Run as
#   cmake -DCOMPILER=... -DSOURCE_DIR=DIR -DWORK_DIR=DIR "-DSOURCES=FILE;..." "-DFLAGS=-I...;..." -P THIS
# Among the flags are the warnings and the definitions of the build.

cmake_minimum_required(VERSION 3.20)

list(LENGTH SOURCES count)
if(count LESS 7)
    message(FATAL_ERROR "Got only ${count} sources: ${SOURCES}")
endif()

# make_headers(KIND HEADER PATTERN REPLACEMENT): HEADER with each match replaced, and the other header as it is.
function(make_headers kind header pattern replacement)
    file(COPY ${SOURCE_DIR}/cmpi/cmpidt.h ${SOURCE_DIR}/cmpi/cmpift.h DESTINATION ${WORK_DIR}/${kind})
    change_header(${kind} ${header} "${pattern}" "${replacement}")
endfunction()

function(change_header kind header pattern replacement)
    file(READ ${WORK_DIR}/${kind}/${header} text)
    string(REGEX REPLACE "${pattern}" "${replacement}" changed "${text}")
    if(changed STREQUAL text)
        message(SEND_ERROR "The ${kind} headers are the project's own: no ${pattern} in ${header}")
    endif()
    file(WRITE ${WORK_DIR}/${kind}/${header} "${changed}")
endfunction()

function(compile_with kind)
    foreach(source IN LISTS SOURCES)
        execute_process(COMMAND ${COMPILER} -std=c++17 ${FLAGS} -fsyntax-only -isystem ${WORK_DIR}/${kind} ${source}
                                COMMAND_ECHO NONE ERROR_VARIABLE errors RESULT_VARIABLE result)
        if(NOT result EQUAL 0)
            message(SEND_ERROR "${source} does not compile with ${kind} headers:\n${errors}")
        endif()
    endforeach()
endfunction()

file(REMOVE_RECURSE ${WORK_DIR})

make_headers(constless cmpift.h "const ([A-Za-z]+)" "\\1")
change_header(constless cmpidt.h "const ([A-Za-z]+)" "\\1")

make_headers(versionless cmpidt.h "typedef int CMPIVersion;" "")
change_header(versionless cmpift.h "CMPIVersion ([a-zA-Z]+)" "int \\1")

make_headers(conventional cmpift.h "CMPIThreadFunc start" "void* (CMPI_THREAD_CDECL* start)(void*)")
change_header(conventional cmpidt.h "typedef int CMPIVersion;"
    "\n#ifdef CMPI_PLATFORM_LINUX_GENERIC_GNU\n#define CMPI_THREAD_CDECL __cdecl\n#else\n#define CMPI_THREAD_CDECL\n#endif\n\\0")

make_headers(newer cmpift.h "\n(struct _CMPI[A-Za-z]+FT\n{[^}]*)};" "\n\\1    void* newer;\n};")

foreach(kind IN ITEMS constless versionless conventional newer)
    compile_with(${kind})
endforeach()
