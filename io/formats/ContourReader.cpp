#include "io/formats/CsvPieces.h"
#include "io/formats/Dxf.h"
#include "io/formats/GCode.h"
#include "io/formats/JsonPieces.h"
#include "io/formats/Svg.h"
#include "io/formats/Text.h"
#include "io/formats/Wkt.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Files.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"

namespace Vorn::IO {

namespace {

void RefuseBinary(std::string_view text, std::string const& path) {
  std::size_t const zero = text.find('\0');
  if (zero != std::string_view::npos) {
    throw Failure(FailureKind::File, PlaceIn(text, zero, path), "is binary, not text");
  }
}

void RefuseEmpty(std::string_view text, std::string const& path) {
  if (text.find_first_not_of(" \t\r\n") == std::string_view::npos) RefuseFile(path, "is empty");
}

constexpr std::size_t kMebibyte = std::size_t{1} << 20;

/// How long the text of a contour may be. A point takes as little as four bytes of these formats
/// and up to 67 times as much memory, as measured for a line string of GeoJSON of a digit a
/// coordinate: some 2 GB at the limit. An entity of DXF is much longer. SVG has a limit of its own.
std::size_t LargestText(Format format) {
  constexpr std::size_t kTerse = 32 * kMebibyte;
  constexpr std::size_t kWordy = 256 * kMebibyte;
  return format == Format::Dxf || format == Format::Svg ? kWordy : kTerse;
}

void RefuseTooLarge(std::string_view text, std::string const& path, Format format) {
  std::size_t const largest = LargestText(format);
  if (text.size() <= largest) return;
  RefuseFile(path, "is too large: more than " + std::to_string(largest / kMebibyte) + " MiB of " +
                       NameOf(format));
}

Format RecognisedFormat(std::string_view text, std::string const& path) {
  if (std::optional<Format> const byName = FormatOf(path)) return *byName;
  if (std::optional<Format> const byContent = FormatOfContent(text)) return *byContent;
  RefuseFile(path, "holds no contour: it looks like none of JSON, CSV, DXF, G-code, WKT and SVG");
}

ContourFile ParseAs(Format format, std::string_view text, std::string const& path,
                    ReadOptions const& options) {
  switch (format) {
    case Format::Json:
    case Format::GeoJson:
      return ParseJsonPieces(text, path, options.arcs);
    case Format::Csv:
      return ParseCsvPieces(text, path, options.arcs);
    case Format::Dxf:
      return ParseDxf(text, path, options);
    case Format::GCode:
      return ParseGCode(text, path, options.arcs);
    case Format::Wkt:
      return ParseWkt(text, path, options.arcs);
    case Format::Svg:
      return ParseSvg(text, path, options);
    default:
      throw Failure(FailureKind::BadArgument, {path},
                    "a contour cannot be read from " + NameOf(format));
  }
}

}  // namespace

ContourFile ParseContour(std::string_view text, std::string const& path,
                         ReadOptions const& options) {
  RefuseBinary(text, path);
  RefuseEmpty(text, path);
  Format const format = options.format ? *options.format : RecognisedFormat(text, path);
  RefuseTooLarge(text, path, format);
  ContourFile contour = ParseAs(format, text, path, options);
  contour.path = Printable(path);
  contour.units = Printable(contour.units);
  if (contour.pieces.empty()) RefuseFile(path, "holds no contour: there are no pieces");
  contour.leftOut = RemovePiecesWithoutLength(&contour.pieces);
  if (contour.pieces.empty()) RefuseFile(path, "holds no contour: no piece has a length");
  return contour;
}

ContourFile ParseContour(std::string_view text, std::string const& path,
                         std::optional<Format> format) {
  return ParseContour(text, path, ReadOptions{format, {}, ArcUse::Keep});
}

ContourFile ReadContour(std::string const& path, std::istream& in, ReadOptions const& options) {
  return ParseContour(ReadTextFile(path, in), InputName(path), options);
}

ContourFile ReadContour(std::string const& path, std::istream& in, std::optional<Format> format) {
  return ReadContour(path, in, ReadOptions{format, {}, ArcUse::Keep});
}

}  // namespace Vorn::IO
