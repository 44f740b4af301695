# cpack runs this on the installed files before it makes the Debian package, to meet Debian's rules:
# compresses the manual pages and adds a changelog in Debian's format, which refers to the project's.
# Each package has a folder there.
file(GLOB roots LIST_DIRECTORIES true "${CPACK_TEMPORARY_DIRECTORY}/*/usr")
if(NOT roots)
    message(FATAL_ERROR "There are no packages in ${CPACK_TEMPORARY_DIRECTORY}")
endif()
foreach(root IN LISTS roots)
    set(name pallax)
    if(EXISTS "${root}/bin/pallax-window")
        set(name pallax-window)
    endif()
    file(GLOB_RECURSE pages "${root}/share/man/*.[157]")
    if(NOT pages)
        message(FATAL_ERROR "There are no manual pages in ${root}")
    endif()
    set(changelog "${root}/share/doc/${name}/changelog")
    file(WRITE "${changelog}"
"${name} (${CPACK_PACKAGE_VERSION}) unstable; urgency=medium

  * What has changed is told by CHANGELOG.md of the sources.

 -- ${CPACK_PACKAGE_CONTACT}  ${CPACK_PALLAX_DATE}
")
    # Without name and time, so that equal contents give equal bytes.
    execute_process(COMMAND gzip -9n ${pages} "${changelog}" COMMAND_ERROR_IS_FATAL ANY)
endforeach()
