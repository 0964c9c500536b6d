# cmake -DTEMPLATE=FILE -DFOLDER=PHOTOS -DOUTPUT=FILE -P contacts.cmake: an address book with its
# photos inside.
foreach(person anna ben mina)
  execute_process(COMMAND base64 --wrap=0 ${FOLDER}/${person}.jpg
    OUTPUT_VARIABLE ${person} COMMAND_ERROR_IS_FATAL ANY)
endforeach()
configure_file(${TEMPLATE} ${OUTPUT} @ONLY NEWLINE_STYLE CRLF)
