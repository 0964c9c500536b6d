# The languages of every text: a new one is a word here and a catalogue beside each of the others.
set(LANGUAGES en de fr es pt ru ko ja zh_CN ar he hi)

# catalogue(DOMAIN FOLDER FILE...): compiles the texts of DOMAIN, for every language, to FOLDER under
# /opt/usr, which is where the application of that domain looks. FILEs have LANGUAGE in the place of
# the language's name; several make one catalogue. The old file is removed and not written over,
# since applications that run have it mapped.
function(catalogue domain folder)
  set(compiled)
  foreach(language IN LISTS LANGUAGES)
    set(sources ${ARGN})
    list(TRANSFORM sources REPLACE LANGUAGE ${language})
    list(TRANSFORM sources PREPEND ${CMAKE_CURRENT_SOURCE_DIR}/)
    set(joined ${CMAKE_CURRENT_BINARY_DIR}/${domain}.${language}.po)
    set(mo ${PHONE_IMAGE}/${folder}/${language}/LC_MESSAGES/${domain}.mo)
    add_custom_command(OUTPUT ${mo}
      COMMAND ${CMAKE_COMMAND} -E rm -f ${mo}
      COMMAND ${MSGCAT} --use-first --output-file=${joined} ${sources}
      COMMAND ${MSGFMT} --check-format --check-domain --output-file=${mo} ${joined}
      DEPENDS ${sources} COMMENT "Compiling ${domain} (${language})" VERBATIM)
    list(APPEND compiled ${mo})
  endforeach()
  add_custom_target(catalogue_${domain} ALL DEPENDS ${compiled})
  add_dependencies(catalogues catalogue_${domain})
endfunction()

add_custom_target(catalogues)
