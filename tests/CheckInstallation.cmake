# Installs the build into an empty prefix and asks the provider from there, with nothing set in the environment. Run as
#   cmake -DBUILD_DIR=DIR -DPREFIX=DIR -DINVENTORY=FILE -DPROVIDERDIR=lib/... -DLIBDIR=lib -DREADELF=... -DCOMPILER=...
#         -DFLAGS=... -DSYSROOT=DIR -DGENERATOR=... -DSANITIZED=BOOL -DWORK_DIR=DIR -P THIS
# SYSROOT: where the compiler for another processor finds libraries; else empty

cmake_minimum_required(VERSION 3.20)

file(REMOVE_RECURSE ${PREFIX})
execute_process(COMMAND ${CMAKE_COMMAND} --install ${BUILD_DIR} --prefix ${PREFIX} OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)

execute_process(
    COMMAND ${CMAKE_COMMAND} -E env --unset=LD_LIBRARY_PATH --unset=CIMHOST_PROVIDER_DIR --unset=CIMHOST_REGISTRATION
            ${PREFIX}/bin/cimhost --inventory ${INVENTORY} ein TAVRO_Glimmark
    OUTPUT_VARIABLE names COMMAND_ERROR_IS_FATAL ANY)
string(REGEX MATCHALL "TAVRO_Glimmark\\.CreationClassName=" found "${names}")
list(LENGTH found count)
if(NOT count EQUAL 13)
    message(SEND_ERROR "The installed provider names ${count} indicators, expected 13:\n${names}")
endif()

# The texts come from the same prefix.
execute_process(
    COMMAND ${CMAKE_COMMAND} -E env --unset=LD_LIBRARY_PATH --unset=CIMHOST_PROVIDER_DIR --unset=CIMHOST_REGISTRATION
            --unset=TAVRO_CATALOGUES --unset=LC_ALL --unset=LC_MESSAGES LANG=de_AT.UTF-8 ${PREFIX}/bin/cimhost
            --inventory ${INVENTORY} ei TAVRO_Glimmark Caption
    OUTPUT_VARIABLE captions COMMAND_ERROR_IS_FATAL ANY)
string(REGEX MATCHALL "Caption = \"Diagnoseanzeige\"" found "${captions}")
list(LENGTH found count)
if(NOT count EQUAL 13)
    message(SEND_ERROR "The installed provider has ${count} German captions, expected 13:\n${captions}")
endif()

# Nothing of the build tree is left in the installed files' paths.
file(GLOB installed ${PREFIX}/bin/* ${PREFIX}/${PROVIDERDIR}/*.so ${PREFIX}/${LIBDIR}/*.so.1)
list(LENGTH installed count)
if(count LESS 6)
    message(SEND_ERROR "Too few files installed: ${installed}")
endif()
foreach(file IN LISTS installed)
    execute_process(COMMAND ${READELF} -d ${file} OUTPUT_VARIABLE dynamic COMMAND_ERROR_IS_FATAL ANY)
    string(FIND "${dynamic}" "${BUILD_DIR}" position)
    if(NOT position EQUAL -1)
        message(SEND_ERROR "${file} looks for libraries in the build tree:\n${dynamic}")
    endif()
endforeach()
file(GLOB_RECURSE texts ${PREFIX}/*.cmake ${PREFIX}/*.pc ${PREFIX}/sbin/*)
list(LENGTH texts count)
if(count LESS 5)
    message(SEND_ERROR "Too few texts installed: ${texts}")
endif()
foreach(file IN LISTS texts)
    file(READ ${file} text)
    foreach(path IN ITEMS ${BUILD_DIR} ${CMAKE_CURRENT_LIST_DIR})
        string(FIND "${text}" "${path}" position)
        if(NOT position EQUAL -1)
            message(SEND_ERROR "${file} names ${path}")
        endif()
    endforeach()
endforeach()

# The tree can be moved, and a maker's engineer builds with it where it then is.
file(REMOVE_RECURSE ${WORK_DIR})
file(MAKE_DIRECTORY ${WORK_DIR})
set(moved ${WORK_DIR}/moved)
file(RENAME ${PREFIX} ${moved})
set(maker ${WORK_DIR}/maker)
execute_process(
    COMMAND ${CMAKE_COMMAND} -G ${GENERATOR} -S ${CMAKE_CURRENT_LIST_DIR}/development -B ${maker}
            -DCMAKE_PREFIX_PATH=${moved} -DCMAKE_CXX_COMPILER=${COMPILER} -DCMAKE_CXX_FLAGS=${FLAGS}
            -DCMAKE_SYSROOT=${SYSROOT} -DSANITIZED=${SANITIZED}
    OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)
execute_process(COMMAND ${CMAKE_COMMAND} --build ${maker} OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)

function(expect text expected)
    if(NOT text MATCHES "${expected}")
        message(SEND_ERROR "Expected ${expected}, found:\n${text}")
    endif()
endfunction()

execute_process(
    COMMAND ${CMAKE_COMMAND} -E env LD_LIBRARY_PATH=${maker}/example ${moved}/bin/cimhost ein TAVRO_Glimmark
    OUTPUT_VARIABLE names COMMAND_ERROR_IS_FATAL ANY)
expect("${names}" "^[^\n]*Fan Tray Fault LED:fan tray, left\"[^\n]*\n[^\n]*Identification LED:front panel\"[^\n]*\n$")
if(NOT SANITIZED)
    execute_process(
        COMMAND ${CMAKE_COMMAND} -E env LD_LIBRARY_PATH=${moved}/${LIBDIR} TAVRO_INVENTORY=${INVENTORY} ${maker}/program
        OUTPUT_VARIABLE answer COMMAND_ERROR_IS_FATAL ANY)
    expect("${answer}" "^four libraries in all: a node\n$")
endif()

# The same by pkg-config.
file(GLOB_RECURSE package ${moved}/tavro-support.pc)
get_filename_component(package_directory ${package} DIRECTORY)
execute_process(
    COMMAND ${CMAKE_COMMAND} -E env PKG_CONFIG_PATH=${package_directory} pkg-config --cflags tavro-support
    OUTPUT_VARIABLE flags OUTPUT_STRIP_TRAILING_WHITESPACE COMMAND_ERROR_IS_FATAL ANY)
separate_arguments(flags UNIX_COMMAND "${FLAGS} ${flags}")
file(REMOVE_RECURSE ${maker})
file(MAKE_DIRECTORY ${maker})
execute_process(
    COMMAND ${COMPILER} -std=c++17 -shared -fPIC -Wl,-soname,libtavro-instrumentation.so.1 ${flags} -o
            ${maker}/libtavro-instrumentation.so.1 ${CMAKE_CURRENT_LIST_DIR}/../platform/example/Instrumentation.cpp COMMAND_ERROR_IS_FATAL ANY)
execute_process(
    COMMAND ${CMAKE_COMMAND} -E env LD_LIBRARY_PATH=${maker} ${moved}/bin/cimhost ein TAVRO_Glimmark
    OUTPUT_VARIABLE names COMMAND_ERROR_IS_FATAL ANY)
expect("${names}" "Fan Tray Fault LED:fan tray, left")
