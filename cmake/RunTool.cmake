# run_tool(OUTPUT COMMAND ARGUMENT...): OUTPUT is what the command prints; a command that fails ends the script.
function(run_tool output)
    execute_process(COMMAND ${ARGN} OUTPUT_VARIABLE text COMMAND_ERROR_IS_FATAL ANY)
    set(${output} "${text}" PARENT_SCOPE)
endfunction()
