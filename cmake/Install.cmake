# Installation: library, headers, CMake package, pkg-config file, man page, licence and changelog.
# The components become the Debian packages.
include(CMakePackageConfigHelpers)

install(
  TARGETS GeometryUtils
  EXPORT GeometryUtilsTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
          COMPONENT runtime
          NAMELINK_COMPONENT development
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT runtime
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT development)
install(
  DIRECTORY ${PROJECT_SOURCE_DIR}/include/vorn
  DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
  COMPONENT development
  FILES_MATCHING
  PATTERN "*.h"
  PATTERN "vorn/io" EXCLUDE)

set(package_dir ${CMAKE_INSTALL_LIBDIR}/cmake/GeometryUtils)
install(
  EXPORT GeometryUtilsTargets
  NAMESPACE Vorn::
  DESTINATION ${package_dir}
  COMPONENT development)
configure_package_config_file(
  ${PROJECT_SOURCE_DIR}/cmake/GeometryUtilsConfig.cmake.in
  ${PROJECT_BINARY_DIR}/GeometryUtilsConfig.cmake
  INSTALL_DESTINATION ${package_dir}
  NO_SET_AND_CHECK_MACRO)
write_basic_package_version_file(
  ${PROJECT_BINARY_DIR}/GeometryUtilsConfigVersion.cmake COMPATIBILITY SameMajorVersion)
install(
  FILES ${PROJECT_BINARY_DIR}/GeometryUtilsConfig.cmake
        ${PROJECT_BINARY_DIR}/GeometryUtilsConfigVersion.cmake
  DESTINATION ${package_dir}
  COMPONENT development)

# The pkg-config file finds its prefix from where it lies, so the installed tree may be moved.
set(pkgconfig_dir ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
file(RELATIVE_PATH pkgconfig_to_prefix /${pkgconfig_dir} /)
string(REGEX REPLACE "/$" "" pkgconfig_to_prefix "${pkgconfig_to_prefix}")
# What a program linked by another compiler than that of C++ needs besides a static library.
set(pkgconfig_private_libs ${CMAKE_CXX_IMPLICIT_LINK_LIBRARIES})
list(FILTER pkgconfig_private_libs INCLUDE REGEX "^(stdc\\+\\+|c\\+\\+|m)$")
list(REMOVE_DUPLICATES pkgconfig_private_libs)
list(TRANSFORM pkgconfig_private_libs PREPEND -l)
list(JOIN pkgconfig_private_libs " " pkgconfig_private_libs)
configure_file(${PROJECT_SOURCE_DIR}/cmake/GeometryUtils.pc.in
               ${PROJECT_BINARY_DIR}/GeometryUtils.pc @ONLY)
install(
  FILES ${PROJECT_BINARY_DIR}/GeometryUtils.pc
  DESTINATION ${pkgconfig_dir}
  COMPONENT development)

if(TARGET GeometryUtilsIO)
  include(InstallIO)
endif()

if(VORN_DEBIAN_PACKAGES)
  include(DebianPackages)
else()
  if(TARGET manual)
    get_target_property(manual manual MANUAL)
    install(
      FILES ${manual}
      DESTINATION ${CMAKE_INSTALL_MANDIR}/man1
      COMPONENT tools)
  endif()
  install(
    FILES ${PROJECT_SOURCE_DIR}/LICENSE ${PROJECT_SOURCE_DIR}/CHANGELOG.md
    DESTINATION ${CMAKE_INSTALL_DOCDIR}
    COMPONENT runtime)
endif()
