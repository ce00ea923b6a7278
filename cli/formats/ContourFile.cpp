#include "cli/formats/ContourFile.h"

#include <algorithm>
#include <cmath>

#include "cli/Failure.h"
#include "cli/Numbers.h"
#include "cli/TextFile.h"
#include "cli/commands/Command.h"
#include "cli/formats/CsvPieces.h"
#include "cli/formats/Dxf.h"
#include "cli/formats/Format.h"
#include "cli/formats/GCode.h"
#include "cli/formats/JsonPieces.h"
#include "cli/formats/Shapes.h"
#include "cli/formats/Text.h"
#include "cli/formats/Wkt.h"

namespace Vorn::Cli {

namespace {

void RefuseBinary(std::string_view text, std::string const& path) {
  std::size_t const zero = text.find('\0');
  if (zero != std::string_view::npos) {
    throw Failure(ExitCode::File, path + ":" + PlaceOf(text, zero) + ": is binary, not text");
  }
}

void RefuseEmpty(std::string_view text, std::string const& path) {
  if (text.find_first_not_of(" \t\r\n") == std::string_view::npos) RefuseFile(path, "is empty");
}

Format RecognisedFormat(std::string_view text, std::string const& path) {
  if (std::optional<Format> const byName = FormatOf(path)) return *byName;
  if (std::optional<Format> const byContent = FormatOfContent(text)) return *byContent;
  RefuseFile(path, "holds no contour: it looks like none of JSON, CSV, DXF, G-code and WKT");
}

ContourFile ParseAs(Format format, std::string_view text, std::string const& path) {
  switch (format) {
    case Format::Json:
      return ParseJsonPieces(text, path);
    case Format::Csv:
      return ParseCsvPieces(text, path);
    case Format::Dxf:
      return ParseDxf(text, path);
    case Format::GCode:
      return ParseGCode(text, path);
    case Format::Wkt:
      return ParseWkt(text, path);
    default:
      throw Failure(ExitCode::Usage, path + ": a contour cannot be read from " + NameOf(format));
  }
}

}  // namespace

double JointTolerance(std::vector<Piece> const& pieces) {
  double coordinate = 0.0;
  double radius = 0.0;
  for (Piece const& piece : pieces) {
    for (XY const& end : {piece.start, piece.end}) {
      coordinate = std::max({coordinate, std::fabs(end.x), std::fabs(end.y)});
    }
    radius = std::max(radius, piece.radius);
  }
  return std::max(1e-9 * coordinate, 1e-14 * radius);
}

bool ReturnsToStart(std::vector<Piece> const& pieces) {
  if (pieces.empty()) return false;
  return Distance(pieces.back().end, pieces.front().start) <= JointTolerance(pieces);
}

std::vector<Gap> FindGaps(ContourFile const& contour) {
  std::vector<Gap> gaps;
  std::vector<Piece> const& pieces = contour.pieces;
  double const tolerance = JointTolerance(pieces);
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    bool const isLast = i + 1 == pieces.size();
    if (isLast && !contour.isClosed) break;
    std::size_t const next = isLast ? 0 : i + 1;
    double const size = Distance(pieces[i].end, pieces[next].start);
    if (size > tolerance) gaps.push_back({i, next, size});
  }
  return gaps;
}

std::string Describe(Gap const& gap) {
  std::string const size = ": the gap is " + FormatShort(gap.size);
  if (gap.after == 0) return "the contour is closed, but its ends do not meet" + size;
  return "pieces " + std::to_string(gap.before + 1) + " and " + std::to_string(gap.after + 1) +
         " do not meet" + size;
}

ContourFile ParseContour(std::string_view text, std::string const& path,
                         std::optional<Format> format) {
  RefuseBinary(text, path);
  RefuseEmpty(text, path);
  ContourFile contour = ParseAs(format ? *format : RecognisedFormat(text, path), text, path);
  contour.path = path;
  if (contour.pieces.empty()) RefuseFile(path, "holds no contour: there are no pieces");
  return contour;
}

ContourFile ReadContour(std::string const& path, Console const& console,
                        std::optional<Format> format) {
  return ParseContour(ReadTextFile(path, console.in), InputName(path), format);
}

}  // namespace Vorn::Cli
