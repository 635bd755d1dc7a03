# What every target of the project is built with: link against glimmark::settings.

set(GLIMMARK_SANITIZE
    ""
    CACHE STRING "Sanitizers to build everything with, as in -fsanitize=, or nothing")

add_library(glimmark_settings INTERFACE)
add_library(glimmark::settings ALIAS glimmark_settings)

target_compile_options(
    glimmark_settings
    INTERFACE -Wall
              -Wextra
              -Wpedantic
              -Wconversion
              -Wsign-conversion
              -Wshadow
              -Wnon-virtual-dtor
              -Woverloaded-virtual
              -Wold-style-cast
              -Wcast-qual
              -Wformat=2
              -Wimplicit-fallthrough
              -Wundef
              -Wunused
              -Werror
              $<$<CXX_COMPILER_ID:GNU>:-Wduplicated-cond
              -Wduplicated-branches
              -Wlogical-op
              -Wuseless-cast>)

# Every symbol is found at link time, in an executable as in a library; a provider that a broker
# loads with RTLD_NOW must not lack one. The sanitizers' own symbols come with the process.
if(NOT GLIMMARK_SANITIZE)
    target_link_options(glimmark_settings INTERFACE -Wl,--no-undefined)
endif()

# RUNPATH, not RPATH: LD_LIBRARY_PATH comes first, so that a maker's support library takes the place
# of one of platform/.
target_link_options(glimmark_settings INTERFACE -Wl,--enable-new-dtags -Wl,-z,relro -Wl,-z,now -Wl,-z,noexecstack)

if(GLIMMARK_SANITIZE)
    add_compile_options(-fsanitize=${GLIMMARK_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    add_link_options(-fsanitize=${GLIMMARK_SANITIZE})
endif()

# Every source tells the fuzzer which of its branches an input took.
if(GLIMMARK_FUZZ)
    if(NOT CMAKE_CXX_COMPILER_ID STREQUAL "Clang")
        message(FATAL_ERROR "GLIMMARK_FUZZ needs clang, which brings libFuzzer; the preset fuzz asks for it")
    endif()
    add_compile_options(-fsanitize=fuzzer-no-link)
    add_link_options(-fsanitize=fuzzer-no-link)
endif()

option(GLIMMARK_COVERAGE "Build everything so that running it counts the lines run" OFF)
if(GLIMMARK_COVERAGE)
    add_compile_options(--coverage -O0)
    add_link_options(--coverage)
endif()
