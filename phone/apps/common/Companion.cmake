# companion_application(TARGET ID): the program and what it needs at run time in the phone's image.
include_guard(GLOBAL)
set(COMPANION_THEME ${CMAKE_BINARY_DIR}/companion.edj CACHE INTERNAL "")

function(companion_application target id)
  add_dependencies(${target} companion_theme)
  if(COMMAND phone_image)
    set(folder ${PHONE_IMAGE}/apps/${id}/res/edje)
    phone_image(${target} DESTINATION apps/${id}/bin)
    add_custom_command(TARGET ${target} POST_BUILD VERBATIM
      COMMAND ${CMAKE_COMMAND} -E make_directory ${folder}
      COMMAND ${CMAKE_COMMAND} -E rm -f ${folder}/companion.edj
      COMMAND ${CMAKE_COMMAND} -E copy ${COMPANION_THEME} ${folder})
    if(IS_DIRECTORY ${CMAKE_CURRENT_SOURCE_DIR}/res)
      phone_image(res DESTINATION apps/${id}/res)
    endif()
  endif()
endfunction()
