# What every target of this project has in common.

# Warnings, language level and floating-point mode for a target of ours.
function(vorn_set_defaults target)
  target_compile_features(${target} PRIVATE cxx_std_20)
  target_compile_definitions(${target} PRIVATE $<$<BOOL:${VORN_ASSERTIONS}>:VORN_ASSERTIONS>)
  if(MSVC)
    target_compile_options(
      ${target} PRIVATE /W4 /fp:precise $<$<BOOL:${VORN_WARNINGS_AS_ERRORS}>:/WX>)
    return()
  endif()

  # No fused multiply-add: a compiler that contracts a*b + c rounds once where the source rounds
  # twice, so the same contour would get other bits on another machine or optimisation level, and
  # a cross product that is exactly zero could come out non-zero. Nor ever -ffast-math.
  target_compile_options(${target} PRIVATE -ffp-contract=off)

  # Functions begin on pairs of lines of the cache and loops on halves of lines, so that the speed
  # of one does not change with what the linker happens to put before it: a linear system of order
  # 3 takes 20 per cent longer on the second line of a pair.
  if(CMAKE_CXX_COMPILER_ID MATCHES "^(GNU|Clang)$")
    target_compile_options(
      ${target} PRIVATE $<$<CONFIG:Release,RelWithDebInfo>:-falign-functions=128 -falign-loops=32>)
  endif()

  # Not among them: -Wfloat-equal, because exact comparisons of doubles are meant here.
  target_compile_options(
    ${target}
    PRIVATE -Wall
            -Wextra
            -Wpedantic
            -Wshadow
            -Wconversion
            -Wsign-conversion
            -Wdouble-promotion
            -Wold-style-cast
            -Wcast-align
            -Wcast-qual
            -Wformat=2
            -Wimplicit-fallthrough
            -Woverloaded-virtual
            -Wundef
            -Wunused
            $<$<CXX_COMPILER_ID:GNU>:-Wduplicated-branches>
            $<$<CXX_COMPILER_ID:GNU>:-Wduplicated-cond>
            $<$<CXX_COMPILER_ID:GNU>:-Wlogical-op>
            $<$<CXX_COMPILER_ID:Clang>:-Wextra-semi>
            $<$<CXX_COMPILER_ID:Clang>:-Wcomma>
            $<$<CXX_COMPILER_ID:Clang>:-Wunreachable-code>
            $<$<BOOL:${VORN_WARNINGS_AS_ERRORS}>:-Werror>)
endfunction()

# Hidden visibility does not hide the instances of standard templates (namespace std has default
# visibility), so the linker gets the list of what leaves the library.
function(vorn_export_only target map)
  get_target_property(type ${target} TYPE)
  if(NOT CMAKE_SYSTEM_NAME STREQUAL "Linux" OR NOT type STREQUAL "SHARED_LIBRARY")
    return()
  endif()
  target_link_options(${target} PRIVATE LINKER:--version-script=${map})
  # The library's calls of its own exported members go straight to them, not by way of the table
  # through which a program could put its own in their place.
  target_link_options(${target} PRIVATE LINKER:-Bsymbolic-functions)
  target_compile_options(${target} PRIVATE -fno-semantic-interposition)
  set_target_properties(${target} PROPERTIES LINK_DEPENDS ${map})
  if(NOT VORN_SANITIZE)
    # A sanitizer's run time is found in the program only, so its symbols stay open there.
    target_link_options(${target} PRIVATE LINKER:--no-undefined)
  endif()
endfunction()

# Sanitizers and coverage hold for every target made after this call.
function(vorn_enable_instrumentation)
  if(VORN_SANITIZE)
    add_compile_options(-fsanitize=${VORN_SANITIZE} -fno-sanitize-recover=all
                        -fno-omit-frame-pointer)
    add_link_options(-fsanitize=${VORN_SANITIZE})
    add_compile_definitions(_GLIBCXX_ASSERTIONS)
  endif()
  if(VORN_COVERAGE)
    # Fits on several threads would lose counts without atomic ones.
    add_compile_options(--coverage -fprofile-update=atomic)
    add_link_options(--coverage)
  endif()
endfunction()

# Compiles up to eight sources of a target as one, which saves most of the time of the headers. For
# whoever builds everything at once; after a change of one source all eight are compiled again.
function(vorn_compile_together target)
  if(NOT VORN_COMPILE_TOGETHER)
    return()
  endif()
  find_package(Python3 REQUIRED COMPONENTS Interpreter)
  get_target_property(sources ${target} SOURCES)
  list(FILTER sources INCLUDE REGEX "^[^$]+\\.cpp$")
  list(REMOVE_ITEM sources ${ARGN})
  execute_process(
    COMMAND ${Python3_EXECUTABLE} ${PROJECT_SOURCE_DIR}/scripts/batching.py 8 ${sources}
    WORKING_DIRECTORY ${CMAKE_CURRENT_SOURCE_DIR}
    OUTPUT_VARIABLE batches COMMAND_ERROR_IS_FATAL ANY)
  foreach(source batch IN ZIP_LISTS sources batches)
    set_source_files_properties(${source} PROPERTIES UNITY_GROUP ${target}_${batch})
  endforeach()
  set_source_files_properties(${ARGN} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
  set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_MODE GROUP)
  # What one source declares shadows nothing of another when each is compiled for itself.
  target_compile_options(${target} PRIVATE -Wno-shadow)
endfunction()

# Rebuilds after a switch of branch or a fresh clone cost seconds instead of minutes. The cache
# takes files that use a precompiled header only when it may overlook two things that no source
# here uses: macros defined ahead of it, and the time of compilation.
macro(vorn_use_ccache)
  find_program(VORN_CCACHE ccache)
  mark_as_advanced(VORN_CCACHE)
  if(VORN_CCACHE AND NOT CMAKE_CXX_COMPILER_LAUNCHER)
    set(CMAKE_CXX_COMPILER_LAUNCHER ${CMAKE_COMMAND} -E env
                                    CCACHE_SLOPPINESS=pch_defines,time_macros ${VORN_CCACHE})
  endif()
endmacro()

# Adds the folder when the option says so; the option exists only when the folder is there.
macro(vorn_add_optional_part option folder what)
  if(EXISTS ${PROJECT_SOURCE_DIR}/${folder}/CMakeLists.txt)
    option(${option} "Build ${what}" ${PROJECT_IS_TOP_LEVEL})
    if(${option})
      add_subdirectory(${folder})
    endif()
  endif()
endmacro()
