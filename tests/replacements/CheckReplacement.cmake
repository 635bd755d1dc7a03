# Runs a request with the libraries of a directory first on the loader's path, and without. Run as
#   cmake -DCIMHOST=FILE -DDIRECTORY=DIR -DEXPECTED=TEXT -DINVENTORY=FILE -P THIS

cmake_minimum_required(VERSION 3.20)

function(ask output)
    execute_process(
        COMMAND ${CMAKE_COMMAND} -E env ${ARGN} ${CIMHOST} --inventory ${INVENTORY} ei TAVRO_Glimmark --format json
        OUTPUT_VARIABLE answer ERROR_VARIABLE log COMMAND_ERROR_IS_FATAL ANY)
    set(${output} "${answer}${log}" PARENT_SCOPE)
endfunction()

ask(real --unset=LD_LIBRARY_PATH)
string(FIND "${real}" "${EXPECTED}" position)
if(NOT position EQUAL -1)
    message(SEND_ERROR "The real library says \"${EXPECTED}\" too; this test would show nothing")
endif()

ask(replaced LD_LIBRARY_PATH=${DIRECTORY})
string(FIND "${replaced}" "${EXPECTED}" position)
if(position EQUAL -1)
    message(SEND_ERROR "No \"${EXPECTED}\" in:\n${replaced}")
endif()
