# Holds a built shared object to what programs and libraries built before rely on. Run as
#   cmake -DLIBRARY=FILE -DSONAME=NAME -DNEEDED="REGEX;..." -DEXPORTS=FILE -DREADELF=... -DNM=... -P THIS
# NEEDED: one pattern for each soname needed beyond the compiler's and the sanitizers' run time.

include(${CMAKE_CURRENT_LIST_DIR}/../../cmake/RunTool.cmake)

run_tool(dynamic ${READELF} -d ${LIBRARY})

string(REGEX MATCH "soname: \\[([^]]*)\\]" found "${dynamic}")
if(NOT CMAKE_MATCH_1 STREQUAL SONAME)
    message(SEND_ERROR "The soname is \"${CMAKE_MATCH_1}\", expected \"${SONAME}\"")
endif()

string(REGEX MATCHALL "Shared library: \\[[^]]*\\]" found "${dynamic}")
string(REGEX REPLACE "Shared library: \\[([^]]*)\\]" "\\1" needed "${found}")
list(FILTER needed EXCLUDE REGEX "^(libstdc\\+\\+|libgcc_s|libc|libm|libasan|libubsan|libtsan|ld-linux.*|ld64)\\.so\\.")
foreach(pattern IN LISTS NEEDED)
    set(matching ${needed})
    list(FILTER matching INCLUDE REGEX "^${pattern}$")
    if(NOT matching)
        message(SEND_ERROR "Does not need ${pattern}")
    endif()
    list(FILTER needed EXCLUDE REGEX "^${pattern}$")
endforeach()
if(needed)
    message(SEND_ERROR "Needs what it should not: ${needed}")
endif()

file(STRINGS ${EXPORTS} expected REGEX "^ +_Z[^;]*;$")
list(TRANSFORM expected REPLACE "[ ;]" "")
run_tool(symbols ${NM} --dynamic --defined-only --format=posix ${LIBRARY})
string(REGEX MATCHALL "[^ \n]+ [A-Za-z][^\n]*\n" symbols "${symbols}")
list(TRANSFORM symbols REPLACE " .*" "")
list(SORT expected)
list(SORT symbols)
if(NOT expected OR NOT symbols STREQUAL expected)
    message(SEND_ERROR "Exports:\n${symbols}\nexpected:\n${expected}")
endif()
