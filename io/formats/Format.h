#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "io/formats/GCode.h"
#include "io/pieces/ContourFile.h"

namespace Vorn::IO {

/// What a file is written as. The first five hold a contour and are read again.
enum class Format { Json, Csv, Dxf, GCode, Wkt, Svg, Html, Png };

/// By the ending of the name, in any case; nothing when it is none of ours.
std::optional<Format> FormatOf(std::string const& path);

/// By the name used for options: json, csv, dxf, gcode (or nc), wkt, svg, html, png.
std::optional<Format> FormatNamed(std::string_view name);

/// As FormatNamed takes it.
std::string NameOf(Format format);

/// By the first words of a text that holds a contour.
std::optional<Format> FormatOfContent(std::string_view text);

/// Whether a contour can be read from and written to the format: all but the drawings.
bool HoldsContour(Format format);

/// What the user can choose about the files.
struct WriteOptions {
  bool dxfEntities = false;  ///< LINE and ARC in place of one POLYLINE
  GCodeOptions gcode;
};

/// The contour as the text of a file.
/// @throws Failure (FailureKind::Internal) for a drawing, or (FailureKind::BadArgument) when the
/// format cannot
///         say what the contour needs.
std::string ToText(ContourFile const& contour, Format format, WriteOptions const& options);

}  // namespace Vorn::IO
