# Target `coverage-report`: runs the tests and prints the coverage of our own sources.
# Not counted: the branches that only exceptions take, lines that hold an assertion, and what a
# failed assertion runs, since the process that could tell has been aborted.

find_program(TARNKILN_GCOVR gcovr)
mark_as_advanced(TARNKILN_GCOVR)
if(TARNKILN_GCOVR)
    add_custom_target(coverage-report
        COMMAND ${CMAKE_CTEST_COMMAND} --output-on-failure
        COMMAND ${TARNKILN_GCOVR}
            --root ${PROJECT_SOURCE_DIR}
            --filter ${PROJECT_SOURCE_DIR}/src/
            --filter ${PROJECT_SOURCE_DIR}/generated/
            --filter ${PROJECT_SOURCE_DIR}/platform/
            --exclude ${PROJECT_SOURCE_DIR}/src/tarnkiln/Assert
            --exclude-throw-branches
            --exclude-unreachable-branches
            --exclude-lines-by-pattern ".*TARNKILN_ASSERT\\(.*"
            --txt
            --print-summary
            ${PROJECT_BINARY_DIR}
        WORKING_DIRECTORY ${PROJECT_BINARY_DIR}
        USES_TERMINAL
        VERBATIM)
else()
    add_custom_target(coverage-report
        COMMAND ${CMAKE_COMMAND} -E echo "coverage-report needs gcovr"
        COMMAND ${CMAKE_COMMAND} -E false)
endif()
