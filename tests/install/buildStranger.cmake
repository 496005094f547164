# Installs the built library into a directory of the build tree, then configures, builds and runs
# the stranger's project against it. Nothing but the installed files is on its paths.

function(run)
    execute_process(COMMAND ${ARGN} COMMAND_ECHO STDOUT COMMAND_ERROR_IS_FATAL ANY)
endfunction()

file(REMOVE_RECURSE ${WORK_DIR})
set(prefix ${WORK_DIR}/prefix)
run(${CMAKE_COMMAND} --install ${BUILD_DIR} --prefix ${prefix})

file(GLOB_RECURSE internals ${prefix}/include/*/internal/*)
if(internals)
    message(FATAL_ERROR "internal headers are installed: ${internals}")
endif()

set(flags)
if(SANITIZERS)
    set(flags -DCMAKE_CXX_FLAGS=-fsanitize=${SANITIZERS})
endif()
run(${CMAKE_COMMAND} -S ${STRANGER_DIR} -B ${WORK_DIR}/build -G ${GENERATOR}
    -DCMAKE_CXX_COMPILER=${CXX_COMPILER} -DCMAKE_PREFIX_PATH=${prefix}
    -DPython3_EXECUTABLE=${PYTHON} ${flags})
run(${CMAKE_COMMAND} --build ${WORK_DIR}/build)
run(${WORK_DIR}/build/stranger)
