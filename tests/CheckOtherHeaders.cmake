# Compiles the provider library's sources against CMPI headers that differ from the project's own as a broker's may:
# older ones without any `const`, and newer ones with more slots at the end of each table. Run as
#   cmake -DCOMPILER=... -DSOURCE_DIR=DIR -DWORK_DIR=DIR -DFLAGS="-I...;..." -P THIS

cmake_minimum_required(VERSION 3.20)

file(STRINGS ${SOURCE_DIR}/src/CMakeLists.txt lines REGEX "^ +[a-z]+/[A-Za-z]+\\.cpp\\)?$")
list(TRANSFORM lines REPLACE "[ )]" "")
list(TRANSFORM lines PREPEND ${SOURCE_DIR}/src/ OUTPUT_VARIABLE sources)
list(LENGTH sources count)
if(count LESS 7)
    message(FATAL_ERROR "Found only ${count} sources: ${sources}")
endif()

function(compile_with kind)
    foreach(source IN LISTS sources)
        execute_process(COMMAND ${COMPILER} -std=c++17 -Wall -Wextra -Werror -Wno-missing-field-initializers -fsyntax-only -I${WORK_DIR}/${kind} ${FLAGS}
                                ${source} COMMAND_ECHO NONE ERROR_VARIABLE errors RESULT_VARIABLE result)
        if(NOT result EQUAL 0)
            message(SEND_ERROR "${source} does not compile with ${kind} headers:\n${errors}")
        endif()
    endforeach()
endfunction()

foreach(header IN ITEMS cmpidt.h cmpift.h)
    file(READ ${SOURCE_DIR}/cmpi/${header} text)

    string(REGEX REPLACE "const ([A-Za-z]+)" "\\1" older "${text}")
    file(WRITE ${WORK_DIR}/older/${header} "${older}")

    string(REGEX REPLACE "\n(struct _CMPI[A-Za-z]+FT\n{[^}]*)};" "\n\\1    void* newer;\n};" newer "${text}")
    file(WRITE ${WORK_DIR}/newer/${header} "${newer}")
endforeach()

file(READ ${WORK_DIR}/older/cmpift.h older)
if(older MATCHES "const ")
    message(SEND_ERROR "The older headers still have a const")
endif()
file(READ ${WORK_DIR}/newer/cmpift.h newer)
if(NOT newer MATCHES "newer;")
    message(SEND_ERROR "The newer headers have no more slots")
endif()

compile_with(older)
compile_with(newer)
