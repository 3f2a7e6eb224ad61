# Installs the project from its build tree into a fresh prefix, then configures, builds and runs the outside
# project examples/consumer against that prefix with find_package(svymath CONFIG).
# Run as: cmake -DBUILD_DIR=... -DSOURCE_DIR=... -DWORK_DIR=... -DGENERATOR=... -DCXX=... [-DCXX_FLAGS=...]
#              [-DWITH_TOOL=ON] -P package_consumer.cmake
foreach(var BUILD_DIR SOURCE_DIR WORK_DIR GENERATOR CXX)
  if(NOT DEFINED ${var})
    message(FATAL_ERROR "package_consumer: ${var} is not set")
  endif()
endforeach()

set(prefix ${WORK_DIR}/prefix)
set(consumer_build ${WORK_DIR}/build)
file(REMOVE_RECURSE ${WORK_DIR})

function(run_step what)
  execute_process(COMMAND ${ARGN} RESULT_VARIABLE result OUTPUT_VARIABLE out ERROR_VARIABLE err)
  if(NOT result EQUAL 0)
    message(FATAL_ERROR "package_consumer: ${what} failed (${result})\n${out}\n${err}")
  endif()
  set(step_output "${out}" PARENT_SCOPE)
endfunction()

run_step("install" ${CMAKE_COMMAND} --install ${BUILD_DIR} --prefix ${prefix})
set(expected include/svymath/svymath.h include/svymath/version.h include/svyutils/svy_string.h)
if(WITH_TOOL)
  list(APPEND expected bin/svy)
endif()
foreach(installed IN LISTS expected)
  if(NOT EXISTS ${prefix}/${installed})
    message(FATAL_ERROR "package_consumer: ${installed} was not installed")
  endif()
endforeach()

run_step("configure" ${CMAKE_COMMAND} -S ${SOURCE_DIR}/examples/consumer -B ${consumer_build} -G ${GENERATOR}
         -DCMAKE_BUILD_TYPE=Release -DCMAKE_CXX_COMPILER=${CXX} "-DCMAKE_CXX_FLAGS=${CXX_FLAGS}"
         -DCMAKE_PREFIX_PATH=${prefix})
run_step("build" ${CMAKE_COMMAND} --build ${consumer_build})
run_step("run" ${consumer_build}/consumer)
message(STATUS "${step_output}")
