# Runs a program with a neighbour as its second argument, in each way in which brokers load; the answers
# are those that it gives alone. Run as
#   cmake -DPROGRAM=FILE -DNEIGHBOUR=FILE "-DARGUMENTS=ARGUMENT;..." [-DUNBOUND=FILE] -P THIS
# UNBOUND: a build of the library whose calls anyone can take, in which the neighbour is called.

cmake_minimum_required(VERSION 3.20)

# run(OUTPUT RESULT MODE ARGUMENT...)
function(run output result)
    execute_process(COMMAND ${PROGRAM} ${ARGN} OUTPUT_VARIABLE printed ERROR_VARIABLE errors RESULT_VARIABLE status)
    set(${output} "${printed}${errors}" PARENT_SCOPE)
    set(${result} "${status}" PARENT_SCOPE)
endfunction()

run(alone status now none ${ARGUMENTS})
if(NOT status EQUAL 0 OR alone MATCHES "^\n*$")
    message(SEND_ERROR "Without a neighbour, status ${status}:\n${alone}")
endif()
foreach(mode IN ITEMS now lazy)
    run(answer status ${mode} ${NEIGHBOUR} ${ARGUMENTS})
    if(NOT status EQUAL 0)
        message(SEND_ERROR "Loaded ${mode}, status ${status}:\n${answer}")
    elseif(NOT answer STREQUAL alone)
        message(SEND_ERROR "Loaded ${mode}, the answer is\n${answer}\nand alone\n${alone}")
    endif()
    if(UNBOUND)
        run(answer status ${mode} ${NEIGHBOUR} ${UNBOUND})
        if(NOT answer MATCHES "The neighbour's [^ ]+ was called")
            message(SEND_ERROR "Loaded ${mode}, nobody called the neighbour of a library that lets itself be taken over; "
                               "this test would show nothing:\n${answer}")
        endif()
    endif()
endforeach()
