# Writes the source of a library that exports the names of another, as another release of it would. Run as
#   cmake -DLIBRARY=FILE -DSOURCE=FILE -DNM=... -P THIS
#
# Each of its functions ends the process and says which it was; so does each function of its tables.

cmake_minimum_required(VERSION 3.20)
include(${CMAKE_CURRENT_LIST_DIR}/../../cmake/RunTool.cmake)

run_tool(symbols ${NM} --dynamic --defined-only --format=posix ${LIBRARY})
string(REGEX MATCHALL "[A-Za-z0-9_]+ [A-Za-z]" symbols "${symbols}")
list(FILTER symbols INCLUDE REGEX "^(_Z|Glimmark)[^ ]* [TWVDBRu]$")

set(text "#include <stdio.h>
#include <unistd.h>
static void called(const char* name) { fprintf(stderr, \"The neighbour's %s was called\\n\", name); _exit(70); }
static void called_by_table(void) { called(\"table\"); }\n")
foreach(symbol IN LISTS symbols)
    string(REGEX MATCH "^[^ ]*" name "${symbol}")
    if(symbol MATCHES " [TW]$")
        string(APPEND text "void ${name}(void); void ${name}(void) { called(\"${name}\"); }\n")
    else()
        string(APPEND text "void (*const ${name}[])(void) = {called_by_table, called_by_table, called_by_table, "
               "called_by_table, called_by_table, called_by_table};\n")
    endif()
endforeach()
file(WRITE ${SOURCE} "${text}")
