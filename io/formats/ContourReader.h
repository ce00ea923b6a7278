#pragma once

#include <iosfwd>
#include <optional>
#include <string>
#include <string_view>

#include "io/pieces/ContourFile.h"

namespace Vorn::IO {

enum class Format;

/// Reads a contour from JSON, CSV, DXF, G-code or WKT; "-" is `in`. Without `format` the
/// ending of the name tells, and for other names the content.
///
/// Gaps stay as they are: nothing is joined that the file does not join.
///
/// @throws Failure (FailureKind::File) naming file, line and offending text, or
/// (FailureKind::BadArgument)
///         when the format is told and cannot be read as a contour.
ContourFile ReadContour(std::string const& path, std::istream& in,
                        std::optional<Format> format = {});

/// The same for text already in memory; `path` serves the messages.
ContourFile ParseContour(std::string_view text, std::string const& path,
                         std::optional<Format> format = {});

}  // namespace Vorn::IO
