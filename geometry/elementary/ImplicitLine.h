// Lines as a*x + b*y + c = 0, known as the implicit form. They are never normalised: the raw
// coefficients decide exact comparisons (parallel segments), and a division would spoil them.

#pragma once

#include <cmath>
#include <optional>

#include "geometry/elementary/Points.h"
#include "math/NumericConstants.h"

namespace Vorn::Elementary {

/// The line a*x + b*y + c = 0, not normalised.
struct ImplicitLine {
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;

  /// The left side of the equation at a point: the signed distance times the length of (a, b).
  double At(Point const& p) const { return a * p.x + b * p.y + c; }

  /// The length of (a, b).
  double Norm() const { return std::sqrt(a * a + b * b); }

  /// The length of (a, b), with the sign that makes the origin's deviation At({0, 0}) /
  /// SignedNorm() no greater than zero.
  double SignedNorm() const { return c > 0.0 ? -Norm() : Norm(); }

  /// The perpendicular through a point; c is not needed for it.
  ImplicitLine NormalThrough(Point const& p) const { return {b, -a, a * p.y - b * p.x}; }
};

/// The line through two points; nothing where they coincide.
inline std::optional<ImplicitLine> LineThrough(Point const& p, Point const& q) {
  if (Numeric::IsZeroMagnitude(p.x - q.x) && Numeric::IsZeroMagnitude(p.y - q.y)) {
    return std::nullopt;
  }
  return ImplicitLine{p.y - q.y, q.x - p.x, p.x * q.y - p.y * q.x};
}

/// The line of all points equally far from two others; nothing where they coincide.
inline std::optional<ImplicitLine> PerpendicularBisector(Point const& p, Point const& q) {
  std::optional<ImplicitLine> const line = LineThrough(p, q);
  if (!line) return std::nullopt;
  return line->NormalThrough(Middle(p, q));
}

}  // namespace Vorn::Elementary
