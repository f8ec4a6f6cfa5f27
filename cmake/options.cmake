# What every target of this project is compiled and linked with.
add_library(dpxlsx_options INTERFACE)
target_compile_options(dpxlsx_options INTERFACE
    -Wall -Wextra -Wpedantic -Wshadow -Wconversion
    # g++ 12 sees overlapping copies in the standard library's own string concatenation.
    $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>
    $<$<BOOL:${DPXLSX_WERROR}>:-Werror>)
if(DPXLSX_SANITIZE)
    target_compile_options(dpxlsx_options INTERFACE
        -fsanitize=${DPXLSX_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer
        # Instrumented code of the standard library looks uninitialised to g++ 12.
        $<$<CXX_COMPILER_ID:GNU>:-Wno-maybe-uninitialized>)
    target_link_options(dpxlsx_options INTERFACE -fsanitize=${DPXLSX_SANITIZE})
endif()
