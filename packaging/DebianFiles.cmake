# cpack runs this on the installed files before it makes the Debian package, to meet Debian's rules:
# compresses the manual pages and adds a changelog in Debian's format, which refers to the project's.
file(GLOB_RECURSE pages "${CPACK_TEMPORARY_DIRECTORY}/usr/share/man/*.[157]")
if(NOT pages)
    message(FATAL_ERROR "There are no manual pages in ${CPACK_TEMPORARY_DIRECTORY}")
endif()

set(changelog "${CPACK_TEMPORARY_DIRECTORY}/usr/share/doc/pallax/changelog")
file(WRITE "${changelog}"
"pallax (${CPACK_PACKAGE_VERSION}) unstable; urgency=medium

  * What has changed is told by CHANGELOG.md of the sources.

 -- ${CPACK_PACKAGE_CONTACT}  ${CPACK_PALLAX_DATE}
")

# Without name and time, so that equal contents give equal bytes.
execute_process(COMMAND gzip -9n ${pages} "${changelog}" COMMAND_ERROR_IS_FATAL ANY)
