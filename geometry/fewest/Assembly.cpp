#include "geometry/fewest/Assembly.h"

#include <algorithm>
#include <cmath>

#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Turn.h"

namespace Vorn::Fewest {

namespace {

using Elem = GeometryUtils::Elem;
using Point = GeometryUtils::Point;

double Cross(Point const& a, Point const& b) { return a.x * b.y - a.y * b.x; }
double Dot(Point const& a, Point const& b) { return a.x * b.x + a.y * b.y; }
Point Minus(Point const& a, Point const& b) { return {a.x - b.x, a.y - b.y}; }
double Length(Point const& a) { return std::sqrt(Dot(a, a)); }

/// Radii above this multiple of the chord have no centre that a double could place: the arc bulges
/// less than the rounding of its ends.
constexpr double kFlattest = 1e12;

/// Whether the direction from the centre to a point lies within the sweep of the arc.
bool IsBeside(BuiltPiece const& piece, Point const& p) {
  Elem const& arc = piece.elem;
  double const sign = arc.direction;
  Point const toStart = Minus(piece.start, arc.center);
  Point const toEnd = Minus(arc.end, arc.center);
  bool const isAfterStart = sign * Cross(toStart, Minus(p, piece.start)) >= 0.0;
  bool const isBeforeEnd = sign * Cross(toEnd, Minus(p, arc.end)) <= 0.0;
  bool const isMinor = sign * Cross(toStart, Minus(arc.end, piece.start)) >= 0.0;
  return isMinor ? isAfterStart && isBeforeEnd : isAfterStart || isBeforeEnd;
}

double DistanceToSegment(Point const& a, Point const& b, Point const& p) {
  Point const along = Minus(b, a);
  Point const to = Minus(p, a);
  double const length2 = Dot(along, along);
  double const share = Dot(to, along);
  if (!(share > 0.0)) return Length(to);
  if (!(share < length2)) return Length(Minus(p, b));
  return std::fabs(Cross(along, to)) / std::sqrt(length2);
}

/// Distance from the circle of an arc, computed from the start and not from the centre, which lies
/// far away where the arc is flat.
double DistanceToCircle(BuiltPiece const& piece, Point const& p) {
  Elem const& arc = piece.elem;
  double const a = 0.5 / arc.radius;
  Point const outwards = Minus(piece.start, arc.center);
  Point const to = Minus(p, piece.start);
  double const f = a * Dot(to, to) + Dot(outwards, to) / arc.radius;
  return std::fabs(DistanceOf(a, f));
}

}  // namespace

BuiltPiece BuildSegment(Point const& start, Point const& end) {
  Elem segment;
  segment.type = GeometryUtils::ElemType::Segment;
  segment.end = end;
  return {start, segment};
}

BuiltPiece BuildArc(Point const& start, Point const& end, Point const& centre, double direction) {
  Elem arc;
  arc.type = GeometryUtils::ElemType::Arc;
  arc.end = end;
  arc.center = centre;
  Point const radial = Minus(start, centre);
  // Scaled, since the squares of very small or very large lengths are no doubles.
  double const scale = ScaleOf(std::max(std::fabs(radial.x), std::fabs(radial.y)));
  arc.radius = Length({radial.x * scale, radial.y * scale}) / scale;
  arc.direction = direction;
  arc.startAngle = std::atan2(start.y - centre.y, start.x - centre.x);
  arc.endAngle = std::atan2(end.y - centre.y, end.x - centre.x);
  return {start, arc};
}

namespace {

/// The middle of a chord and the unit vector to the left of it; 0 for a chord of no length.
struct Bisector {
  Point middle;
  Point normal;

  Bisector(Point const& start, Point const& end)
      : middle{0.5 * (start.x + end.x), 0.5 * (start.y + end.y)} {
    Point chord = Minus(end, start);
    // Scaled, since the squares of very small or very large lengths are no doubles.
    double const scale = ScaleOf(std::max(std::fabs(chord.x), std::fabs(chord.y)));
    chord = {chord.x * scale, chord.y * scale};
    double const length = Length(chord);
    if (length > 0.0) normal = {-chord.y / length, chord.x / length};
  }
  /// The place on it at a height above the chord.
  Point At(double height) const {
    return {middle.x + height * normal.x, middle.y + height * normal.y};
  }
};

}  // namespace

BuiltPiece BuildArcNear(Point const& start, Point const& end, Point const& centre,
                        double direction) {
  Bisector const bisector(start, end);
  double const height = Dot(Minus(centre, bisector.middle), bisector.normal);
  bool const hasChord = bisector.normal.x != 0.0 || bisector.normal.y != 0.0;
  return BuildArc(start, end, hasChord ? bisector.At(height) : centre, direction);
}

BuiltPiece BuildAlong(PlacedCircle const& circle, Point const& start, Point const& end) {
  double const length = Length(Minus(end, start));
  if (!(std::fabs(circle.about.a) * length * kFlattest > 1.0)) return BuildSegment(start, end);
  Bisector const bisector(start, end);
  Place const gradient = GradientAt(circle, {bisector.middle.x, bisector.middle.y});
  // The centre is where the gradient vanishes: at middle - gradient / (2 a).
  double const height = -Dot({gradient.x, gradient.y}, bisector.normal) / (2.0 * circle.about.a);
  return BuildArc(start, end, bisector.At(height), circle.about.a > 0.0 ? -1.0 : 1.0);
}

double DistanceToPiece(BuiltPiece const& piece, WPoint const& p) {
  Point const at{p.x, p.y};
  if (piece.elem.type == GeometryUtils::ElemType::Segment) {
    return DistanceToSegment(piece.start, piece.elem.end, at);
  }
  if (IsBeside(piece, at)) return DistanceToCircle(piece, at);
  return std::min(Length(Minus(at, piece.start)), Length(Minus(at, piece.elem.end)));
}

PieceDeviation MeasurePiece(Path const& path, BuiltPiece const& piece, std::int32_t first,
                            std::int32_t end) {
  PieceDeviation largest;
  for (std::int32_t i = first; i < end; ++i) {
    double const value = DistanceToPiece(piece, path.At(i)) / path.At(i).w;
    if (value > largest.value || largest.index < 0) largest = {value, i};
  }
  return largest;
}

namespace {

Point Nearest(PlacedCircle const& circle, WPoint const& p) {
  Place const at{p.x, p.y};
  Place const gradient = GradientAt(circle, at);
  double const length = std::sqrt(gradient.x * gradient.x + gradient.y * gradient.y);
  double const distance = DistanceOf(circle.about.a, ValueAt(circle, at));
  if (!(length > 0.0)) return {p.x, p.y};
  return {p.x - distance * gradient.x / length, p.y - distance * gradient.y / length};
}

/// Points at an end of the path that noise may have put in another order.
constexpr std::int32_t kPointsAtEnd = 4;

/// The end of a piece at the end of the path: beside the point that lies farthest along it.
/// `step` is +1 for the start of the path and -1 for its end.
Point FreeEnd(Path const& path, ChainPiece const& piece, std::int32_t step) {
  std::int32_t const outermost = step > 0 ? piece.first : piece.end - 1;
  Point end = Nearest(piece.circle, path.At(outermost));
  std::int32_t const count = std::min(kPointsAtEnd, piece.end - piece.first);
  for (std::int32_t k = 1; k < count; ++k) {
    Point const other = Nearest(piece.circle, path.At(outermost + k * step));
    Place const gradient = GradientAt(piece.circle, {end.x, end.y});
    // The direction of travel is the gradient turned to the right.
    double const ahead = gradient.y * (other.x - end.x) - gradient.x * (other.y - end.y);
    if (ahead * step < 0.0) end = other;
  }
  return end;
}

}  // namespace

namespace {

/// Draws back the ends of a single piece that would be a full turn, each by as much as its point
/// allows beside the deviation that it has.
void DrawBack(Path const& path, ChainPiece const& piece, Point* start, Point* end) {
  auto const drawn = [&](Point const& at, WPoint const& p, double sense) {
    double const e = DistanceOf(piece.circle.about.a, ValueAt(piece.circle, {p.x, p.y})) / p.w;
    double const room = e * e < 1.0 ? 0.5 * p.w * std::sqrt(1.0 - e * e) : 0.0;
    Place const gradient = GradientAt(piece.circle, {at.x, at.y});
    Point const moved{at.x + sense * room * gradient.y, at.y - sense * room * gradient.x};
    return Nearest(piece.circle, {moved.x, moved.y, p.w});
  };
  *start = drawn(*start, path.At(piece.first), 1.0);
  *end = drawn(*end, path.At(piece.end - 1), -1.0);
}

/// An end of the chain: its fixed place, or beside the outermost points.
Point EndOf(Path const& path, Opening const& opening, ChainPiece const& piece, std::int32_t step) {
  if (opening.isFree) return FreeEnd(path, piece, step);
  Place const place = PlaceOn(opening.gate, opening.low);
  return {place.x, place.y};
}

/// A turn from which on the ends of a piece may meet.
constexpr double kNearFullTurn = 6.0;

/// The angle that the points of a piece turn about its centre.
double TurnOf(Path const& path, ChainPiece const& piece) {
  Turn turn(piece.circle.about);
  Place const& origin = piece.circle.origin;
  for (std::int32_t i = piece.first; i < piece.end; ++i) {
    turn.Add({path.At(i).x - origin.x, path.At(i).y - origin.y});
  }
  return turn.Angle();
}

}  // namespace

std::vector<BuiltPiece> BuildPieces(Path const& path, Chain const& chain) {
  std::vector<BuiltPiece> pieces;
  if (chain.pieces.empty()) return pieces;
  Point start = EndOf(path, path.start, chain.pieces.front(), 1);
  Point finish = EndOf(path, path.finish, chain.pieces.back(), -1);
  if (path.start.isFree && chain.pieces.size() == 1 &&
      TurnOf(path, chain.pieces.front()) > kNearFullTurn) {
    DrawBack(path, chain.pieces.front(), &start, &finish);
  }
  for (std::size_t k = 0; k < chain.pieces.size(); ++k) {
    ChainPiece const& piece = chain.pieces[k];
    Point end;
    if (k + 1 == chain.pieces.size()) {
      end = finish;
    } else {
      Place const joint = PlaceOn(chain.gates[k], chain.offsets[k]);
      end = {joint.x, joint.y};
    }
    BuiltPiece built = BuildSegment(start, end);
    // Of a line rounding may leave an arc far flatter than what is asked for.
    bool const isFlat = 4.0 * std::fabs(piece.circle.about.a) * path.limits.largestRadius < 1.0;
    if (!isFlat && MeasurePiece(path, built, piece.first, piece.end).value > 1.0) {
      built = BuildAlong(piece.circle, start, end);
    }
    pieces.push_back(built);
    start = end;
  }
  return pieces;
}

}  // namespace Vorn::Fewest
