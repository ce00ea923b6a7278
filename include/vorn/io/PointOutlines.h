#pragma once

#include <iosfwd>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "vorn/io/Export.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Points.h"

namespace Vorn::IO {

/// How points are taken from a file.
struct PointReading {
  ToleranceColumn tolerance;         ///< of a table
  ColumnChoice columns;              ///< of a table
  std::optional<Format> format;      ///< Csv is a table; nothing: the name or the content tells
  std::optional<double> flattening;  ///< how far chords may be from curves and arcs; nothing: these
                                     ///< are refused
};

/// The runs of points in a file, each to be fitted by itself.
///
/// A table of points is one run, see ReadPoints. Of DXF, G-code, WKT, GeoJSON, SVG and the JSON of
/// a contour the vertices of the lines are the points, run by run in the order of the file; runs
/// whose ends meet (see ChainTolerance) are chained. A run that comes back exactly to its start
/// ends there and repeats its first point. Arcs and curves are refused, or their chords taken. Such
/// points have no lines and no tolerances.
///
/// Without a format, a name that ends like one of these tells; any other text is a table unless it
/// begins as DXF, WKT, JSON or XML do.
///
/// @throws Failure as ReadPoints and ReadContour do, (FailureKind::File) naming the outline and the
///         place of an arc without `flattening`, (BadArgument) when columns are chosen of a file
///         that is no table, or the format is a drawing.
VORN_IO_EXPORT std::vector<PointFile> ReadPointOutlines(std::string const& path, std::istream& in,
                                                        PointReading const& reading);

/// The same for text already in memory; `path` serves the messages and tells the format.
VORN_IO_EXPORT std::vector<PointFile> ParsePointOutlines(std::string_view text,
                                                         std::string const& path,
                                                         PointReading const& reading);

/// The points of outlines of one file, one after the other; there must be at least one.
VORN_IO_EXPORT PointFile Joined(std::vector<PointFile> const& outlines);

/// Whether the file is a table of points, by what is said of it, its name and its content.
VORN_IO_EXPORT bool IsPointTable(std::string_view text, std::string const& path,
                                 std::optional<Format> format);

}  // namespace Vorn::IO
