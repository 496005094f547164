# Compiles through ccache where it is installed and the caller has named no launcher.
# Precompiled headers need the two sloppiness flags; without them each use would be a miss.

if(NOT CMAKE_CXX_COMPILER_LAUNCHER)
    find_program(TARNKILN_CCACHE ccache)
    mark_as_advanced(TARNKILN_CCACHE)
    if(TARNKILN_CCACHE)
        set(CMAKE_CXX_COMPILER_LAUNCHER
            ${CMAKE_COMMAND} -E env CCACHE_SLOPPINESS=pch_defines,time_macros ${TARNKILN_CCACHE})
    endif()
endif()
