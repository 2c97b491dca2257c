# Gives a package's tree the files that Debian's policy asks for, before CPack packs it.
set(doc ${CPACK_TEMPORARY_INSTALL_DIRECTORY}/usr/share/doc/pagemeld)
file(REMOVE ${doc}/LICENSE) # its text is in copyright
file(COPY ${CMAKE_CURRENT_LIST_DIR}/copyright ${CMAKE_CURRENT_LIST_DIR}/changelog DESTINATION ${doc})
file(GLOB pages ${CPACK_TEMPORARY_INSTALL_DIRECTORY}/usr/share/man/man*/*.[0-9])
execute_process(COMMAND gzip --no-name --best ${doc}/changelog ${pages} COMMAND_ERROR_IS_FATAL ANY)
