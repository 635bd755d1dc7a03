# Each layer of the library can include its own headers and those of the layers below it, and no other. Run as
#   cmake -DCOMPILER=... -DSOURCE_DIR=DIR -Dtrace=DIR;... -Dmodel=... -Dfactory=... -Dproviders=... -P THIS
# where each layer comes with the directories that its headers are looked for in.

cmake_minimum_required(VERSION 3.20)

# compiles(RESULT LAYER TEXT STEP): whether the text gets through that step of the compiler where the layer's sources lie.
function(compiles result layer text step)
    list(TRANSFORM ${layer} PREPEND -I OUTPUT_VARIABLE directories)
    set(file ${CMAKE_CURRENT_BINARY_DIR}/layers-${layer}.cpp)
    file(WRITE ${file} "${text}\n")
    execute_process(COMMAND ${COMPILER} -std=c++17 ${step} ${directories} ${file} RESULT_VARIABLE code OUTPUT_QUIET ERROR_QUIET)
    file(REMOVE ${file})
    if(code EQUAL 0)
        set(${result} TRUE PARENT_SCOPE)
    else()
        set(${result} FALSE PARENT_SCOPE)
    endif()
endfunction()

# Preprocessing, -E, is enough to find a header.
function(expect layer text expected step)
    compiles(found ${layer} "${text}" ${step})
    if(NOT found STREQUAL expected)
        message(SEND_ERROR "In the layer ${layer}, whether this compiles is ${found} and should be ${expected}: ${text}")
    endif()
endfunction()

set(below)
foreach(layer trace model factory providers)
    list(APPEND below ${layer})
    foreach(other trace model factory providers)
        set(seen FALSE)
        if(other IN_LIST below)
            set(seen TRUE)
        endif()
        file(GLOB headers RELATIVE ${SOURCE_DIR}/${other} ${SOURCE_DIR}/${other}/*.h)
        list(TRANSFORM headers REPLACE "(.+)" "#include \"\\1\"\n")
        string(JOIN "" text ${headers})
        expect(${layer} "${text}" ${seen} -E)
    endforeach()
endforeach()

# Only from the factory on there are CMPI types.
foreach(layer trace model factory providers)
    set(knows_cmpi FALSE)
    if(layer STREQUAL "factory" OR layer STREQUAL "providers")
        set(knows_cmpi TRUE)
    endif()
    expect(${layer} "#include <cmpidt.h>" ${knows_cmpi} -E)
    expect(${layer} "#include <cmpift.h>\nCMPIInstance* instance;" ${knows_cmpi} -fsyntax-only)
endforeach()
expect(model "#include <Tavro/Common.h>" TRUE -fsyntax-only)
