# Brings what was put together into the shape that Debian asks of a package.
if(NOT CPACK_GENERATOR STREQUAL "DEB")
  return()
endif()
set(share ${CPACK_TEMPORARY_DIRECTORY}/usr/share)
file(GLOB pages ${share}/man/man1/*.1)
execute_process(COMMAND gzip -9nf ${pages} COMMAND_ERROR_IS_FATAL ANY)
# The shell of Debian looks elsewhere for what packages bring.
file(RENAME ${share}/zsh/site-functions ${share}/zsh/vendor-completions)

set(doc ${share}/doc/${CPACK_PACKAGE_NAME})
file(MAKE_DIRECTORY ${doc})
configure_file(${CPACK_KORA_COPYRIGHT} ${doc}/copyright COPYONLY)
string(TIMESTAMP date "%a, %d %b %Y %H:%M:%S +0000" UTC)
file(WRITE ${doc}/changelog
"${CPACK_PACKAGE_NAME} (${CPACK_PACKAGE_VERSION}) stable; urgency=medium

  * Built from the sources of version ${CPACK_PACKAGE_VERSION}.

 -- ${CPACK_PACKAGE_CONTACT}  ${date}
")
execute_process(COMMAND gzip -9nf ${doc}/changelog COMMAND_ERROR_IS_FATAL ANY)
