# Installs BUILD under WORK, builds CONSUMER against it there and runs it on CASE.
function(run)
  execute_process(COMMAND ${ARGN} COMMAND_ERROR_IS_FATAL ANY OUTPUT_VARIABLE text)
  set(output "${text}" PARENT_SCOPE)
endfunction()

file(REMOVE_RECURSE ${WORK})
run(${CMAKE_COMMAND} --install ${BUILD} --prefix ${WORK}/prefix)
set(flags)
if(SANITIZE)
  set(flags -DCMAKE_CXX_FLAGS=-fsanitize=${SANITIZE})
endif()
run(${CMAKE_COMMAND} -S ${CONSUMER} -B ${WORK}/build -G Ninja -DCMAKE_CXX_COMPILER=${COMPILER}
    -DCMAKE_PREFIX_PATH=${WORK}/prefix ${flags})
run(${CMAKE_COMMAND} --build ${WORK}/build)
run(${WORK}/build/consumer ${CASE})
# By hand, see examples/first-steps/README.md: Sd = 0.0775 m.
if(NOT output STREQUAL "result 1 Sd 0.0775\n")
  message(FATAL_ERROR "the consumer printed: ${output}")
endif()
run(${WORK}/prefix/bin/qm-rps --version)
message(STATUS "installed, found, linked and run: ${output}")
file(REMOVE_RECURSE ${WORK})
