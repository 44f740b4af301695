# Run by cpack on what has been installed, before it becomes a Debian package: what Debian wants of
# every package and a plain installation need not have. Manual pages are compressed, and there is a
# changelog in Debian's form, which points to the one that people read.
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

# Without name and time, so that the same content gives the same bytes.
execute_process(COMMAND gzip -9n ${pages} "${changelog}" COMMAND_ERROR_IS_FATAL ANY)
