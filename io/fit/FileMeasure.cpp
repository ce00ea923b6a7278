#include "vorn/io/FileMeasure.h"

#include <algorithm>
#include <utility>

#include "io/formats/GCode.h"
#include "io/pieces/Turning.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"

namespace Vorn::IO {

namespace {

/// One more digit divides the error by ten; with so many more than the tolerance asks for, rounding
/// is no longer what takes a point out.
constexpr int kMostExtraDecimals = 8;

double SmallestTolerance(std::vector<WPoint> const& points) {
  return std::min_element(points.begin(), points.end(),
                          [](WPoint const& a, WPoint const& b) { return a.w < b.w; })
      ->w;
}

/// Nothing when the contour cannot be written with these digits.
std::optional<std::string> GCodeWith(int decimals, ContourFile const& contour,
                                     GCodeOptions options) {
  options.decimals = decimals;
  try {
    return ToGCode(contour, options);
  } catch (Failure const&) {
    return {};
  }
}

/// Chords leave an arc by up to a hundredth of the smallest tolerance, if nobody says.
constexpr double kChordsInTolerance = 0.01;

/// A point that would be outside by the chords of an arc.
struct Tight {
  std::size_t piece = 0;
  double angle = 0.0;  ///< radians turned from the start of the arc to the direction of the point
};

std::vector<Tight> TightPoints(std::vector<WPoint> const& points, ContourFile const& contour,
                               double chords) {
  Remeasured const measured = Remeasure(points, contour.pieces);
  std::vector<Tight> tight;
  for (std::size_t i = 0; i < points.size(); ++i) {
    PointDeviation const& deviation = measured.points[i];
    Piece const& piece = contour.pieces[deviation.piece];
    if (!piece.IsArc() || deviation.distance + chords <= points[i].w) continue;
    double const angle = TurnTo(piece, points[i].x, points[i].y);
    if (angle > 0.0 && angle < piece.sweep) tight.push_back({deviation.piece, angle});
  }
  std::sort(tight.begin(), tight.end(), [](Tight const& a, Tight const& b) {
    return std::pair(a.piece, a.angle) < std::pair(b.piece, b.angle);
  });
  return tight;
}

/// The contour with its arcs divided where such points are nearest: chords end there, and a point
/// is no further from the end of a chord than from the arc.
ContourFile DividedAt(std::vector<Tight> const& tight, ContourFile const& contour) {
  ContourFile divided = contour;
  divided.pieces.clear();
  auto next = tight.begin();
  for (std::size_t i = 0; i < contour.pieces.size(); ++i) {
    Piece const& arc = contour.pieces[i];
    Piece rest = arc;
    for (; next != tight.end() && next->piece == i; ++next) {
      XY const to = PointOnArc(arc, next->angle);
      divided.pieces.push_back(
          MakeArc(rest.start, to, arc.center, arc.radius, arc.counterClockwise));
      rest = MakeArc(to, arc.end, arc.center, arc.radius, arc.counterClockwise);
    }
    divided.pieces.push_back(rest);
  }
  RemovePiecesWithoutLength(&divided.pieces);
  return divided;
}

std::string GeoJsonFor(std::vector<WPoint> const& points, ContourFile const& contour,
                       WriteOptions options) {
  if (!options.chords) options.chords = kChordsInTolerance * SmallestTolerance(points);
  ContourFile const divided = DividedAt(TightPoints(points, contour, *options.chords), contour);
  return ToText(divided, Format::GeoJson, options);
}

}  // namespace

FileMeasure MeasureText(std::string_view text, Format format, std::vector<WPoint> const& points) {
  FileMeasure measure;
  try {
    ContourFile const contour = ParseContour(text, "the file", format);
    Remeasured const remeasured = Remeasure(points, contour.pieces);
    measure.relative = remeasured.Worst().relative;
    measure.point = remeasured.worst;
    measure.isWithin = AreWithinTolerance(remeasured, points);
  } catch (Failure const& failure) {
    measure.unreadable = failure.what();
  }
  return measure;
}

std::string ToTextFor(std::vector<WPoint> const& points, ContourFile const& contour, Format format,
                      WriteOptions options) {
  if (format == Format::GeoJson) return GeoJsonFor(points, contour, options);
  if (format != Format::GCode) return ToText(contour, format, options);
  options.gcode.tolerance = SmallestTolerance(points);
  bool const isWithin = AreWithinTolerance(Remeasure(points, contour.pieces), points);
  int const first = GCodeDecimals(contour.units, options.gcode.tolerance);
  if (!options.gcode.decimals && isWithin) {
    int const last = std::min(first + kMostExtraDecimals, kMostGCodeDecimals);
    for (int decimals = first; decimals <= last; ++decimals) {
      auto const text = GCodeWith(decimals, contour, options.gcode);
      if (text && MeasureText(*text, format, points).IsWithin()) return *text;
    }
  }
  return ToText(contour, format, options);
}

}  // namespace Vorn::IO
