# The CMPI headers: glimmark::cmpi carries their include directory.
#
# A broker's development package has them in a folder cmpi/ of the include path or, rarely, on the
# include path itself. Where there is none, the project's own serve; they describe the same tables.
# Naming a directory outright: -DGLIMMARK_CMPI_INCLUDE_DIR=/path/with/cmpift.h

find_path(
    GLIMMARK_CMPI_INCLUDE_DIR cmpift.h
    PATH_SUFFIXES cmpi
    DOC "Directory of the CMPI headers cmpidt.h and cmpift.h")

if(GLIMMARK_CMPI_INCLUDE_DIR)
    if(NOT EXISTS ${GLIMMARK_CMPI_INCLUDE_DIR}/cmpift.h OR NOT EXISTS ${GLIMMARK_CMPI_INCLUDE_DIR}/cmpidt.h)
        message(FATAL_ERROR "GLIMMARK_CMPI_INCLUDE_DIR is ${GLIMMARK_CMPI_INCLUDE_DIR}, which has no cmpidt.h and cmpift.h")
    endif()
    set(glimmark_cmpi_directory ${GLIMMARK_CMPI_INCLUDE_DIR})
    set(glimmark_cmpi_kind SYSTEM)
else()
    set(glimmark_cmpi_directory ${PROJECT_SOURCE_DIR}/cmpi)
    set(glimmark_cmpi_kind "")
endif()
message(STATUS "CMPI headers: ${glimmark_cmpi_directory}")

add_library(glimmark_cmpi INTERFACE)
add_library(glimmark::cmpi ALIAS glimmark_cmpi)
target_include_directories(glimmark_cmpi ${glimmark_cmpi_kind} INTERFACE ${glimmark_cmpi_directory})
# The brokers' headers ask for the platform by name.
target_compile_definitions(glimmark_cmpi INTERFACE CMPI_PLATFORM_LINUX_GENERIC_GNU)
