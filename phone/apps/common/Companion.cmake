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
    catalogue(${id} apps/${id}/res/locale po/LANGUAGE.po ../common/po/LANGUAGE.po)
  endif()
endfunction()

# companion_icons(ID FILE.svg...): drawn as PNG of the size of a row's picture.
function(companion_icons id)
  set(icons)
  foreach(source IN LISTS ARGN)
    get_filename_component(name ${source} NAME_WE)
    set(icon ${PHONE_IMAGE}/apps/${id}/res/images/${name}.png)
    add_custom_command(OUTPUT ${icon} DEPENDS ${source} VERBATIM
      COMMAND ${CMAKE_COMMAND} -E make_directory ${PHONE_IMAGE}/apps/${id}/res/images
      COMMAND ${RSVG_CONVERT} -w 84 -h 84 -o ${icon}.new ${CMAKE_CURRENT_SOURCE_DIR}/${source}
      COMMAND ${CMAKE_COMMAND} -E rename ${icon}.new ${icon})
    list(APPEND icons ${icon})
  endforeach()
  add_custom_target(icons_${id} ALL DEPENDS ${icons})
endfunction()
