# Installs the project from its build tree into a fresh prefix, then configures, builds and runs the outside
# project examples/consumer against that prefix with find_package(svymath CONFIG). The installed tool and the
# consumer run with an empty environment (no LD_LIBRARY_PATH), as a new user's shell would have it: each
# installed binary must find its libraries from its own location.
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

# A library loaded by a host that knows only its path (dlopen, a plug-in) must still find its sibling.
file(GLOB installed_libraries ${prefix}/lib*/libsvy*.so)
foreach(library IN LISTS installed_libraries)
  run_step("ldd ${library}" env -i ldd ${library})
  if(step_output MATCHES "not found")
    message(FATAL_ERROR "package_consumer: ${library} does not find its dependencies\n${step_output}")
  endif()
endforeach()

run_step("configure" ${CMAKE_COMMAND} -S ${SOURCE_DIR}/examples/consumer -B ${consumer_build} -G ${GENERATOR}
         -DCMAKE_BUILD_TYPE=Release -DCMAKE_CXX_COMPILER=${CXX} "-DCMAKE_CXX_FLAGS=${CXX_FLAGS}"
         -DCMAKE_PREFIX_PATH=${prefix})
run_step("build" ${CMAKE_COMMAND} --build ${consumer_build})
run_step("run" env -i ${consumer_build}/consumer)
message(STATUS "${step_output}")

if(WITH_TOOL)
  file(WRITE ${WORK_DIR}/leg.csv "0,0,3,4\n")
  execute_process(COMMAND env -i ${prefix}/bin/svy cogo inverse ${WORK_DIR}/leg.csv
                  RESULT_VARIABLE result OUTPUT_VARIABLE out ERROR_VARIABLE err)
  if(NOT result EQUAL 0 OR NOT out MATCHES "5\\.0000")
    message(FATAL_ERROR "package_consumer: the installed svy failed (${result})\n${out}\n${err}")
  endif()
endif()
