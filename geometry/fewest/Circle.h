#pragma once

#include <cmath>

/// Circles and lines as four coefficients in which "within tolerance" is linear; the coordinates of
/// Lie sphere geometry without the sign of the radius (pencils of circles, Pedoe 1957).
namespace Vorn::Fewest {

/// The circle or line f(p) = a |p|^2 + bx x + by y + d = 0. With Form(c, c) = 1 the signed distance
/// e of p fulfils f = e + a e^2, so that |e| <= w is |f - a w^2| <= w for every w up to the radius
/// 1 / |2 a|. A line has a = 0 and needs no case of its own. f grows to the left of the direction
/// in which the path runs.
struct Circle {
  double a = 0.0;
  double bx = 0.0;
  double by = 0.0;
  double d = 0.0;
};

/// The bilinear form whose value Form(c, c) = |b|^2 - 4 a d is the squared gradient on the circle.
inline double Form(Circle const& c, Circle const& o) {
  return c.bx * o.bx + c.by * o.by - 2.0 * (c.a * o.d + c.d * o.a);
}

/// The circle times a factor: the same curve.
inline Circle Scaled(Circle const& c, double factor) {
  return {c.a * factor, c.bx * factor, c.by * factor, c.d * factor};
}

/// first + share (second - first), coefficient by coefficient.
inline Circle Between(Circle const& first, Circle const& second, double share) {
  return {first.a + share * (second.a - first.a), first.bx + share * (second.bx - first.bx),
          first.by + share * (second.by - first.by), first.d + share * (second.d - first.d)};
}

/// A place of the plane in local coordinates.
struct Place {
  double x = 0.0;
  double y = 0.0;
};

/// A normalised circle in the coordinates of the path, with coefficients about an origin near its
/// points. About an origin that is s away d is of the order of a s^2, and its rounding exceeds what
/// small tolerances on long paths leave.
struct PlacedCircle {
  Circle about;
  Place origin;
};

/// The line from one place to another; a line along x for places that coincide.
inline Circle LineThrough(Place const& p, Place const& q) {
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  double const length = std::sqrt(dx * dx + dy * dy);
  if (!(length > 0.0)) return {0.0, 0.0, 1.0, -p.y};
  Circle line{0.0, -dy / length, dx / length, 0.0};
  line.d = -(line.bx * p.x + line.by * p.y);
  return line;
}

/// f at a place.
inline double ValueAt(Circle const& c, Place const& p) {
  return c.a * (p.x * p.x + p.y * p.y) + c.bx * p.x + c.by * p.y + c.d;
}

/// Gradient of f at a place: the left normal of the path there, of length 1 on a normalised circle.
inline Place GradientAt(Circle const& c, Place const& p) {
  return {2.0 * c.a * p.x + c.bx, 2.0 * c.a * p.y + c.by};
}

/// The placed circle times a factor: the same curve.
inline PlacedCircle Scaled(PlacedCircle const& c, double factor) {
  return {Scaled(c.about, factor), c.origin};
}

/// f of a placed circle at a place of the path.
inline double ValueAt(PlacedCircle const& c, Place const& p) {
  return ValueAt(c.about, Place{p.x - c.origin.x, p.y - c.origin.y});
}

/// The gradient of a placed circle at a place of the path.
inline Place GradientAt(PlacedCircle const& c, Place const& p) {
  return GradientAt(c.about, Place{p.x - c.origin.x, p.y - c.origin.y});
}

/// Signed distance of a place with value f from a normalised circle of coefficient a, without the
/// centre, which lies far away for flat arcs. A value beyond the centre gives the radius.
inline double DistanceOf(double a, double f) {
  double const root = 1.0 + 4.0 * a * f;
  return 2.0 * f / (1.0 + (root > 0.0 ? std::sqrt(root) : 0.0));
}

}  // namespace Vorn::Fewest
