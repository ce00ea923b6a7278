#include "io/formats/CsvPieces.h"
#include "io/formats/Dxf.h"
#include "io/formats/GCode.h"
#include "io/formats/JsonPieces.h"
#include "io/formats/ReadingMemory.h"
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

void RefuseTooLarge(std::string_view text, std::string const& path, Format format) {
  if (MemoryToRead(text, format) <= kLargestMemory) return;
  RefuseFile(path, "is too large: to read this " + NameOf(format) +
                       " would take more than 1 GiB of memory");
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
