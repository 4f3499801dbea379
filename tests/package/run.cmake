# Fails at the first step that fails.
function(run)
  execute_process(COMMAND ${ARGN} COMMAND_ERROR_IS_FATAL ANY)
endfunction()

# Runs the user's program; `result` is its exit status and what it printed.
function(run_user result)
  execute_process(COMMAND ${WORK_DIR}/build/user RESULT_VARIABLE status OUTPUT_VARIABLE output ERROR_QUIET)
  set(${result} "${status}: ${output}" PARENT_SCOPE)
endfunction()

function(expect actual expected)
  if(NOT actual STREQUAL expected)
    message(FATAL_ERROR "expected: ${expected}\nfound: ${actual}")
  endif()
endfunction()

unset(ENV{CIMDELTA_ROOT})
file(REMOVE_RECURSE ${WORK_DIR})
run(${CMAKE_COMMAND} --install ${BUILD_DIR} --prefix ${WORK_DIR}/prefix)
# Nothing may depend on where it was installed first, nor on the trees that it comes from.
set(package ${WORK_DIR}/moved)
file(RENAME ${WORK_DIR}/prefix ${package})
file(REAL_PATH ${package} package)
file(GLOB_RECURSE headers RELATIVE ${package}/include/cimdelta ${package}/include/cimdelta/*)
list(SORT headers)
string(REPLACE ";" "," headers "${headers}")
expect("${headers}" "${HEADERS}")
set(flags "")
# Sanitizers make no difference to what a header includes.
set(check_headers ON)
if(SANITIZE)
  set(check_headers OFF)
  set(flags "-fsanitize=${SANITIZE}")
endif()
run(${CMAKE_COMMAND} -S ${USER_SOURCE} -B ${WORK_DIR}/build -G Ninja -DCMAKE_CXX_COMPILER=${CXX} -DCMAKE_PREFIX_PATH=${package}
    -DCMAKE_CXX_FLAGS=${flags} -DUSER_CHECK_HEADERS=${check_headers})
run(${CMAKE_COMMAND} --build ${WORK_DIR}/build)
run_user(result)
expect("${result}" "0: delta: 2 containers, data in ${package}/share/cimdelta\n")
run(${package}/bin/cimdelta --version)
run(${CMAKE_COMMAND} -E compare_files ${SOURCE_DIR}/data/schema/comparison-1.json ${package}/share/cimdelta/schema/comparison-1.json)

# The package's data and no other: without them the program fails, and the environment may name others.
file(RENAME ${package}/share/cimdelta ${WORK_DIR}/elsewhere)
run_user(result)
expect("${result}" "1: no delta namespace, data in ${package}/share/cimdelta\n")
set(ENV{CIMDELTA_ROOT} ${WORK_DIR}/elsewhere)
run_user(result)
expect("${result}" "0: delta: 2 containers, data in ${WORK_DIR}/elsewhere\n")

# What is only to be installed configures without the packages of tests and benchmarks, and a release without the latter.
set(without_bench -DCMAKE_DISABLE_FIND_PACKAGE_benchmark=ON -DCMAKE_CXX_COMPILER=${CXX})
run(${CMAKE_COMMAND} -S ${SOURCE_DIR} --preset install -B ${WORK_DIR}/install ${without_bench} -DCMAKE_DISABLE_FIND_PACKAGE_GTest=ON)
run(${CMAKE_COMMAND} -S ${SOURCE_DIR} --preset release -B ${WORK_DIR}/release ${without_bench})
