# Debian packages, one per component: the two shared libraries, the development files of each, the
# program.
if(NOT BUILD_SHARED_LIBS)
  message(FATAL_ERROR "The Debian packages hold the shared library: set BUILD_SHARED_LIBS to ON")
endif()
set(library_package libgeometryutils${PROJECT_VERSION_MAJOR})
set(development_package libgeometryutils-dev)
set(io_library_package libgeometryutils-io${PROJECT_VERSION_MAJOR})
set(io_development_package libgeometryutils-io-dev)
set(tools_package geometryutils-tools)
set(debian_dir ${PROJECT_SOURCE_DIR}/cmake/debian)
set(debian_revision 1)

# The newest entry of the Debian changelog must be about the version being packaged.
set(debian_version ${PROJECT_VERSION}-${debian_revision})
file(STRINGS ${debian_dir}/changelog first_line LIMIT_COUNT 1)
if(NOT first_line MATCHES "^geometryutils \\(${debian_version}\\) ")
  message(FATAL_ERROR "cmake/debian/changelog does not start with version ${debian_version}")
endif()

# Compressed as the archive wants it: best compression, neither name nor time inside.
find_program(gzip_program gzip REQUIRED)

# Compresses a file of the sources into one of the build, again whenever it changes.
function(compress source target)
  execute_process(
    COMMAND ${gzip_program} -9 --no-name --stdout ${source} OUTPUT_FILE ${target}
    COMMAND_ERROR_IS_FATAL ANY)
  set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${source})
endfunction()

set(compressed ${PROJECT_BINARY_DIR}/debian)
file(MAKE_DIRECTORY ${compressed})
compress(${debian_dir}/changelog ${compressed}/changelog.Debian.gz)
compress(${PROJECT_SOURCE_DIR}/CHANGELOG.md ${compressed}/changelog.gz)

get_target_property(manual manual MANUAL)
add_custom_command(
  OUTPUT ${compressed}/contour.1.gz
  COMMAND ${gzip_program} -9 --no-name --stdout ${manual} > ${compressed}/contour.1.gz
  DEPENDS manual ${manual}
  COMMENT "Compressing the manual page"
  VERBATIM)
add_custom_target(
  compressed_manual ALL
  DEPENDS ${compressed}/contour.1.gz
  COMMENT "Compressed manual page")

foreach(component IN ITEMS library development io_library io_development tools)
  string(REPLACE library runtime install_component ${component})
  install(
    FILES ${debian_dir}/copyright ${compressed}/changelog.Debian.gz ${compressed}/changelog.gz
    DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/${${component}_package}
    COMPONENT ${install_component})
endforeach()
install(
  FILES ${compressed}/contour.1.gz
  DESTINATION ${CMAKE_INSTALL_MANDIR}/man1
  COMPONENT tools)

set(CPACK_GENERATOR DEB)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_COMPONENTS_ALL runtime development io_runtime io_development tools)
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
    OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)

# Each package has a summary of its own, the first line of its description.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")
set(CPACK_PACKAGE_CONTACT "GeometryUtils developers <maintainers@example.invalid>")
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)
set(CPACK_DEBIAN_PACKAGE_RELEASE ${debian_revision})
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${PROJECT_BINARY_DIR} ${PROJECT_BINARY_DIR}/io)

set(CPACK_DEBIAN_RUNTIME_PACKAGE_NAME ${library_package})
set(CPACK_DEBIAN_RUNTIME_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_RUNTIME_PACKAGE_CONTROL_EXTRA ${debian_dir}/triggers)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS_POLICY ">=")
set(CPACK_COMPONENT_RUNTIME_DESCRIPTION
    "plane geometry for contour measurement, shared library
Turns measured contour points, each with its own tolerance, into a
contour of straight segments and circular arcs that passes within
every tolerance. Edits contours, measures their area and finds
self-intersections and intersections of lines, circles and arcs.
.
This package holds the shared library.")

set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME ${development_package})
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SHLIBDEPS OFF)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS "${library_package} (= ${debian_version})")
set(CPACK_COMPONENT_DEVELOPMENT_DESCRIPTION
    "plane geometry for contour measurement, development files
Turns measured contour points, each with its own tolerance, into a
contour of straight segments and circular arcs that passes within
every tolerance. Edits contours, measures their area and finds
self-intersections and intersections of lines, circles and arcs.
.
This package holds the headers, the CMake package and the pkg-config
file.")

set(CPACK_DEBIAN_IO_RUNTIME_PACKAGE_NAME ${io_library_package})
set(CPACK_DEBIAN_IO_RUNTIME_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_IO_RUNTIME_PACKAGE_CONTROL_EXTRA ${debian_dir}/triggers)
set(CPACK_DEBIAN_IO_RUNTIME_PACKAGE_DEPENDS "${library_package} (>= ${debian_version})")
set(CPACK_COMPONENT_IO_RUNTIME_DESCRIPTION
    "files, measures and drawings of contours, shared library
Reads measured points, fits contours of straight segments and circular
arcs to them, reads and writes contours as JSON, CSV, DXF, G-code, WKT,
GeoJSON and SVG, measures deviations, areas and intersections, and draws SVG, PNG
and HTML.
.
This package holds the shared library.")

set(CPACK_DEBIAN_IO_DEVELOPMENT_PACKAGE_NAME ${io_development_package})
set(CPACK_DEBIAN_IO_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_IO_DEVELOPMENT_PACKAGE_SHLIBDEPS OFF)
set(CPACK_DEBIAN_IO_DEVELOPMENT_PACKAGE_DEPENDS
    "${io_library_package} (= ${debian_version}), ${development_package} (= ${debian_version})")
set(CPACK_COMPONENT_IO_DEVELOPMENT_DESCRIPTION
    "files, measures and drawings of contours, development files
Reads measured points, fits contours of straight segments and circular
arcs to them, reads and writes contours as JSON, CSV, DXF, G-code, WKT,
GeoJSON and SVG, measures deviations, areas and intersections, and draws SVG, PNG
and HTML.
.
This package holds the headers, the part of the CMake package and the
pkg-config file.")

set(CPACK_DEBIAN_TOOLS_PACKAGE_NAME ${tools_package})
set(CPACK_DEBIAN_TOOLS_PACKAGE_SECTION science)
set(CPACK_DEBIAN_TOOLS_PACKAGE_DEPENDS "${io_library_package} (>= ${debian_version})")
set(CPACK_DEBIAN_TOOLS_PACKAGE_RECOMMENDS fonts-dejavu-core)
set(CPACK_COMPONENT_TOOLS_DESCRIPTION
    "fit lines and arcs to measured contour points
The program contour reads measured points from a CSV file, fits a
contour of straight segments and circular arcs within their
tolerances, prints a table of the elements and writes them as JSON
and as an SVG drawing.")

include(CPack)
