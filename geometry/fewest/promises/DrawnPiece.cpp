// Distances from a circle. With q = p - start and d = centre - start
//
//   |p - centre|^2 - r^2 = |q|^2 - 2 q d + (|d|^2 - r^2),
//
// of which the last term is computed exactly once for each arc. The deviation is that divided by
// |p - centre| + r. One product and one difference round by 2^-53 each, which makes
// 8 * 2^-53 * (|q|^2 + 2 |q| |d|) in the numerator, so a flat arc loses nothing to its far centre.

#include "geometry/fewest/promises/DrawnPiece.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "geometry/fewest/promises/Expansion.h"

namespace Vorn::Promises {

namespace {

using Point = GeometryUtils::Point;
using Elem = GeometryUtils::Elem;

constexpr double kTurn = 2.0 * std::numbers::pi;
constexpr double kRoundings = 8.0 * kUnitRoundoff;

Point Minus(Point const& a, Point const& b) { return {a.x - b.x, a.y - b.y}; }
double Dot(Point const& a, Point const& b) { return a.x * b.x + a.y * b.y; }
double Cross(Point const& a, Point const& b) { return a.x * b.y - a.y * b.x; }
double Length(Point const& a) { return std::sqrt(Dot(a, a)); }

Expansion SquaredDistance(Point const& a, Point const& b) {
  Expansion const dx = Expansion::Difference(a.x, b.x);
  Expansion const dy = Expansion::Difference(a.y, b.y);
  Expansion sum;
  sum.AddProduct(dx, dx, 1.0);
  sum.AddProduct(dy, dy, 1.0);
  return sum;
}

/// Angle from the start to the direction of start + q, in the sense of the arc, in (-pi, pi].
double AngleTo(DrawnPiece const& arc, Point const& q) {
  Point const& d = arc.toCentre;
  return std::atan2(-arc.sense * Cross(d, q), Dot(d, d) - Dot(d, q));
}

double AngleFromZero(DrawnPiece const& arc, Point const& q) {
  double const angle = AngleTo(arc, q);
  return angle < 0.0 ? angle + kTurn : angle;
}

Place AtStart(DrawnPiece const& piece, Point const& p, double left) {
  double const distance = Length(Minus(p, piece.start));
  return {Beside::Start, 0.0, distance, kRoundings * distance, left};
}

Place AtEnd(DrawnPiece const& piece, Point const& p, double left) {
  double const distance = Length(Minus(p, piece.end));
  return {Beside::End, piece.length, distance, kRoundings * distance, left};
}

Place PlaceBySegment(DrawnPiece const& segment, Point const& p) {
  Point const q = Minus(p, segment.start);
  if (segment.length == 0.0) return AtStart(segment, p, 0.0);
  double const left = Cross(segment.toEnd, q) / segment.length;
  double const along = Dot(segment.toEnd, q) / segment.length;
  double const slack = kRoundings * (std::fabs(q.x) + std::fabs(q.y));
  if (!(along > slack)) return AtStart(segment, p, left);
  if (!(along < segment.length - slack)) return AtEnd(segment, p, left);
  return {Beside::Piece, along, std::fabs(left), slack, left};
}

Place PlaceByArc(DrawnPiece const& arc, Point const& p) {
  Point const q = Minus(p, arc.start);
  Point const& d = arc.toCentre;
  double const fromCentre = Length(Minus(q, d));
  double const q2 = Dot(q, q);
  double const sum = fromCentre + arc.radius;
  double const outside = (q2 - 2.0 * Dot(q, d) + arc.power) / sum;
  double const left = -arc.sense * outside;
  double const angle = AngleFromZero(arc, q);
  double const slack = 16.0 * kUnitRoundoff * (1.0 + angle);
  if (angle > slack && angle < arc.sweep - slack) {
    double const error = kRoundings * (q2 + 2.0 * std::sqrt(q2) * Length(d)) / sum;
    return {Beside::Piece, angle * arc.radius, std::fabs(outside), error, left};
  }
  bool const isNearerToEnd = angle >= slack && angle - arc.sweep <= kTurn - angle;
  return isNearerToEnd ? AtEnd(arc, p, left) : AtStart(arc, p, left);
}

bool IsWithinOfPoint(Point const& end, WPoint const& p) {
  Expansion excess = SquaredDistance({p.x, p.y}, end);
  excess.AddProduct(Expansion(p.w), Expansion(p.w), -1.0);
  return excess.Sign() <= 0;
}

/// |cross|^2 <= w^2 |toEnd|^2
bool IsWithinOfLine(DrawnPiece const& segment, WPoint const& p) {
  Expansion const dx = Expansion::Difference(segment.end.x, segment.start.x);
  Expansion const dy = Expansion::Difference(segment.end.y, segment.start.y);
  Expansion cross;
  cross.AddProduct(dx, Expansion::Difference(p.y, segment.start.y), 1.0);
  cross.AddProduct(dy, Expansion::Difference(p.x, segment.start.x), -1.0);
  Expansion squaredTolerance;
  squaredTolerance.AddProduct(Expansion(p.w), Expansion(p.w), 1.0);
  Expansion excess;
  excess.AddProduct(cross, cross, 1.0);
  excess.AddProduct(squaredTolerance, SquaredDistance(segment.end, segment.start), -1.0);
  return excess.Sign() <= 0;
}

/// r - w <= |p - centre| <= r + w
bool IsWithinOfCircle(DrawnPiece const& arc, WPoint const& p) {
  Expansion const distance2 = SquaredDistance({p.x, p.y}, arc.centre);
  Expansion const outer = Expansion::Difference(arc.radius, -p.w);
  Expansion beyondOuter = distance2;
  beyondOuter.AddProduct(outer, outer, -1.0);
  if (beyondOuter.Sign() > 0) return false;
  Expansion const inner = Expansion::Difference(arc.radius, p.w);
  if (inner.Sign() <= 0) return true;
  Expansion beyondInner = distance2;
  beyondInner.AddProduct(inner, inner, -1.0);
  return beyondInner.Sign() >= 0;
}

}  // namespace

DrawnPiece DrawSegment(Point const& start, Point const& end) {
  DrawnPiece piece;
  piece.start = start;
  piece.end = end;
  piece.toEnd = Minus(end, start);
  piece.length = Length(piece.toEnd);
  return piece;
}

DrawnPiece Draw(Point const& start, Elem const& elem) {
  DrawnPiece piece = DrawSegment(start, elem.end);
  if (elem.type != GeometryUtils::ElemType::Arc) return piece;
  piece.isArc = true;
  piece.centre = elem.center;
  piece.toCentre = Minus(elem.center, start);
  piece.radius = elem.radius;
  piece.sense = elem.direction > 0.0 ? 1.0 : -1.0;
  piece.sweep = AngleFromZero(piece, piece.toEnd);
  piece.power = PowerOf(piece, start);
  piece.length = piece.sweep * piece.radius;
  return piece;
}

double PowerOf(DrawnPiece const& arc, Point const& p) {
  Expansion power = SquaredDistance(p, arc.centre);
  power.AddProduct(Expansion(arc.radius), Expansion(arc.radius), -1.0);
  return power.Value();
}

Place PlaceOf(DrawnPiece const& piece, Point const& p) {
  return piece.isArc ? PlaceByArc(piece, p) : PlaceBySegment(piece, p);
}

Point PointAt(DrawnPiece const& piece, double along) {
  if (!piece.isArc) {
    double const share = piece.length == 0.0 ? 0.0 : along / piece.length;
    return {piece.start.x + share * piece.toEnd.x, piece.start.y + share * piece.toEnd.y};
  }
  // start + (1 - cos) d - sin * sense * (d turned left), with 1 - cos = 2 sin^2 of half the angle.
  double const angle = along / piece.radius;
  double const halfSine = std::sin(0.5 * angle);
  double const lift = 2.0 * halfSine * halfSine;
  double const shift = piece.sense * std::sin(angle);
  Point const& d = piece.toCentre;
  return {piece.start.x + lift * d.x + shift * d.y, piece.start.y + lift * d.y - shift * d.x};
}

double RoundingOf(DrawnPiece const& piece) {
  double const ends = std::max(std::max(std::fabs(piece.start.x), std::fabs(piece.start.y)),
                               std::max(std::fabs(piece.end.x), std::fabs(piece.end.y)));
  double const centre = std::fabs(piece.toCentre.x) + std::fabs(piece.toCentre.y);
  return kRoundings * (ends + centre + piece.radius);
}

bool IsWithin(DrawnPiece const& piece, WPoint const& p, Beside beside) {
  if (beside == Beside::Start) return IsWithinOfPoint(piece.start, p);
  if (beside == Beside::End) return IsWithinOfPoint(piece.end, p);
  return piece.isArc ? IsWithinOfCircle(piece, p) : IsWithinOfLine(piece, p);
}

}  // namespace Vorn::Promises
