# Every public header must compile on its own: one generated source per header, built into an object library
# that is part of the default build, so a header that forgets an include breaks the build at once.
function(svy_add_header_check)
  file(GLOB_RECURSE headers CONFIGURE_DEPENDS
    RELATIVE ${PROJECT_SOURCE_DIR}
    ${PROJECT_SOURCE_DIR}/svyutils/*.h ${PROJECT_SOURCE_DIR}/svymath/*.h)
  set(sources)
  foreach(header IN LISTS headers)
    string(MAKE_C_IDENTIFIER "${header}" stem)
    set(source ${PROJECT_BINARY_DIR}/header_check/${stem}.cpp)
    file(CONFIGURE OUTPUT ${source} CONTENT "#include \"${header}\"\n")
    list(APPEND sources ${source})
  endforeach()
  add_library(svy_header_check OBJECT ${sources})
  target_link_libraries(svy_header_check PRIVATE svymath)
  svy_set_warnings(svy_header_check)
endfunction()
