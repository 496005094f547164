# Target `coverage-report`: runs the tests and prints the coverage of our own sources. It fails if
# that of the kernel and the collections is below 95 % of the lines or 85 % of the branches.
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
            --json ${PROJECT_BINARY_DIR}/coverage.json
            --txt
            --print-summary
            ${PROJECT_BINARY_DIR}
        COMMAND ${TARNKILN_GCOVR}
            --root ${PROJECT_SOURCE_DIR}
            --add-tracefile ${PROJECT_BINARY_DIR}/coverage.json
            --filter ${PROJECT_SOURCE_DIR}/src/tarnkiln/kernel/
            --filter ${PROJECT_SOURCE_DIR}/src/tarnkiln/collections/
            --txt ${PROJECT_BINARY_DIR}/coverage-kernel-collections.txt
            --print-summary
            --fail-under-line 95
            --fail-under-branch 85
        WORKING_DIRECTORY ${PROJECT_BINARY_DIR}
        USES_TERMINAL
        VERBATIM)
else()
    add_custom_target(coverage-report
        COMMAND ${CMAKE_COMMAND} -E echo "coverage-report needs gcovr"
        COMMAND ${CMAKE_COMMAND} -E false)
endif()
