# phone_image(TARGET-OR-FILE... DESTINATION FOLDER)
#
# Puts programs (targets) and files into the image of the phone, build/image/opt/usr/FOLDER, from
# which `phone up` fills /opt/usr of a phone. A file that the build makes needs its rule in the same
# directory. A folder is taken with all that is in it.
set(PHONE_IMAGE ${CMAKE_BINARY_DIR}/image/opt/usr CACHE INTERNAL "")

function(phone_image)
  cmake_parse_arguments(ARG "" "DESTINATION" "" ${ARGN})
  if(NOT ARG_DESTINATION OR NOT ARG_UNPARSED_ARGUMENTS)
    message(FATAL_ERROR "phone_image(TARGET-OR-FILE... DESTINATION FOLDER)")
  endif()
  set(folder ${PHONE_IMAGE}/${ARG_DESTINATION})
  set(copies)
  foreach(item IN LISTS ARG_UNPARSED_ARGUMENTS)
    if(TARGET ${item})
      # Removed first: phones share the image's files by hard links, and what runs stays as it is.
      add_custom_command(TARGET ${item} POST_BUILD VERBATIM
        COMMAND ${CMAKE_COMMAND} -E make_directory ${folder}
        COMMAND ${CMAKE_COMMAND} -E rm -f ${folder}/$<TARGET_FILE_NAME:${item}>
        COMMAND ${CMAKE_COMMAND} -E copy $<TARGET_FILE:${item}> ${folder})
    else()
      get_filename_component(path ${item} ABSOLUTE)
      if(IS_DIRECTORY ${path})
        file(GLOB_RECURSE inside RELATIVE ${path} CONFIGURE_DEPENDS ${path}/*)
        foreach(file IN LISTS inside)
          phone_image_file(${path}/${file} ${folder}/${file})
          list(APPEND copies ${folder}/${file})
        endforeach()
      else()
        get_filename_component(name ${path} NAME)
        phone_image_file(${path} ${folder}/${name})
        list(APPEND copies ${folder}/${name})
      endif()
    endif()
  endforeach()
  if(copies)
    string(MAKE_C_IDENTIFIER "image_${ARG_DESTINATION}" name)
    set(number 1)
    while(TARGET ${name}_${number})
      math(EXPR number "${number} + 1")
    endwhile()
    add_custom_target(${name}_${number} ALL DEPENDS ${copies})
  endif()
endfunction()

function(phone_image_file source target)
  get_filename_component(folder ${target} DIRECTORY)
  add_custom_command(OUTPUT ${target} DEPENDS ${source} VERBATIM
    COMMAND ${CMAKE_COMMAND} -E make_directory ${folder}
    COMMAND ${CMAKE_COMMAND} -E rm -f ${target}
    COMMAND ${CMAKE_COMMAND} -E copy ${source} ${target}
    COMMAND chmod a+r ${target})  # the layout compiler's files are its user's alone
endfunction()
