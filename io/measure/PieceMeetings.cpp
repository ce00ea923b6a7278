#include "io/measure/PieceMeetings.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "io/pieces/Turning.h"
#include "vorn/GeometryUtils.h"
#include "vorn/io/Deviations.h"

namespace Vorn::IO {

namespace {

constexpr double kFullTurn = 2.0 * std::numbers::pi;

/// Sines of the angle between directions below this make a tangent: what is left of an exact one
/// after coordinates with nine digits.
constexpr double kTangentSine = 1e-7;

XY Minus(XY const& a, XY const& b) { return {a.x - b.x, a.y - b.y}; }

double Cross(XY const& a, XY const& b) { return a.x * b.y - a.y * b.x; }

double Dot(XY const& a, XY const& b) { return a.x * b.x + a.y * b.y; }

bool IsOn(Piece const& piece, XY const& point, double tolerance) {
  return DistanceTo(piece, point.x, point.y) <= tolerance;
}

/// Collects the places of two pieces, each once.
class Places {
 public:
  Places(Piece const& a, Piece const& b, double tolerance) : a_(a), b_(b), tolerance_(tolerance) {}

  void Add(XY const& point) {
    auto const isHere = [&](XY const& other) { return Distance(other, point) <= tolerance_; };
    if (std::none_of(points_.begin(), points_.end(), isHere)) points_.push_back(point);
  }

  void AddIfOnBoth(XY const& point) {
    if (IsOn(a_, point, tolerance_) && IsOn(b_, point, tolerance_)) Add(point);
  }

  /// The ends first: they are known exactly, and what is found near them is the same place.
  void AddEnds() {
    for (XY const& end : {a_.start, a_.end}) {
      if (IsOn(b_, end, tolerance_)) Add(end);
    }
    for (XY const& end : {b_.start, b_.end}) {
      if (IsOn(a_, end, tolerance_)) Add(end);
    }
  }

  std::vector<XY> const& Points() const { return points_; }

 private:
  Piece const& a_;
  Piece const& b_;
  double tolerance_;
  std::vector<XY> points_;
};

/// Seen from the start of the first line: the library compares lines by products of coordinates.
void AddLineCrossing(Piece const& a, Piece const& b, Places* places) {
  XY const origin = a.start;
  XY const end = Minus(a.end, origin);
  XY const from = Minus(b.start, origin);
  XY const to = Minus(b.end, origin);
  XY at;
  if (GeometryUtils::GetLineSegmentsIntersection(0.0, 0.0, end.x, end.y, from.x, from.y, to.x, to.y,
                                                 &at.x,
                                                 &at.y) == SegmentsRelPosition::Intersecting) {
    places->AddIfOnBoth({origin.x + at.x, origin.y + at.y});
  }
}

void AddLineAndArc(Piece const& line, Piece const& arc, double tolerance, Places* places) {
  XY const along = {(line.end.x - line.start.x) / line.length,
                    (line.end.y - line.start.y) / line.length};
  XY const toCenter = Minus(arc.center, line.start);
  double const middle = Dot(toCenter, along);
  double const offset = Cross(along, toCenter);
  auto const at = [&](double position) {
    return XY{line.start.x + position * along.x, line.start.y + position * along.y};
  };
  double const depth = arc.radius - std::fabs(offset);
  if (depth < -tolerance) return;
  if (depth <= tolerance) return places->AddIfOnBoth(at(middle));
  double const half = std::sqrt(depth * (arc.radius + std::fabs(offset)));
  places->AddIfOnBoth(at(middle - half));
  places->AddIfOnBoth(at(middle + half));
}

bool AreOnOneCircle(Piece const& a, Piece const& b, double tolerance) {
  return a.IsArc() && b.IsArc() && Distance(a.center, b.center) <= tolerance &&
         std::fabs(a.radius - b.radius) <= tolerance;
}

void AddArcs(Piece const& a, Piece const& b, double tolerance, Places* places) {
  Piece const& large = a.radius >= b.radius ? a : b;
  Piece const& small = a.radius >= b.radius ? b : a;
  XY const between = Minus(small.center, large.center);
  double const distance = std::hypot(between.x, between.y);
  if (distance <= tolerance) return;
  double const outside = distance - (large.radius + small.radius);
  double const inside = (large.radius - small.radius) - distance;
  if (outside > tolerance || inside > tolerance) return;
  XY const unit = {between.x / distance, between.y / distance};
  auto const at = [&](double along, double across) {
    return XY{large.center.x + along * unit.x - across * unit.y,
              large.center.y + along * unit.y + across * unit.x};
  };
  if (outside >= -tolerance || inside >= -tolerance) {
    return places->AddIfOnBoth(at(large.radius, 0.0));
  }
  double const difference = (large.radius - small.radius) * (large.radius + small.radius);
  double const along = 0.5 * (distance + difference / distance);
  double const across = std::sqrt(std::max(0.0, (large.radius - along) * (large.radius + along)));
  places->AddIfOnBoth(at(along, across));
  places->AddIfOnBoth(at(along, -across));
}

bool IsTangent(Piece const& a, Piece const& b, XY const& point) {
  XY const alongA = DirectionAt(a, PositionOn(a, point));
  XY const alongB = DirectionAt(b, PositionOn(b, point));
  return std::fabs(Cross(alongA, alongB)) <= kTangentSine;
}

/// Sorts the places along `a` and joins those between which `a` runs on `b`.
std::vector<Meeting> Joined(Piece const& a, Piece const& b, double tolerance,
                            std::vector<XY> points) {
  std::sort(points.begin(), points.end(), [&a](XY const& one, XY const& other) {
    return PositionOn(a, one) < PositionOn(a, other);
  });
  bool const mayRunTogether = (!a.IsArc() && !b.IsArc()) || AreOnOneCircle(a, b, tolerance);
  auto const runsOn = [&](XY const& from, XY const& to) {
    double const middle = 0.5 * (PositionOn(a, from) + PositionOn(a, to));
    XY const onLine = {0.5 * (from.x + to.x), 0.5 * (from.y + to.y)};
    return IsOn(b, a.IsArc() ? PointOnArc(a, middle / a.radius) : onLine, tolerance);
  };
  std::vector<Meeting> meetings;
  for (std::size_t i = 0; i < points.size(); ++i) {
    if (mayRunTogether && i + 1 < points.size() && runsOn(points[i], points[i + 1])) {
      meetings.push_back({points[i], points[i + 1], true});
      // A stretch may end where the next one begins, but not in a place of its own.
      bool const goesOn = i + 2 < points.size() && runsOn(points[i + 1], points[i + 2]);
      if (!goesOn) ++i;
    } else {
      meetings.push_back({points[i], {}, IsTangent(a, b, points[i])});
    }
  }
  return meetings;
}

}  // namespace

std::vector<Meeting> MeetingsOf(Piece const& a, Piece const& b, double tolerance) {
  Places places(a, b, tolerance);
  places.AddEnds();
  if (!a.IsArc() && !b.IsArc()) {
    AddLineCrossing(a, b, &places);
  } else if (!a.IsArc()) {
    AddLineAndArc(a, b, tolerance, &places);
  } else if (!b.IsArc()) {
    AddLineAndArc(b, a, tolerance, &places);
  } else if (!AreOnOneCircle(a, b, tolerance)) {
    AddArcs(a, b, tolerance, &places);
  }
  return Joined(a, b, tolerance, places.Points());
}

double PositionOn(Piece const& piece, XY const& point) {
  if (piece.IsArc()) {
    double const turn = TurnTo(piece, point.x, point.y);
    // Beyond the end: the nearer end, which for a point on the arc is off by rounding only.
    if (turn > piece.sweep) {
      return turn - piece.sweep < kFullTurn - turn ? piece.length : 0.0;
    }
    return turn * piece.radius;
  }
  XY const along = Minus(piece.end, piece.start);
  double const part = Dot(Minus(point, piece.start), along) / Dot(along, along);
  return std::clamp(part, 0.0, 1.0) * piece.length;
}

XY DirectionAt(Piece const& piece, double position) {
  if (!piece.IsArc()) {
    return {(piece.end.x - piece.start.x) / piece.length,
            (piece.end.y - piece.start.y) / piece.length};
  }
  double const turn = position / piece.radius;
  double const polar = piece.startAngle + (piece.counterClockwise ? turn : -turn);
  double const sign = piece.counterClockwise ? 1.0 : -1.0;
  return {-sign * std::sin(polar), sign * std::cos(polar)};
}

}  // namespace Vorn::IO
