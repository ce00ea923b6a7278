#pragma once

#include <iosfwd>
#include <optional>
#include <string>
#include <string_view>

#include "vorn/io/ContourFile.h"
#include "vorn/io/Export.h"
#include "vorn/io/GCodeOptions.h"

namespace Vorn::IO {

/// What a file is written as. All but the last two are read as well.
enum class Format { Json, Csv, Dxf, GCode, Wkt, GeoJson, Svg, Html, Png };

/// By the ending of the name, in any case; nothing when it is none of ours.
VORN_IO_EXPORT std::optional<Format> FormatOf(std::string const& path);

/// By the name used for options: json, csv, dxf, gcode (or nc), wkt, geojson, svg, html, png.
VORN_IO_EXPORT std::optional<Format> FormatNamed(std::string_view name);

/// As FormatNamed takes it.
VORN_IO_EXPORT std::string NameOf(Format format);

/// By the first words of a text that holds a contour.
VORN_IO_EXPORT std::optional<Format> FormatOfContent(std::string_view text);

/// Whether a contour can be read from and written to the format: all but the drawings.
VORN_IO_EXPORT bool HoldsContour(Format format);

struct WriteOptions;

/// The same where a choice counts: SVG holds a contour when it is plain.
VORN_IO_EXPORT bool HoldsContour(Format format, WriteOptions const& options);

/// Whether a contour can be read from the format: those that hold one, and SVG, whose shapes are
/// one.
VORN_IO_EXPORT bool IsReadAsContour(Format format);

/// The version of the JSON documents that hold a contour; it grows when a field changes its meaning
/// or goes away.
inline constexpr int kJsonSchemaVersion = 1;

/// The version of DXF that is written.
enum class DxfVersion { R12, R2000 };

/// What the user can choose about the files.
struct WriteOptions {
  bool dxfEntities = false;                 ///< LINE and ARC in place of one polyline
  DxfVersion dxfVersion = DxfVersion::R12;  ///< R2000: LWPOLYLINE, units and layers of holes
  bool svgPlain = false;                    ///< SVG is the contour itself, not a drawing of it
  std::optional<double> chords;  ///< GeoJSON: how far chords may be from arcs; needed for these
  GCodeOptions gcode;            ///< of a tool path
};

/// The contour as the text of a file. Pieces without length are left out, see
/// RemovePiecesWithoutLength.
/// @throws std::bad_alloc when memory runs out, but not with JSON: the JSON library takes memory to
///         free a document, and ends the program where it gets none. The same holds for reading.
/// @throws Failure (FailureKind::BadArgument) for the format of a drawing, when no piece has a
///         length, or when the format cannot say what the contour needs.
VORN_IO_EXPORT std::string ToText(ContourFile const& contour, Format format,
                                  WriteOptions const& options);

/// What becomes of the arcs of circles in a file.
enum class ArcUse {
  Keep,   ///< they are pieces of the contour
  Refuse  ///< points are wanted, so the first arc ends the reading with its place in the file
};

/// How a file with a contour is read.
struct ReadOptions {
  std::optional<Format> format;      ///< nothing: the ending of the name tells, or the content
  std::optional<double> flattening;  ///< how far chords may be from curves; nothing: none are made
  ArcUse arcs = ArcUse::Keep;        ///< what becomes of arcs of circles
};

/// Reads a contour from JSON, CSV, DXF, G-code, WKT, GeoJSON or SVG; "-" is `in`. Without `format`
/// the ending of the name tells, and for other names the content.
///
/// Curves that are no arcs of circles become chords where `flattening` says how near these must be,
/// and are refused otherwise.
///
/// Gaps stay as they are: nothing is joined that the file does not join. Pieces without length are
/// left out and counted, see RemovePiecesWithoutLength.
///
/// @throws Failure (FailureKind::File) with file, line and offending text, or (BadArgument) when
/// the
///         format is told and cannot be read as a contour.
VORN_IO_EXPORT ContourFile ReadContour(std::string const& path, std::istream& in,
                                       std::optional<Format> format = {});

/// The same with options.
VORN_IO_EXPORT ContourFile ReadContour(std::string const& path, std::istream& in,
                                       ReadOptions const& options);

/// The same for text already in memory; `path` serves the messages.
VORN_IO_EXPORT ContourFile ParseContour(std::string_view text, std::string const& path,
                                        std::optional<Format> format = {});

/// The same with options.
VORN_IO_EXPORT ContourFile ParseContour(std::string_view text, std::string const& path,
                                        ReadOptions const& options);

}  // namespace Vorn::IO
