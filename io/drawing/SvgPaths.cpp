#include "io/drawing/SvgPaths.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "io/drawing/Feet.h"
#include "io/drawing/SvgElements.h"

namespace Vorn::IO::Svg {

namespace {

/// Arcs are written in parts of at most this sweep, in radians: one part of more than half a turn
/// is ambiguous, and one of nearly a whole turn loses its centre to rounding.
constexpr double kLargestArcPart = 0.5 * std::numbers::pi;

/// An arc that bulges less than this many pixels is written as a line; its radius in pixels may
/// be beyond what viewers handle.
constexpr double kFlatArc = 0.02;

std::string ArcData(Piece const& arc, double from, double to, View const& view) {
  double const radius = arc.radius * view.Scale();
  double const sweep = (to - from) * arc.sweep;
  int const parts = std::max(1, static_cast<int>(std::ceil(sweep / kLargestArcPart - 1e-9)));
  double const bulge = radius * (1.0 - std::cos(0.5 * sweep / parts));
  std::string data;
  for (int i = 1; i <= parts; ++i) {
    bool const isEnd = i == parts && to == 1.0;
    GeometryUtils::Point const target =
        isEnd ? arc.end : PointOnArc(arc, from * arc.sweep + sweep * i / parts);
    std::string const at = Px(view(target.x, target.y));
    if (bulge < kFlatArc) {
      data += "L" + at;
    } else {
      // With y turned over by the view, counter-clockwise is SVG's negative sense.
      char const* const sense = arc.counterClockwise ? "0" : "1";
      data += "A" + Px(radius) + "," + Px(radius) + " 0 0 " + sense + " " + at;
    }
  }
  return data;
}

}  // namespace

std::string StretchData(Piece const& piece, double from, double to, View const& view) {
  if (piece.IsArc() && piece.length > 0.0) {
    return ArcData(piece, from / piece.length, to / piece.length, view);
  }
  GeometryUtils::Point const end = to == piece.length ? piece.end : PlaceOn(piece, to);
  return "L" + Px(view(end.x, end.y));
}

std::string PathData(std::vector<Piece> const& pieces, View const& view) {
  std::string data;
  std::string pen;
  for (Piece const& piece : pieces) {
    // Pieces of a file need not meet: a gap is not drawn over.
    std::string const start = Px(view(piece.start.x, piece.start.y));
    if (start != pen) data += "M" + start;
    data += StretchData(piece, 0.0, piece.length, view);
    pen = Px(view(piece.end.x, piece.end.y));
  }
  return data;
}

}  // namespace Vorn::IO::Svg
