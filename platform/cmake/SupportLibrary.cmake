# add_support_library(NAME ALIAS SOURCE...)
#
# The shared object lib<NAME>.so.1 from the sources in the calling folder. What include/ holds is its
# interface and is installed as it lies there; exports.map lists the symbols that others may bind to. The library is
# the installation component NAME; what a compiler needs of it is in the component support-development.
function(add_support_library name alias)
    add_library(${name} SHARED ${ARGN})
    add_library(${alias} ALIAS ${name})
    target_include_directories(
        ${name} PUBLIC $<BUILD_INTERFACE:${CMAKE_CURRENT_SOURCE_DIR}/include>
                       $<INSTALL_INTERFACE:${CMAKE_INSTALL_INCLUDEDIR}>)
    target_link_libraries(${name} PRIVATE glimmark::settings glimmark::described)

    set(exports ${CMAKE_CURRENT_SOURCE_DIR}/exports.map)
    if(GLIMMARK_LIBCXX)
        set(exports ${PROJECT_SOURCE_DIR}/platform/cmake/libcxx.map)
    endif()
    # What is exported stays the library's own for its own calls, whatever else the process has loaded.
    target_link_options(${name} PRIVATE LINKER:--version-script=${exports} LINKER:-Bsymbolic)
    # The support libraries lie side by side, in the build tree as where they are installed.
    set_target_properties(
        ${name}
        PROPERTIES VERSION 1.0.0
                   SOVERSION 1
                   LINK_DEPENDS ${exports}
                   BUILD_WITH_INSTALL_RPATH ON
                   INSTALL_RPATH "\$ORIGIN")

    string(REGEX REPLACE "^tavro-" "" export_name ${name})
    set_target_properties(${name} PROPERTIES EXPORT_NAME ${export_name})
    install(
        TARGETS ${name}
        EXPORT TavroSupportTargets
        LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
                COMPONENT ${name}
                NAMELINK_COMPONENT support-development)
    install(DIRECTORY include/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} COMPONENT support-development)
endfunction()

# add_support_library_tests(NAME SOURCE...)
#
# The tests of the support library NAME, in one executable; beside them a test of the built file:
# its soname, what it needs at run time, and that it exports what exports.map lists, no more, no less.
# NEEDS_<NAME> holds patterns of the sonames needed beyond the compiler's run-time libraries.
function(add_support_library_tests name)
    add_executable(${name}-tests ${ARGN})
    target_link_libraries(${name}-tests PRIVATE ${name} glimmark::test-settings GTest::gtest_main)
    glimmark_add_tests_of(${name}-tests THREADS)

    if(NOT GLIMMARK_LIBCXX)
        add_test(
            NAME ${name}.SharedObject
            COMMAND
                ${CMAKE_COMMAND} -DLIBRARY=$<TARGET_FILE:${name}> -DSONAME=lib${name}.so.1
                "-DNEEDED=${NEEDS_${name}}" -DEXPORTS=${CMAKE_CURRENT_SOURCE_DIR}/exports.map -DREADELF=${CMAKE_READELF}
                -DNM=${CMAKE_NM} -P ${PROJECT_SOURCE_DIR}/platform/cmake/CheckSharedObject.cmake)
    endif()
endfunction()
