# What goes into an installation: the library, what programs are built with, and the command. Each is a
# component, and so a package of its own.

include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(KEL_PACKAGE_DIRECTORY "${CMAKE_INSTALL_LIBDIR}/cmake/TarvoKel")
file(RELATIVE_PATH KEL_PREFIX_FROM_PC
  "/prefix/${CMAKE_INSTALL_LIBDIR}/pkgconfig" "/prefix")
file(RELATIVE_PATH KEL_LIBRARIES_FROM_COMMAND
  "/prefix/${CMAKE_INSTALL_BINDIR}" "/prefix/${CMAKE_INSTALL_LIBDIR}")

# An installation works wherever it is put.
set_target_properties(tarvo_kel tarvo_platform PROPERTIES INSTALL_RPATH "$ORIGIN")
set_target_properties(tarvo_kel PROPERTIES EXPORT_NAME kel)
set_target_properties(tarvo_platform PROPERTIES EXPORT_NAME platform)

install(TARGETS tarvo_kel tarvo_platform EXPORT TarvoKelTargets
  LIBRARY DESTINATION "${CMAKE_INSTALL_LIBDIR}" COMPONENT library
    NAMELINK_COMPONENT development
  ARCHIVE DESTINATION "${CMAKE_INSTALL_LIBDIR}" COMPONENT development
  INCLUDES DESTINATION "${CMAKE_INSTALL_INCLUDEDIR}/tarvo")
install(DIRECTORY "${PROJECT_SOURCE_DIR}/include/" "${PROJECT_SOURCE_DIR}/platform/include/"
  "${PROJECT_BINARY_DIR}/include/"
  DESTINATION "${CMAKE_INSTALL_INCLUDEDIR}/tarvo" COMPONENT development FILES_MATCHING PATTERN "*.h")

configure_package_config_file(cmake/TarvoKelConfig.cmake.in TarvoKelConfig.cmake
  INSTALL_DESTINATION "${KEL_PACKAGE_DIRECTORY}" NO_SET_AND_CHECK_MACRO)
write_basic_package_version_file(TarvoKelConfigVersion.cmake COMPATIBILITY SameMajorVersion)
install(EXPORT TarvoKelTargets NAMESPACE TarvoKel:: DESTINATION "${KEL_PACKAGE_DIRECTORY}"
  COMPONENT development)
install(FILES "${PROJECT_BINARY_DIR}/TarvoKelConfig.cmake"
  "${PROJECT_BINARY_DIR}/TarvoKelConfigVersion.cmake"
  DESTINATION "${KEL_PACKAGE_DIRECTORY}" COMPONENT development)
# The build tree is a package too, for find_package with TarvoKel_DIR.
export(EXPORT TarvoKelTargets NAMESPACE TarvoKel:: FILE "${PROJECT_BINARY_DIR}/TarvoKelTargets.cmake")

# A shared library knows itself what it needs; pkg-config would ask for it wherever programs are built.
if(NOT BUILD_SHARED_LIBS)
  set(KEL_PRIVATE_NEEDS "Libs.private: -lboost_filesystem\nRequires.private: libpcre2-8\n")
endif()
configure_file(cmake/tarvo-kel.pc.in tarvo-kel.pc @ONLY)
install(FILES "${PROJECT_BINARY_DIR}/tarvo-kel.pc" DESTINATION "${CMAKE_INSTALL_LIBDIR}/pkgconfig"
  COMPONENT development)

if(NOT TARGET kel)
  return()
endif()
set_target_properties(kel PROPERTIES INSTALL_RPATH "$ORIGIN/${KEL_LIBRARIES_FROM_COMMAND}")
install(TARGETS kel RUNTIME DESTINATION "${CMAKE_INSTALL_BINDIR}" COMPONENT command)
set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS docs/kel.1)
execute_process(COMMAND gzip -9 --no-name --stdout "${PROJECT_SOURCE_DIR}/docs/kel.1"
  OUTPUT_FILE "${PROJECT_BINARY_DIR}/kel.1.gz" COMMAND_ERROR_IS_FATAL ANY)
install(FILES "${PROJECT_BINARY_DIR}/kel.1.gz" DESTINATION "${CMAKE_INSTALL_MANDIR}/man1"
  COMPONENT command)
install(FILES tools/kel/completions/kel.bash COMPONENT command
  DESTINATION "${CMAKE_INSTALL_DATADIR}/bash-completion/completions" RENAME kel)
install(FILES tools/kel/completions/_kel COMPONENT command
  DESTINATION "${CMAKE_INSTALL_DATADIR}/zsh/site-functions")
install(FILES tools/kel/completions/kel.fish COMPONENT command
  DESTINATION "${CMAKE_INSTALL_DATADIR}/fish/vendor_completions.d")
