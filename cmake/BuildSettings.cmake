# What every target of the project is built with: link against glimmark::settings.

if(CMAKE_SIZEOF_VOID_P LESS 8)
    message(FATAL_ERROR "This is a compiler for 32 bits, which are not supported: nothing was tried there. Expected 64.")
endif()

set(CMAKE_CXX_STANDARD 17)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_C_STANDARD 11)
set(CMAKE_C_STANDARD_REQUIRED ON)
set(CMAKE_C_EXTENSIONS OFF)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)

# One folder each for what a process loads and what a person runs, as in an installed tree.
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/lib)
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/bin)

set(GLIMMARK_SANITIZE
    ""
    CACHE STRING "Sanitizers to build everything with, as in -fsanitize=, or nothing")

# Libraries in C++ that the distribution has compiled are of its compiler's standard library, and are not used then.
option(GLIMMARK_LIBCXX "Build everything with clang's own standard library, libc++" OFF)
if(GLIMMARK_LIBCXX)
    string(APPEND CMAKE_CXX_FLAGS " -stdlib=libc++")
endif()

add_library(glimmark_settings INTERFACE)
add_library(glimmark::settings ALIAS glimmark_settings)

target_compile_options(
    glimmark_settings
    INTERFACE -Wall
              -Wextra
              -pedantic-errors
              -Wconversion
              -Wsign-conversion
              -Wshadow
              -Wnon-virtual-dtor
              -Woverloaded-virtual
              -Wold-style-cast
              -Wcast-align
              -Wcast-qual
              -Wdate-time
              -Wdouble-promotion
              -Wextra-semi
              -Wsuggest-override
              -Wformat=2
              -Wimplicit-fallthrough
              -Wundef
              -Wunused
              -Werror
              $<$<CXX_COMPILER_ID:GNU>:-Wduplicated-cond
              -Wduplicated-branches
              -Wlogical-op
              -Wuseless-cast>
              $<$<CXX_COMPILER_ID:Clang>:-Wcomma
              -Wconditional-uninitialized
              -Wdocumentation
              -Wloop-analysis
              -Wunreachable-code>)

# Sources that are compiled together look like headers to this check, which is about headers.
if(CMAKE_UNITY_BUILD)
    target_compile_options(glimmark_settings INTERFACE $<$<CXX_COMPILER_ID:GNU>:-Wno-subobject-linkage>)
endif()

# The compiler clears its memory up less often: a twentieth of its time for some hundred megabytes.
target_compile_options(glimmark_settings INTERFACE $<$<CXX_COMPILER_ID:GNU>:--param=ggc-min-heapsize=1000000>)

# Every symbol is found at link time, in an executable as in a library; a provider that a broker
# loads with RTLD_NOW must not lack one. The sanitizers' own symbols come with the process.
if(NOT GLIMMARK_SANITIZE)
    target_link_options(glimmark_settings INTERFACE -Wl,--no-undefined)
endif()

# RUNPATH, not RPATH: LD_LIBRARY_PATH comes first, so that a maker's support library takes the place
# of one of platform/.
target_link_options(glimmark_settings INTERFACE -Wl,--enable-new-dtags)

# Hardening. A provider runs inside a server's broker, often as root. tests/CheckHardening.cmake reads
# off the built files that all of it took effect.
#
# Loaded anywhere in memory, executables too; all symbols bound before the first request, and the tables
# of their addresses read-only from then on; no code on the stack, none that the loader would write into.
include(CheckPIESupported)
check_pie_supported()
target_link_options(glimmark_settings INTERFACE -Wl,-z,relro -Wl,-z,now -Wl,-z,noexecstack -Wl,-z,text)

# A return address that was overwritten and a stack that grew into other memory end the process. cf-protection marks
# where functions begin, for processors that watch jumps and returns: they do so only where every file of the process has
# the note for it, the C library's start files too. Those of Debian 12 have none, so there it is of no effect. Not every
# processor and compiler has all three.
include(CheckCXXCompilerFlag)
set(GLIMMARK_PROTECTIONS)
foreach(protection IN ITEMS stack-protector-strong stack-clash-protection cf-protection)
    check_cxx_compiler_flag(-f${protection} GLIMMARK_HAS_${protection})
    if(GLIMMARK_HAS_${protection})
        list(APPEND GLIMMARK_PROTECTIONS ${protection})
        target_compile_options(glimmark_settings INTERFACE -f${protection})
    endif()
endforeach()

option(GLIMMARK_COVERAGE "Build everything so that running it counts the lines run" OFF)

# C library functions that know the size of the buffer that they write to check it. They need the
# optimiser; a sanitizer checks more and sees less with them. A level of the builder's own holds.
set(GLIMMARK_FORTIFY OFF)
if(NOT GLIMMARK_SANITIZE AND NOT GLIMMARK_COVERAGE AND NOT CMAKE_CXX_FLAGS MATCHES "_FORTIFY_SOURCE")
    set(GLIMMARK_FORTIFY $<CONFIG:Release,RelWithDebInfo,MinSizeRel>)
    # Some compilers bring a definition of their own.
    target_compile_options(glimmark_settings INTERFACE $<${GLIMMARK_FORTIFY}:-U_FORTIFY_SOURCE>
                                                       $<${GLIMMARK_FORTIFY}:-D_FORTIFY_SOURCE=2>)
endif()

# What is shipped is the same whichever folder it is built in. Debuggers and the counting of lines want the folder.
set(CMAKE_BUILD_RPATH_USE_ORIGIN ON)
if(NOT GLIMMARK_COVERAGE)
    # Of two that match, the compiler takes the later.
    add_compile_options($<$<NOT:$<CONFIG:Debug>>:-ffile-prefix-map=${PROJECT_SOURCE_DIR}=.>
                        $<$<NOT:$<CONFIG:Debug>>:-ffile-prefix-map=${PROJECT_BINARY_DIR}=build>)
endif()

if(GLIMMARK_SANITIZE)
    # For what a sanitizer makes too slow, or does otherwise.
    add_compile_definitions(GLIMMARK_SANITIZED)
    add_compile_options(-fsanitize=${GLIMMARK_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    add_link_options(-fsanitize=${GLIMMARK_SANITIZE})
endif()

# Every source tells the fuzzer which of its branches an input took.
if(GLIMMARK_FUZZ)
    if(NOT CMAKE_CXX_COMPILER_ID STREQUAL "Clang")
        message(FATAL_ERROR "GLIMMARK_FUZZ needs clang, which brings libFuzzer; the preset asan asks for it")
    endif()
    add_compile_options(-fsanitize=fuzzer-no-link)
    add_link_options(-fsanitize=fuzzer-no-link)
endif()

if(GLIMMARK_COVERAGE)
    add_compile_options(--coverage -O0)
    add_link_options(--coverage)
endif()

# What is shared with others is compared with its description, types included (scripts/check-interface): it is compiled
# with all debug information. link against glimmark::described.
add_library(glimmark_described INTERFACE)
add_library(glimmark::described ALIAS glimmark_described)
target_compile_options(glimmark_described INTERFACE $<$<CONFIG:RelWithDebInfo>:-g>)
