# What an installation holds: the shared library and its header, the CMake package and pkg-config
# file a host builds against, the command-line tool, the help files; and the Debian package of it.
# Only karstgraph and karstgraph_cli are named here: the static libraries inside the shared one
# stay private to the build.
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(KG_CMAKE_PACKAGE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/KarstGraph)

target_include_directories(karstgraph PUBLIC $<INSTALL_INTERFACE:${CMAKE_INSTALL_INCLUDEDIR}>)
install(TARGETS karstgraph EXPORT KarstGraphTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/karstgraph DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})

install(EXPORT KarstGraphTargets NAMESPACE KarstGraph:: DESTINATION ${KG_CMAKE_PACKAGE_DIR})
configure_package_config_file(${PROJECT_SOURCE_DIR}/cmake/KarstGraphConfig.cmake.in
  ${PROJECT_BINARY_DIR}/KarstGraphConfig.cmake INSTALL_DESTINATION ${KG_CMAKE_PACKAGE_DIR})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/KarstGraphConfigVersion.cmake
  VERSION ${PROJECT_VERSION} COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/KarstGraphConfig.cmake ${PROJECT_BINARY_DIR}/KarstGraphConfigVersion.cmake
  DESTINATION ${KG_CMAKE_PACKAGE_DIR})

# The .pc file finds the prefix from its own folder, so a copied or staged tree works as installed.
file(RELATIVE_PATH KG_PC_TO_PREFIX /${CMAKE_INSTALL_LIBDIR}/pkgconfig /)
string(REGEX REPLACE "/$" "" KG_PC_TO_PREFIX "${KG_PC_TO_PREFIX}")
configure_file(${PROJECT_SOURCE_DIR}/cmake/karstgraph.pc.in ${PROJECT_BINARY_DIR}/karstgraph.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/karstgraph.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)

# The tool holds the component itself; the run path only matters should it ever link the library.
file(RELATIVE_PATH KG_BIN_TO_LIB /${CMAKE_INSTALL_BINDIR} /${CMAKE_INSTALL_LIBDIR})
set_target_properties(karstgraph_cli PROPERTIES INSTALL_RPATH "$ORIGIN/${KG_BIN_TO_LIB}")
install(TARGETS karstgraph_cli RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})

# The tool looks for Help/ in <prefix>/share/karstgraph among other places.
install(DIRECTORY ${PROJECT_SOURCE_DIR}/Help DESTINATION ${CMAKE_INSTALL_DATADIR}/karstgraph)

set(CPACK_PACKAGE_NAME karstgraph)
set(CPACK_PACKAGE_VENDOR "KarstGraph developers")
set(CPACK_PACKAGE_CONTACT "KarstGraph developers <dev@karstgraph.invalid>")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "Charting component with a C interface, and its command-line tool")
set(CPACK_PACKAGE_DESCRIPTION "KarstGraph reads a host's report grids, builds a value table and \
shows the chart in a window of its own, with printing, styles and help. The package holds the \
shared library, its C header, the CMake and pkg-config files to build a host against it, the \
karstgraph tool and the help files.")
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_GENERATOR DEB)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_PACKAGE_MAINTAINER "${CPACK_PACKAGE_CONTACT}")
find_program(KG_DPKG_SHLIBDEPS dpkg-shlibdeps)
if(KG_DPKG_SHLIBDEPS)
  set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
else()
  # What the library and the tool link on Debian 12, for machines without dpkg-dev.
  set(CPACK_DEBIAN_PACKAGE_DEPENDS "libqt6core6, libqt6gui6, libqt6widgets6, libqt6svg6, \
libqt6printsupport6, libsqlite3-0, libpng16-16, libc6, libstdc++6")
endif()
include(CPack)
