# Runs on the files gathered for the package: Debian has programs stripped, and manual pages and changelogs compressed.
set(usr ${CPACK_TEMPORARY_INSTALL_DIRECTORY}/usr)
file(GLOB programs ${usr}/bin/*)
file(GLOB texts ${usr}/share/man/man1/* ${usr}/share/doc/*/changelog)
execute_process(COMMAND strip --remove-section=.comment --remove-section=.note ${programs} COMMAND_ERROR_IS_FATAL ANY)
execute_process(COMMAND gzip -9n ${texts} COMMAND_ERROR_IS_FATAL ANY)
