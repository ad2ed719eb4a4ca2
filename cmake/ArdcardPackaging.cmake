# What a user installs: the library, the host application and the demo
# builder, a desktop entry with its icon, and the man page of ardcard made
# from its own --help. `cpack` in the build directory makes the Debian
# package ardcard_<version>_<arch>.deb.

set(ARDCARD_MAN_PAGE ${PROJECT_BINARY_DIR}/packaging/ardcard.1)
add_custom_command(OUTPUT ${ARDCARD_MAN_PAGE}.gz
  COMMAND ${CMAKE_COMMAND} -E make_directory ${PROJECT_BINARY_DIR}/packaging
  COMMAND ${CMAKE_COMMAND} -E env ASAN_OPTIONS=detect_leaks=0
    ${CMAKE_COMMAND} -DARDCARD=$<TARGET_FILE:ardcard> -DOUTPUT=${ARDCARD_MAN_PAGE}
    -P ${PROJECT_SOURCE_DIR}/packaging/make_manpage.cmake
  COMMAND gzip -9nf ${ARDCARD_MAN_PAGE}
  DEPENDS ardcard ${PROJECT_SOURCE_DIR}/packaging/make_manpage.cmake
  COMMENT "Man page of ardcard from its --help"
  VERBATIM)
add_custom_target(ardcard_man_page ALL DEPENDS ${ARDCARD_MAN_PAGE}.gz)

install(FILES ${ARDCARD_MAN_PAGE}.gz DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
install(FILES ${PROJECT_SOURCE_DIR}/packaging/ardcard.desktop
  DESTINATION ${CMAKE_INSTALL_DATADIR}/applications)
install(FILES ${PROJECT_SOURCE_DIR}/packaging/ardcard.svg
  DESTINATION ${CMAKE_INSTALL_DATADIR}/icons/hicolor/scalable/apps)

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME ardcard)
set(CPACK_PACKAGE_VENDOR ardcard)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "account card viewer for Ardeco company databases")
set(CPACK_PACKAGE_DESCRIPTION
  "ardcard shows accounts of an Ardeco company database: journal lines with a\n\
running balance, printable statements, spreadsheet export and period graphs.\n\
It holds the host application ardcard, the demo company builder ardcard-demo,\n\
the card library for Qt 6 programs (ardcard::card, with its CMake package)\n\
and its Qt Designer plugin.")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_MAINTAINER "ardcard developers <ardcard@localhost>")
set(CPACK_DEBIAN_PACKAGE_SECTION misc)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
# Plugins Qt loads by name, which no linker sees: the SQL drivers the
# connection types open.
set(CPACK_DEBIAN_PACKAGE_DEPENDS "libqt6sql6-sqlite, libqt6sql6-odbc")
set(CPACK_DEBIAN_PACKAGE_RECOMMENDS "fonts-liberation2, culmus, tdsodbc, libsqliteodbc")
# Debug information is stripped; gzip keeps `cpack` quick.
set(CPACK_DEBIAN_COMPRESSION_TYPE gzip)
include(CPack)
