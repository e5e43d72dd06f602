# Flags of every target of the project, in one interface target.
find_program(CCACHE_PROGRAM ccache)
if(CCACHE_PROGRAM)
    set(CMAKE_CXX_COMPILER_LAUNCHER
        ${CMAKE_COMMAND} -E env CCACHE_SLOPPINESS=pch_defines,time_macros ${CCACHE_PROGRAM}) # as precompiled headers need
endif()

add_library(spectrel_options INTERFACE)
target_compile_features(spectrel_options INTERFACE cxx_std_20)
target_compile_options(spectrel_options INTERFACE
    -ffp-contract=off # the same last digit on every processor
    -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wno-sign-conversion -Werror
    $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>) # g++ 12 sees overlaps in "text" + std::string where there are none
if(BUILD_TESTING)
    # One setting for all, so that they can share precompiled headers; the toolkit's targets ask for it.
    target_compile_options(spectrel_options INTERFACE -fPIC $<$<CXX_COMPILER_ID:Clang>:SHELL:-Xclang -fno-pch-timestamp>)
endif()
target_compile_definitions(spectrel_options INTERFACE SPECTREL_VERSION="${PROJECT_VERSION}")
if(SPECTREL_SANITIZERS)
    target_compile_options(spectrel_options INTERFACE
        -fsanitize=${SPECTREL_SANITIZERS} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    target_link_options(spectrel_options INTERFACE -fsanitize=${SPECTREL_SANITIZERS})
endif()
if(SPECTREL_FUZZ)
    # The libraries, too, must tell the fuzzer which way they took.
    target_compile_options(spectrel_options INTERFACE -fsanitize=fuzzer-no-link)
    target_link_options(spectrel_options INTERFACE -fsanitize=fuzzer-no-link)
endif()
set(CMAKE_CXX_EXTENSIONS OFF)
