# Installs the build into an empty prefix and asks the provider from there, with nothing set in the environment. Run as
#   cmake -DBUILD_DIR=DIR -DPREFIX=DIR -DINVENTORY=FILE -DPROVIDERDIR=lib/... -DREADELF=... -P THIS

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

# Nothing of the build tree is left in the installed files' paths.
file(GLOB installed ${PREFIX}/bin/* ${PREFIX}/${PROVIDERDIR}/*.so ${PREFIX}/${PROVIDERDIR}/../*.so.1)
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
