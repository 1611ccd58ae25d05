# Run by CPack once the files of the packages are laid out: each package gets a changelog in Debian's form, and manual
# pages and changelogs are compressed, with no time in them.
string(TIMESTAMP date "%a, %d %b %Y %H:%M:%S +0000" UTC) # SOURCE_DATE_EPOCH, where that is set
file(GLOB folders ${CPACK_TEMPORARY_INSTALL_DIRECTORY}/*/usr/share/doc/*)
foreach(folder IN LISTS folders)
    file(WRITE ${folder}/changelog "varnex3 (${CPACK_PACKAGE_VERSION}) unstable; urgency=medium

  * CHANGELOG.md.gz in this folder tells what has changed.

 -- ${CPACK_PACKAGE_CONTACT}  ${date}
")
endforeach()
file(GLOB_RECURSE texts ${CPACK_TEMPORARY_INSTALL_DIRECTORY}/*/usr/share/man/*
    ${CPACK_TEMPORARY_INSTALL_DIRECTORY}/*/usr/share/doc/*/changelog
    ${CPACK_TEMPORARY_INSTALL_DIRECTORY}/*/usr/share/doc/*/CHANGELOG.md)
execute_process(COMMAND gzip -9n ${texts} COMMAND_ERROR_IS_FATAL ANY)
