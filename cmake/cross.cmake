# Builds for another processor with Debian's cross compiler: what scripts/cross has put into build/cross/<architecture>,
# by Debian's name of it, is where headers and libraries are found.
#   cmake -DCMAKE_TOOLCHAIN_FILE=cmake/cross.cmake -DGLIMMARK_CROSS=arm64 ...

set(GLIMMARK_CROSS
    ""
    CACHE STRING "Debian's name of the architecture that is built for")
list(APPEND CMAKE_TRY_COMPILE_PLATFORM_VARIABLES GLIMMARK_CROSS)
set(processors arm64=aarch64 s390x=s390x)
list(FILTER processors INCLUDE REGEX "^${GLIMMARK_CROSS}=")
if(NOT processors)
    message(FATAL_ERROR "GLIMMARK_CROSS is \"${GLIMMARK_CROSS}\"; expected arm64 or s390x")
endif()
string(REGEX REPLACE ".*=" "" processor "${processors}")

set(CMAKE_SYSTEM_NAME Linux)
set(CMAKE_SYSTEM_PROCESSOR ${processor})
set(CMAKE_LIBRARY_ARCHITECTURE ${processor}-linux-gnu)
set(CMAKE_C_COMPILER ${processor}-linux-gnu-gcc)
set(CMAKE_CXX_COMPILER ${processor}-linux-gnu-g++)

cmake_path(SET root NORMALIZE ${CMAKE_CURRENT_LIST_DIR}/../build/cross/${GLIMMARK_CROSS}/root)
set(CMAKE_SYSROOT ${root})
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)
set(ENV{PKG_CONFIG_SYSROOT_DIR} ${root})
set(ENV{PKG_CONFIG_LIBDIR} ${root}/usr/lib/${CMAKE_LIBRARY_ARCHITECTURE}/pkgconfig:${root}/usr/share/pkgconfig)

set(CMAKE_INSTALL_LIBDIR
    lib/${CMAKE_LIBRARY_ARCHITECTURE}
    CACHE STRING "Where libraries are installed, relative to the prefix")
set(CPACK_DEBIAN_PACKAGE_ARCHITECTURE ${GLIMMARK_CROSS})
