#pragma once

#include <string>
#include <string_view>

/// What the beginning of a text tells about its format.
namespace Vorn::IO {

/// The first line that is neither empty nor a comment behind #, in lower case without blanks at its
/// ends; nothing when there is none. A byte order mark of UTF-8 is passed over.
std::string FirstLine(std::string_view text);

/// Whether such a line begins well-known text: "linestring (0 0, 1 0)", "srid=4326;polygon ...".
bool LooksLikeWkt(std::string_view firstLine);

/// Whether the text is of a format that may stand in one line, however long: JSON, XML or
/// well-known text. Tables, G-code and DXF have a line for each point or number.
bool MayStandInOneLine(std::string_view text);

}  // namespace Vorn::IO
