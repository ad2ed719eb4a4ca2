# The library other programs use: one shared library, ardcard::card, made of
# the objects of the folder libraries, with the few headers a container needs
# under include/ardcard/ and a CMake package configuration.
#
# The folder libraries stay static and keep including each other's headers by
# folder ("card/card.h"); that path is never part of the installed target. A
# container sees only <ardcard/...>, and card.h forward-declares everything
# internal, so no internal header travels with it.

include(CMakePackageConfigHelpers)

set(ARDCARD_GENERATED_DIR ${PROJECT_BINARY_DIR}/generated)
configure_file(${PROJECT_SOURCE_DIR}/cmake/version.h.in
  ${ARDCARD_GENERATED_DIR}/ardcard/version.h @ONLY)

# The headers a container includes: the card, the connection dialog, the
# hosting page the card's first placing reads, the one error type the card's
# members throw, the call that prepares page windows, and the version.
set(ARDCARD_PUBLIC_HEADERS
  ${PROJECT_SOURCE_DIR}/src/card/card.h
  ${PROJECT_SOURCE_DIR}/src/connection/conn_dialog.h
  ${PROJECT_SOURCE_DIR}/src/host/hosting_page.h
  ${PROJECT_SOURCE_DIR}/src/host/prepare_web_engine.h
  ${PROJECT_SOURCE_DIR}/src/common/failure.h
  ${ARDCARD_GENERATED_DIR}/ardcard/version.h
)

# The same headers under build/generated/ardcard/, so that programs built in
# this tree against ardcard::card (the Designer plugin) include them exactly
# as an installed container does.
foreach(header IN LISTS ARDCARD_PUBLIC_HEADERS)
  get_filename_component(name ${header} NAME)
  if(NOT header STREQUAL ${ARDCARD_GENERATED_DIR}/ardcard/${name})
    configure_file(${header} ${ARDCARD_GENERATED_DIR}/ardcard/${name} COPYONLY)
  endif()
endforeach()

set(ARDCARD_FOLDER_LIBRARIES
  ardcard_common ardcard_host ardcard_connection ardcard_ledger ardcard_info
  ardcard_reports ardcard_card)

add_library(ardcard_shared SHARED)
foreach(folder IN LISTS ARDCARD_FOLDER_LIBRARIES)
  target_sources(ardcard_shared PRIVATE $<TARGET_OBJECTS:${folder}>)
  add_dependencies(ardcard_shared ${folder})
endforeach()
target_link_libraries(ardcard_shared
  PUBLIC Qt6::Widgets
  PRIVATE Qt6::Core Qt6::Gui Qt6::Sql Qt6::WebEngineWidgets Qt6::PrintSupport ICU::uc
    SQLite::SQLite3)
target_include_directories(ardcard_shared INTERFACE
  $<BUILD_INTERFACE:${ARDCARD_GENERATED_DIR}>
  $<INSTALL_INTERFACE:${CMAKE_INSTALL_INCLUDEDIR}>)
# Everything the objects call is resolved when the library is linked, not
# first in a container's program.
target_link_options(ardcard_shared PRIVATE -Wl,--no-undefined)
set_target_properties(ardcard_shared PROPERTIES
  OUTPUT_NAME ardcard
  EXPORT_NAME card
  VERSION ${PROJECT_VERSION}
  SOVERSION ${PROJECT_VERSION_MAJOR})
add_library(ardcard::card ALIAS ardcard_shared)

install(TARGETS ardcard_shared EXPORT ardcardTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR})
install(FILES ${ARDCARD_PUBLIC_HEADERS} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/ardcard)

set(ARDCARD_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/ardcard)
install(EXPORT ardcardTargets NAMESPACE ardcard:: DESTINATION ${ARDCARD_CMAKE_DIR})
configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/ardcardConfig.cmake.in
  ${PROJECT_BINARY_DIR}/ardcardConfig.cmake
  INSTALL_DESTINATION ${ARDCARD_CMAKE_DIR})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/ardcardConfigVersion.cmake
  VERSION ${PROJECT_VERSION} COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/ardcardConfig.cmake
  ${PROJECT_BINARY_DIR}/ardcardConfigVersion.cmake
  DESTINATION ${ARDCARD_CMAKE_DIR})
