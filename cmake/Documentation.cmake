# Reference documentation: `cmake --build build/dev --target docs`, then open
# build/dev/docs/html/index.html.
find_program(VORN_DOXYGEN doxygen)
find_program(VORN_DOT dot)
mark_as_advanced(VORN_DOXYGEN VORN_DOT)

if(VORN_DOXYGEN)
  set(doxygen_output ${PROJECT_BINARY_DIR}/docs)
  set(doxygen_have_dot NO)
  if(VORN_DOT)
    set(doxygen_have_dot YES)
  endif()
  configure_file(${PROJECT_SOURCE_DIR}/docs/Doxyfile.in ${PROJECT_BINARY_DIR}/Doxyfile @ONLY)
  configure_file(${PROJECT_SOURCE_DIR}/docs/DoxyfileIO.in ${PROJECT_BINARY_DIR}/DoxyfileIO @ONLY)
  add_custom_target(
    docs
    COMMAND ${CMAKE_COMMAND} -E make_directory ${doxygen_output}/io
    COMMAND ${VORN_DOXYGEN} ${PROJECT_BINARY_DIR}/Doxyfile
    COMMAND ${VORN_DOXYGEN} ${PROJECT_BINARY_DIR}/DoxyfileIO
    COMMENT "Writing the reference documentation to ${doxygen_output}/html/index.html"
    VERBATIM)
endif()
