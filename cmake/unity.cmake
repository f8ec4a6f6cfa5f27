# With DPXLSX_UNITY the sources of a target are compiled together, so that the headers of the standard library,
# of ICU, of GoogleTest and of the tool's packages are read once, not once a source. What is local to a source
# then needs a name of its own in the target, also other than those that headers declare. With a number, that
# many sources at a time: large targets would take too long on one processor.
function(compile_together target)
    set(batch 0)
    if(ARGC GREATER 1)
        set(batch ${ARGV1})
    endif()
    if(DPXLSX_UNITY)
        set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_BATCH_SIZE ${batch})
    endif()
endfunction()
