# The flags of our own targets: link `tarnkiln_build_flags` privately, which brings the warnings, the
# sanitizers, the coverage counters and the switch for assertions. None of it reaches a client.

add_library(tarnkiln_warnings INTERFACE)
target_compile_options(tarnkiln_warnings INTERFACE
    -Wall -Wextra -Wpedantic
    -Wcast-qual
    -Wconversion -Wno-sign-conversion
    -Wextra-semi
    -Wnon-virtual-dtor
    -Wundef
    $<$<BOOL:${TARNKILN_WARNINGS_AS_ERRORS}>:-Werror>)

add_library(tarnkiln_sanitizers INTERFACE)
if(TARNKILN_SANITIZE)
    list(JOIN TARNKILN_SANITIZE "," sanitizers)
    target_compile_options(tarnkiln_sanitizers INTERFACE
        -fsanitize=${sanitizers} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    target_link_options(tarnkiln_sanitizers INTERFACE -fsanitize=${sanitizers})
endif()

add_library(tarnkiln_coverage INTERFACE)
if(TARNKILN_COVERAGE)
    target_compile_options(tarnkiln_coverage INTERFACE --coverage -fprofile-update=atomic)
    target_link_options(tarnkiln_coverage INTERFACE --coverage)
endif()

add_library(tarnkiln_build_flags INTERFACE)
target_link_libraries(tarnkiln_build_flags INTERFACE
    tarnkiln_warnings tarnkiln_sanitizers tarnkiln_coverage)
target_compile_definitions(tarnkiln_build_flags INTERFACE
    $<$<BOOL:${TARNKILN_CHECKED}>:TARNKILN_CHECKED>)
target_compile_options(tarnkiln_build_flags INTERFACE
    # ccache can only tell one precompiled header from another when the compiler names it.
    $<$<CXX_COMPILER_ID:GNU>:-fpch-preprocess>)
