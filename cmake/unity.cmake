# With DPXLSX_UNITY the sources of a folder are compiled together, so that the headers of the standard
# library, of ICU, of GoogleTest and of the tool's packages are read once a folder, not once a source. What is
# local to a source then needs a name of its own in the folder, also other than those that headers declare.
function(compile_folders_as_one target)
    if(NOT DPXLSX_UNITY)
        return()
    endif()
    set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_MODE GROUP)
    get_target_property(sources ${target} SOURCES)
    foreach(source IN LISTS sources)
        get_filename_component(folder ${source} DIRECTORY)
        get_filename_component(folder ${folder} NAME)
        set_source_files_properties(${source} PROPERTIES UNITY_GROUP "${folder}")
    endforeach()
endfunction()

# The same for a folder that is too large for one unit; units of similar size keep all processors busy.
function(compile_in_batches target)
    if(DPXLSX_UNITY)
        set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_BATCH_SIZE 6)
    endif()
endfunction()
