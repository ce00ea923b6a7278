# Installation of the library that reads, measures, fits and draws contours, beside the core: its
# headers are a folder of their own, and the CMake package of the core finds it where it is there.
install(
  TARGETS GeometryUtilsIO
  EXPORT GeometryUtilsIOTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
          COMPONENT io_runtime
          NAMELINK_COMPONENT io_development
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT io_runtime
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT io_development)
install(
  DIRECTORY ${PROJECT_SOURCE_DIR}/include/vorn/io
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/vorn
  COMPONENT io_development
  FILES_MATCHING
  PATTERN "*.h")
install(
  EXPORT GeometryUtilsIOTargets
  NAMESPACE Vorn::
  DESTINATION ${package_dir}
  COMPONENT io_development)
configure_file(${PROJECT_SOURCE_DIR}/cmake/GeometryUtilsIO.pc.in
               ${PROJECT_BINARY_DIR}/GeometryUtilsIO.pc @ONLY)
install(
  FILES ${PROJECT_BINARY_DIR}/GeometryUtilsIO.pc
  DESTINATION ${pkgconfig_dir}
  COMPONENT io_development)
