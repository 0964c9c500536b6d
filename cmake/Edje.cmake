# edje_theme(SOURCE OUTPUT [IMAGES folder] [DEPENDS file...])
#
# Compiles an .edc into build/edje/OUTPUT and sets OUTPUT_edj to its path in the caller's scope.
function(edje_theme source output)
  cmake_parse_arguments(ARG "" "IMAGES" "DEPENDS" ${ARGN})
  set(edj ${CMAKE_BINARY_DIR}/edje/${output})
  set(options)
  if(ARG_IMAGES)
    list(APPEND options -id ${ARG_IMAGES})
  endif()
  add_custom_command(OUTPUT ${edj} VERBATIM
    COMMAND ${CMAKE_COMMAND} -E make_directory ${CMAKE_BINARY_DIR}/edje
    COMMAND ${EDJE_CC} ${options} ${CMAKE_CURRENT_SOURCE_DIR}/${source} ${edj}
    DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/${source} ${ARG_DEPENDS}
    COMMENT "Compiling ${output}")
  set(${output}_edj ${edj} PARENT_SCOPE)
endfunction()
