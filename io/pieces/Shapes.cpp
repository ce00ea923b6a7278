#include "io/pieces/Shapes.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "io/pieces/Turning.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr double kEpsilon = std::numeric_limits<double>::epsilon();

double AngleOf(XY const& center, XY const& point) {
  return std::atan2(point.y - center.y, point.x - center.x);
}

double LargestCoordinate(Piece const& piece) {
  return std::max({std::fabs(piece.start.x), std::fabs(piece.start.y), std::fabs(piece.end.x),
                   std::fabs(piece.end.y)});
}

/// How far an end may be from where the circle has it: three good digits of the arc, six of what
/// it is worked out from.
double AllowedError(Piece const& arc) {
  constexpr double kOfArc = 1e-3;
  constexpr double kOfTerms = 1e-6;
  double const terms =
      arc.radius + LargestCoordinate(arc) + std::fabs(arc.center.x) + std::fabs(arc.center.y);
  return kOfArc * std::min(arc.radius, arc.length) + kOfTerms * terms;
}

void Include(XY const& point, Extent* extent) {
  extent->low = {std::min(extent->low.x, point.x), std::min(extent->low.y, point.y)};
  extent->high = {std::max(extent->high.x, point.x), std::max(extent->high.y, point.y)};
}

/// The places where the arc is highest, lowest, leftmost or rightmost in its middle.
void IncludeBulge(Piece const& arc, Extent* extent) {
  XY const extremes[] = {{arc.center.x + arc.radius, arc.center.y},
                         {arc.center.x, arc.center.y + arc.radius},
                         {arc.center.x - arc.radius, arc.center.y},
                         {arc.center.x, arc.center.y - arc.radius}};
  for (XY const& extreme : extremes) {
    double turn = TurnBetween(arc.startAngle, AngleOf(arc.center, extreme), arc.counterClockwise);
    if (turn < arc.sweep) Include(extreme, extent);
  }
}

}  // namespace

bool IsUsable(double value) { return std::fabs(value) <= kLargestCoordinate; }

double Distance(XY const& a, XY const& b) { return std::hypot(a.x - b.x, a.y - b.y); }

bool AreEqual(XY const& a, XY const& b) { return a.x == b.x && a.y == b.y; }

Piece MakeLine(XY const& start, XY const& end) {
  Piece line;
  line.start = start;
  line.end = end;
  line.length = Distance(start, end);
  return line;
}

Piece MakeArc(XY const& start, XY const& end, XY const& center, double radius,
              bool counterClockwise) {
  Piece arc;
  arc.kind = Piece::Kind::Arc;
  arc.start = start;
  arc.end = end;
  arc.center = center;
  arc.radius = radius;
  arc.counterClockwise = counterClockwise;
  arc.startAngle = AngleOf(center, start);
  arc.endAngle = AngleOf(center, end);
  arc.sweep = TurnBetween(arc.startAngle, arc.endAngle, counterClockwise);
  arc.length = radius * arc.sweep;
  return arc;
}

Piece MakeBulge(XY const& start, XY const& end, double bulge) {
  double const chord = Distance(start, end);
  double const size = std::fabs(bulge);
  double const radius = chord * (1.0 / size + size) / 4.0;
  double const rise = chord * size / 2.0;
  if (!(rise > radius * kEpsilon) || !IsUsable(radius)) return MakeLine(start, end);
  // The centre lies on the perpendicular of the chord, this part of the chord away from it.
  double const part = (1.0 / bulge - bulge) / 4.0;
  XY const center = {(start.x + end.x) / 2.0 - part * (end.y - start.y),
                     (start.y + end.y) / 2.0 + part * (end.x - start.x)};
  Piece arc = MakeArc(start, end, center, radius, bulge > 0.0);
  // Better than from the angles, which lose the sweep of a short arc of a large circle.
  arc.sweep = 4.0 * std::atan(size);
  arc.length = radius * arc.sweep;
  return arc;
}

double BulgeOf(Piece const& piece) {
  if (!piece.IsArc()) return 0.0;
  double const bulge = std::tan(piece.sweep / 4.0);
  return piece.counterClockwise ? bulge : -bulge;
}

std::vector<Piece> MakeCircle(XY const& start, XY const& center, double radius,
                              bool counterClockwise) {
  XY const opposite = {2.0 * center.x - start.x, 2.0 * center.y - start.y};
  return {MakeArc(start, opposite, center, radius, counterClockwise),
          MakeArc(opposite, start, center, radius, counterClockwise)};
}

Piece Reversed(Piece const& piece) {
  Piece reversed = piece;
  std::swap(reversed.start, reversed.end);
  std::swap(reversed.startAngle, reversed.endAngle);
  if (piece.IsArc()) reversed.counterClockwise = !piece.counterClockwise;
  return reversed;
}

std::vector<Piece> Halves(Piece const& arc) {
  XY const middle = PointOnArc(arc, arc.sweep / 2.0);
  return {MakeArc(arc.start, middle, arc.center, arc.radius, arc.counterClockwise),
          MakeArc(middle, arc.end, arc.center, arc.radius, arc.counterClockwise)};
}

std::vector<Piece> WithoutWideArcs(std::vector<Piece> const& pieces) {
  std::vector<Piece> result;
  for (Piece const& piece : pieces) {
    if (piece.IsArc() && piece.sweep > kWidestArc) {
      std::vector<Piece> const halves = Halves(piece);
      result.insert(result.end(), halves.begin(), halves.end());
    } else {
      result.push_back(piece);
    }
  }
  return result;
}

std::vector<Piece> WithoutArcsBeyond(double widest, std::vector<Piece> const& pieces) {
  std::vector<Piece> result;
  for (Piece const& piece : pieces) {
    int const count =
        piece.IsArc() ? std::max(1, static_cast<int>(std::ceil(piece.sweep / widest))) : 1;
    XY from = piece.start;
    for (int part = 1; part < count; ++part) {
      XY const to = PointOnArc(piece, piece.sweep * part / count);
      result.push_back(MakeArc(from, to, piece.center, piece.radius, piece.counterClockwise));
      from = to;
    }
    result.push_back(piece);
    if (count > 1) {
      result.back() = MakeArc(from, piece.end, piece.center, piece.radius, piece.counterClockwise);
    }
  }
  return result;
}

std::vector<std::vector<Piece>> ConnectedRuns(std::vector<Piece> const& pieces, double tolerance) {
  std::vector<std::vector<Piece>> runs;
  for (Piece const& piece : pieces) {
    if (runs.empty() || Distance(runs.back().back().end, piece.start) > tolerance) {
      runs.emplace_back();
    }
    runs.back().push_back(piece);
  }
  return runs;
}

std::optional<std::string> FaultOf(Piece const& arc) {
  if (!(arc.radius > 0.0)) return "the radius is not above 0";
  double const atStart = Distance(PointOnArc(arc, 0.0), arc.start);
  double const atEnd = Distance(PointOnArc(arc, arc.sweep), arc.end);
  double const allowed = AllowedError(arc);
  if (!(atStart <= allowed)) return "the start is " + FormatShort(atStart) + " off the circle";
  if (!(atEnd <= allowed)) return "the end is " + FormatShort(atEnd) + " off the circle";
  return {};
}

Extent ExtentOf(std::vector<Piece> const& pieces) {
  Extent extent = {pieces.front().start, pieces.front().start};
  for (Piece const& piece : pieces) {
    Include(piece.start, &extent);
    Include(piece.end, &extent);
    if (piece.IsArc()) IncludeBulge(piece, &extent);
  }
  return extent;
}

}  // namespace Vorn::IO
