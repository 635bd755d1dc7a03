# The CMPI headers: glimmark::cmpi carries their include directory, for what a broker or a maker loads.
#
# A broker's development package has them in a folder cmpi/ of the include path or, rarely, on the
# include path itself. Where there is none, the project's own serve; they describe the same tables.
# Naming a directory outright: -DGLIMMARK_CMPI_INCLUDE_DIR=/path/with/cmpift.h
#
# glimmark::cmpi-own carries the project's own headers whatever the machine has, for cimhost and the tests.

function(glimmark_add_cmpi_headers name directory)
    add_library(glimmark_${name} INTERFACE)
    add_library(glimmark::${name} ALIAS glimmark_${name})
    target_include_directories(glimmark_${name} ${ARGN} INTERFACE ${directory})
    # The brokers' headers ask for the platform by name. Some name a calling convention then, which Linux does not
    # have: there is but one.
    target_compile_definitions(glimmark_${name} INTERFACE CMPI_PLATFORM_LINUX_GENERIC_GNU __cdecl=)
endfunction()

cmake_path(SET own_headers NORMALIZE ${CMAKE_CURRENT_LIST_DIR}/../cmpi)
glimmark_add_cmpi_headers(cmpi-own ${own_headers})

if(DEFINED GLIMMARK_CMPI_INCLUDE_DIR AND GLIMMARK_CMPI_INCLUDE_DIR)
    foreach(header IN ITEMS cmpidt.h cmpift.h)
        if(NOT EXISTS ${GLIMMARK_CMPI_INCLUDE_DIR}/${header})
            message(FATAL_ERROR "GLIMMARK_CMPI_INCLUDE_DIR is ${GLIMMARK_CMPI_INCLUDE_DIR}, which has no ${header}")
        endif()
    endforeach()
    set(directory ${GLIMMARK_CMPI_INCLUDE_DIR})
else()
    find_path(glimmark_cmpidt_directory cmpidt.h PATH_SUFFIXES cmpi)
    find_path(glimmark_cmpift_directory cmpift.h PATH_SUFFIXES cmpi)
    mark_as_advanced(glimmark_cmpidt_directory glimmark_cmpift_directory)
    # Half a set of headers is none.
    if(glimmark_cmpidt_directory AND glimmark_cmpidt_directory STREQUAL glimmark_cmpift_directory)
        set(directory ${glimmark_cmpift_directory})
    endif()
endif()

if(directory)
    glimmark_add_cmpi_headers(cmpi ${directory} SYSTEM)
else()
    set(directory ${own_headers})
    glimmark_add_cmpi_headers(cmpi ${directory})
endif()
message(STATUS "CMPI headers: ${directory}")
unset(directory)
unset(own_headers)

set(GLIMMARK_CMPI_INCLUDE_DIR
    ""
    CACHE PATH "Directory of the CMPI headers cmpidt.h and cmpift.h; empty: search, or the project's own")
