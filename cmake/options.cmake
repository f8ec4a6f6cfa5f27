# What every target of this project is compiled and linked with.
add_library(dpxlsx_options INTERFACE)
# The library's headers have the paths that they have when they are installed, "dpxlsx/..."; all else
# is found from the root.
file(MAKE_DIRECTORY ${PROJECT_BINARY_DIR}/include)
file(CREATE_LINK ${PROJECT_SOURCE_DIR} ${PROJECT_BINARY_DIR}/include/dpxlsx SYMBOLIC)
target_include_directories(dpxlsx_options INTERFACE
    ${PROJECT_BINARY_DIR}/include ${PROJECT_SOURCE_DIR})
target_compile_options(dpxlsx_options INTERFACE
    -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wsign-conversion -Wold-style-cast -Wcast-qual
    -Wundef -Wdouble-promotion -Wnon-virtual-dtor
    # g++ 12 sees overlapping copies in the standard library's own string concatenation.
    $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>
    $<$<BOOL:${DPXLSX_WERROR}>:-Werror>)
# The standard library checks indexes and preconditions.
target_compile_definitions(dpxlsx_options INTERFACE $<$<CONFIG:Debug>:_GLIBCXX_ASSERTIONS>)
if(DPXLSX_SANITIZE)
    target_compile_options(dpxlsx_options INTERFACE
        -fsanitize=${DPXLSX_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer
        # Instrumented code of the standard library looks uninitialised to g++ 12.
        $<$<CXX_COMPILER_ID:GNU>:-Wno-maybe-uninitialized>)
    target_link_options(dpxlsx_options INTERFACE -fsanitize=${DPXLSX_SANITIZE})
endif()

# With sanitizers the optimiser takes minutes over tables of cases and of options, each step of which is checked.
function(leave_unoptimized_when_sanitized target)
    if(DPXLSX_SANITIZE)
        target_compile_options(${target} PRIVATE -O0)
    endif()
endfunction()
