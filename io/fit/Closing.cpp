#include "io/fit/Closing.h"

#include <algorithm>
#include <cmath>
#include <optional>

#include "io/fit/Assignment.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/FitReport.h"

namespace Vorn::IO {

namespace {

/// A crossing further from the seam than this many of its tolerances would be a spike.
constexpr double kFarthestCrossing = 4.0;

constexpr int kMostNewtonSteps = 30;

/// A step this small, measured in the distance from the origin, is rounding.
constexpr double kSettled = 1e-14;

/// An end this near to the circle, measured in radii, is on it.
constexpr double kOnCircle = 1e-14;

/// Signed distance of a point from the line or circle that a piece is part of, with its gradient.
struct Offset {
  double value = 0.0;
  double dx = 0.0;
  double dy = 0.0;
};

Offset OffsetFrom(Piece const& piece, XY const& at) {
  if (piece.IsArc()) {
    double const x = at.x - piece.center.x;
    double const y = at.y - piece.center.y;
    double const r = std::hypot(x, y);
    return {r - piece.radius, x / r, y / r};
  }
  double const dx = -(piece.end.y - piece.start.y) / piece.length;
  double const dy = (piece.end.x - piece.start.x) / piece.length;
  return {dx * (at.x - piece.start.x) + dy * (at.y - piece.start.y), dx, dy};
}

/// Where the carriers of both pieces cross, by Newton's method from a point nearby. Nothing when
/// the steps do not settle, as with carriers that touch or do not meet.
std::optional<XY> CrossingNear(Piece const& a, Piece const& b, XY at, double farthest) {
  XY const begin = at;
  for (int step = 0; step < kMostNewtonSteps; ++step) {
    Offset const f = OffsetFrom(a, at);
    Offset const g = OffsetFrom(b, at);
    double const determinant = f.dx * g.dy - f.dy * g.dx;
    double const x = (f.value * g.dy - g.value * f.dy) / determinant;
    double const y = (g.value * f.dx - f.value * g.dx) / determinant;
    XY const next = {at.x - x, at.y - y};
    if (!(std::hypot(next.x - begin.x, next.y - begin.y) <= farthest)) return {};
    bool const isSettled = std::hypot(x, y) <= kSettled * std::hypot(next.x, next.y);
    at = next;
    if (isSettled) return at;
  }
  return {};
}

/// The arc from `start` to `end` through the middle of `old`; on the old circle when both are.
Piece MovedArc(Piece const& old, XY const& start, XY const& end) {
  auto const isOnCircle = [&](XY const& p) {
    double const r = std::hypot(p.x - old.center.x, p.y - old.center.y);
    return std::fabs(r - old.radius) <= kOnCircle * old.radius;
  };
  if (isOnCircle(start) && isOnCircle(end)) {
    return MakeArc(start, end, old.center, old.radius, old.counterClockwise);
  }
  // Relative to the middle, where nothing cancels that matters.
  XY const middle = PointOnArc(old, 0.5 * old.sweep);
  double const ax = start.x - middle.x;
  double const ay = start.y - middle.y;
  double const bx = end.x - middle.x;
  double const by = end.y - middle.y;
  double const a2 = ax * ax + ay * ay;
  double const b2 = bx * bx + by * by;
  double const twiceCross = 2.0 * (ax * by - ay * bx);
  double const cx = (a2 * by - b2 * ay) / twiceCross;
  double const cy = (b2 * ax - a2 * bx) / twiceCross;
  return MakeArc(start, end, {middle.x + cx, middle.y + cy}, std::hypot(cx, cy),
                 old.counterClockwise);
}

Piece Moved(Piece const& old, XY const& start, XY const& end) {
  return old.IsArc() ? MovedArc(old, start, end) : MakeLine(start, end);
}

/// Whether the arc is the old one but for a little: a new end on the wrong side of the old start
/// would turn a short arc into nearly a full circle.
bool IsAlike(Piece const& piece, Piece const& old) {
  if (!piece.IsArc()) return piece.length > 0.0;
  return std::isfinite(piece.radius) && std::fabs(piece.sweep - old.sweep) < 0.5 * old.sweep;
}

std::vector<XY> PlacesToTry(WPoint const& seam, Piece const& first, Piece const& last) {
  XY const& start = first.start;
  XY const& end = last.end;
  XY const middle = {0.5 * (start.x + end.x), 0.5 * (start.y + end.y)};
  std::vector<XY> places = {{seam.x, seam.y}, start, end, middle};
  if (auto const crossing =
          CrossingNear(first, last, {seam.x, seam.y}, kFarthestCrossing * seam.w)) {
    places.insert(places.begin(), *crossing);
  }
  return places;
}

/// The points that the first and the last piece stand for: no others can move out of tolerance.
std::vector<WPoint> PointsAtSeam(std::vector<WPoint> const& points,
                                 std::vector<Piece> const& pieces) {
  auto const ranges = AssignPoints(points, pieces);
  if (!ranges) return points;
  std::vector<WPoint> near;
  for (PointRange const& range : {ranges->front(), ranges->back()}) {
    auto const begin = points.begin() + static_cast<std::ptrdiff_t>(range.first);
    near.insert(near.end(), begin, begin + static_cast<std::ptrdiff_t>(range.count));
  }
  // Both ends stand for the seam, even where another piece is nearer.
  near.push_back(points.front());
  return near;
}

double WorstOf(std::vector<WPoint> const& points, std::vector<Piece> const& pieces) {
  return Remeasure(points, pieces).Worst().relative;
}

/// What is left of a piece without the first or last stretch; nothing when that is all of it.
std::optional<Piece> Shortened(Piece const& piece, double atStart, double atEnd) {
  if (!(atStart + atEnd < piece.length)) return {};
  if (piece.IsArc()) {
    XY const start = atStart > 0.0 ? PointOnArc(piece, atStart / piece.radius) : piece.start;
    XY const end = atEnd > 0.0 ? PointOnArc(piece, piece.sweep - atEnd / piece.radius) : piece.end;
    return MakeArc(start, end, piece.center, piece.radius, piece.counterClockwise);
  }
  double const x = (piece.end.x - piece.start.x) / piece.length;
  double const y = (piece.end.y - piece.start.y) / piece.length;
  return MakeLine({piece.start.x + atStart * x, piece.start.y + atStart * y},
                  {piece.end.x - atEnd * x, piece.end.y - atEnd * y});
}

double StepBetween(WPoint const& a, WPoint const& b) { return std::hypot(b.x - a.x, b.y - a.y); }

/// The last and the first piece with a line between them.
struct Bridge {
  Piece last;
  Piece line;
  Piece first;
};

/// A bridge that begins and ends this part of a step away from the seam.
std::optional<Bridge> BridgeOver(std::vector<WPoint> const& points,
                                 std::vector<Piece> const& pieces, double part) {
  auto const last =
      Shortened(pieces.back(), 0.0, part * StepBetween(points[points.size() - 2], points.back()));
  auto const first = Shortened(pieces.front(), part * StepBetween(points[0], points[1]), 0.0);
  if (!last || !first) return {};
  return Bridge{*last, MakeLine(last->end, first->start), *first};
}

/// Whether both ends of the line are within the tolerance of the seam, and so all of it.
bool IsAtSeam(Piece const& line, WPoint const& seam) {
  double const largest = kLargestRelative * seam.w;
  return std::hypot(line.start.x - seam.x, line.start.y - seam.y) <= largest &&
         std::hypot(line.end.x - seam.x, line.end.y - seam.y) <= largest;
}

/// The parts of a step to try, the longest first: the longer a bridge, the less it turns.
constexpr double kPartsOfStep[] = {0.5, 0.3, 0.1};

std::optional<Bridge> FindBridge(std::vector<WPoint> const& points,
                                 std::vector<Piece> const& pieces) {
  if (pieces.size() > 1) {
    std::vector<WPoint> const near = PointsAtSeam(points, pieces);
    double const largest =
        std::max(kLargestRelative, WorstOf(near, {pieces.front(), pieces.back()}));
    for (double const part : kPartsOfStep) {
      std::optional<Bridge> const bridge = BridgeOver(points, pieces, part);
      if (bridge && WorstOf(near, {bridge->last, bridge->line, bridge->first}) <= largest) {
        return bridge;
      }
    }
  }
  Bridge const shortest = {pieces.back(), MakeLine(pieces.back().end, pieces.front().start),
                           pieces.front()};
  if (IsAtSeam(shortest.line, points.front())) return shortest;
  return {};
}

bool CloseWithOneMore(std::vector<WPoint> const& points, std::vector<Piece>* pieces) {
  std::optional<Bridge> const bridge = FindBridge(points, *pieces);
  if (!bridge) return false;
  pieces->front() = bridge->first;
  if (pieces->size() > 1) pieces->back() = bridge->last;
  pieces->push_back(bridge->line);
  return true;
}

bool CloseInOnePoint(std::vector<WPoint> const& points, std::vector<Piece>* pieces) {
  if (pieces->size() < 2) return false;
  std::vector<WPoint> const near = PointsAtSeam(points, *pieces);
  // Only where the end pieces stand for all of them may the others lend a hand.
  std::vector<Piece> const ends = {pieces->front(), pieces->back()};
  double least = std::max(kLargestRelative, WorstOf(near, ends));
  std::optional<std::vector<Piece>> best;
  for (XY const& place : PlacesToTry(points.front(), ends.front(), ends.back())) {
    std::vector<Piece> const moved = {Moved(ends.front(), place, ends.front().end),
                                      Moved(ends.back(), ends.back().start, place)};
    if (!IsAlike(moved.front(), ends.front()) || !IsAlike(moved.back(), ends.back())) continue;
    double const worst = WorstOf(near, moved);
    if (!(worst <= least) || (best && worst == least)) continue;
    least = worst;
    best = moved;
  }
  if (!best) return false;
  pieces->front() = best->front();
  pieces->back() = best->back();
  return true;
}

}  // namespace

bool CloseExactly(std::vector<WPoint> const& points, std::vector<Piece>* pieces) {
  if (GapOf(*pieces) == 0.0) return true;
  return CloseInOnePoint(points, pieces) || CloseWithOneMore(points, pieces);
}

double GapOf(std::vector<Piece> const& pieces) {
  XY const& start = pieces.front().start;
  XY const& end = pieces.back().end;
  return std::hypot(end.x - start.x, end.y - start.y);
}

}  // namespace Vorn::IO
