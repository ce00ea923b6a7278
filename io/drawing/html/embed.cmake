# Writes the text files as one C++ header: cmake -DOUT=header -DPARTS=name=file,file;... -P this
#
# The page holds its scripts as one module, in the order given, so what they import and export from
# each other by name goes.
set(header "// Made from the files in io/drawing/html.\n#pragma once\n\n")
string(APPEND header "namespace Vorn::IO::Html {\n\n")
foreach(part IN LISTS PARTS)
  string(REGEX MATCH "^([^=]+)=(.+)$" unused "${part}")
  set(name ${CMAKE_MATCH_1})
  string(REPLACE "," ";" files "${CMAKE_MATCH_2}")
  set(text "")
  foreach(file IN LISTS files)
    file(READ "${file}" contents)
    string(REGEX REPLACE "import {[^}]*} from '[.]/[a-z]+[.]js';\n" "" contents "${contents}")
    string(REGEX REPLACE "(^|\n)export " "\\1" contents "${contents}")
    string(APPEND text "${contents}")
  endforeach()
  string(APPEND header "inline constexpr char ${name}[] = R\"html~(${text})html~\";\n\n")
endforeach()
string(APPEND header "}  // namespace Vorn::IO::Html\n")
file(WRITE "${OUT}" "${header}")
