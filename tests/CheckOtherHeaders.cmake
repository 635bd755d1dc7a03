# Compiles the sources that include CMPI headers against headers that differ from the project's own as a broker's may:
# older ones without any `const`, and so with names that are char*, without the type CMPIVersion, and with functions of
# threads that name a calling convention; and newer ones with more slots at the end of each table. Run as
#   cmake -DCOMPILER=... -DSOURCE_DIR=DIR -DWORK_DIR=DIR "-DSOURCES=FILE;..." "-DFLAGS=-I...;..." -P THIS
# Among the flags are the warnings and the definitions of the build.

cmake_minimum_required(VERSION 3.20)

list(LENGTH SOURCES count)
if(count LESS 7)
    message(FATAL_ERROR "Got only ${count} sources: ${SOURCES}")
endif()

# change(KIND HEADER PATTERN REPLACEMENT): replaces each match in the KIND headers, which are the project's own at first.
function(change kind header pattern replacement)
    set(file ${WORK_DIR}/${kind}/${header})
    if(NOT EXISTS ${file})
        file(COPY ${SOURCE_DIR}/cmpi/cmpidt.h ${SOURCE_DIR}/cmpi/cmpift.h DESTINATION ${WORK_DIR}/${kind})
    endif()
    file(READ ${file} text)
    string(REGEX REPLACE "${pattern}" "${replacement}" changed "${text}")
    if(changed STREQUAL text)
        message(SEND_ERROR "The ${kind} headers have no ${pattern} in ${header}")
    endif()
    file(WRITE ${file} "${changed}")
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

change(older cmpift.h "const ([A-Za-z]+)" "\\1")
change(older cmpidt.h "const ([A-Za-z]+)" "\\1")
change(older cmpift.h "CMPIVersion ([a-zA-Z]+)" "int \\1")
change(older cmpift.h "CMPIThreadFunc start" "void* (CMPI_THREAD_CDECL* start)(void*)")
change(older cmpidt.h "typedef int CMPIVersion;" "
#ifdef CMPI_PLATFORM_LINUX_GENERIC_GNU
#define CMPI_THREAD_CDECL __cdecl
#else
#define CMPI_THREAD_CDECL
#endif
")

change(newer cmpift.h "\n(struct _CMPI[A-Za-z]+FT\n{[^}]*)};" "\n\\1    void* newer;\n};")

compile_with(older)
compile_with(newer)
