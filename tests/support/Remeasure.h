#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <optional>
#include <vector>

#include "vorn/GeometryUtils.h"

/// A fitted contour measured again from nothing but its elements and the points. Formulas of its
/// own in extended precision: nothing of the library is used.
namespace Vorn::Testing {

/// What rounding may add to a relative deviation of 1.
inline constexpr double kWithinTolerance = 1.0 + 1e-9;

struct Remeasured {
  /// Points at which the pieces begin and end: 0 first, the last point reached last.
  std::vector<std::int32_t> joints;
  /// Largest deviation of a point from the line or circle of its piece, relative to its tolerance.
  double largest = 0.0;
  std::int32_t largestIndex = -1;
  /// The same from the pieces as drawn, from whichever is nearest.
  double largestFromDrawn = 0.0;
};

namespace Internal {

using Point = GeometryUtils::Point;
using Elem = GeometryUtils::Elem;

using Real = long double;

struct RealPoint {
  Real x;
  Real y;
};

/// Exact: every double is an extended one.
template <typename AnyPoint>
RealPoint ToReal(AnyPoint const& p) {
  return {static_cast<Real>(p.x), static_cast<Real>(p.y)};
}

inline Real Distance(RealPoint const& p, RealPoint const& q) {
  return std::hypot(p.x - q.x, p.y - q.y);
}

inline bool IsArc(Elem const& elem) { return elem.type == GeometryUtils::ElemType::Arc; }

/// From the whole line or the whole circle.
inline Real DistanceFromCarrier(RealPoint const& p, RealPoint const& start, Elem const& piece) {
  if (IsArc(piece)) {
    return std::fabs(Distance(p, ToReal(piece.center)) - static_cast<Real>(piece.radius));
  }
  RealPoint const end = ToReal(piece.end);
  Real const length = Distance(start, end);
  if (length == 0) return Distance(p, start);
  return std::fabs((end.x - start.x) * (p.y - start.y) - (end.y - start.y) * (p.x - start.x)) /
         length;
}

/// Angle swept from the start of the arc to p in the arc's direction.
inline Real SweepTo(RealPoint const& p, RealPoint const& start, Elem const& arc) {
  Real const turn = 2 * std::acos(Real{-1});
  RealPoint const center = ToReal(arc.center);
  Real sweep = std::atan2(p.y - center.y, p.x - center.x) -
               std::atan2(start.y - center.y, start.x - center.x);
  if (arc.direction < 0) sweep = -sweep;
  while (sweep < 0) sweep += turn;
  return sweep;
}

/// Whether the foot of p lies between the ends of the piece.
inline bool ProjectsInside(RealPoint const& p, RealPoint const& start, Elem const& piece) {
  RealPoint const end = ToReal(piece.end);
  if (IsArc(piece)) return SweepTo(p, start, piece) <= SweepTo(end, start, piece);
  Real const dx = end.x - start.x;
  Real const dy = end.y - start.y;
  Real const along = (p.x - start.x) * dx + (p.y - start.y) * dy;
  return along >= 0 && along <= dx * dx + dy * dy;
}

inline Real DistanceFromDrawn(RealPoint const& p, RealPoint const& start, Elem const& piece) {
  if (ProjectsInside(p, start, piece)) return DistanceFromCarrier(p, start, piece);
  return std::min(Distance(p, start), Distance(p, ToReal(piece.end)));
}

}  // namespace Internal

/// Finds the points at which the pieces meet and measures every point against its piece. Empty when
/// the contour starts away from the first point, when a piece ends within the tolerance of no later
/// point, or when the last piece does not reach the last point: then it does not fit at all.
///
/// A joint is found from its end point alone: neighbours are more than 1.5 times the sum of their
/// tolerances apart, so no end point lies within the tolerances of two of them.
inline std::optional<Remeasured> Remeasure(std::vector<WPoint> const& points,
                                           std::vector<GeometryUtils::Elem> const& contour) {
  using Internal::Real;
  using Internal::ToReal;
  if (contour.size() < 2 || points.empty()) return std::nullopt;
  auto const relative = [&points](Real distance, std::size_t i) {
    return static_cast<double>(distance / static_cast<Real>(points[i].w));
  };
  auto const isAt = [&](GeometryUtils::Point const& end, std::size_t i) {
    return relative(Internal::Distance(ToReal(end), ToReal(points[i])), i) <= kWithinTolerance;
  };
  if (!isAt(contour[0].end, 0)) return std::nullopt;

  Remeasured result;
  result.joints.push_back(0);
  std::size_t joint = 0;
  for (std::size_t k = 1; k < contour.size(); ++k) {
    std::size_t next = joint + 1;
    while (next < points.size() && !isAt(contour[k].end, next)) ++next;
    if (next >= points.size()) return std::nullopt;
    for (std::size_t i = joint; i <= next; ++i) {
      double const deviation = relative(
          Internal::DistanceFromCarrier(ToReal(points[i]), ToReal(contour[k - 1].end), contour[k]),
          i);
      if (!(deviation <= result.largest)) {
        result.largest = deviation;
        result.largestIndex = static_cast<std::int32_t>(i);
      }
    }
    joint = next;
    result.joints.push_back(static_cast<std::int32_t>(joint));
  }
  if (joint + 1 != points.size()) return std::nullopt;

  for (std::size_t i = 0; i < points.size(); ++i) {
    auto const fromPiece = [&](std::size_t k) {
      return Internal::DistanceFromDrawn(ToReal(points[i]), ToReal(contour[k - 1].end), contour[k]);
    };
    Real nearest = fromPiece(1);
    for (std::size_t k = 2; k < contour.size(); ++k) nearest = std::min(nearest, fromPiece(k));
    result.largestFromDrawn = std::max(result.largestFromDrawn, relative(nearest, i));
  }
  return result;
}

/// Number of points of each piece.
inline std::vector<std::int32_t> PieceCounts(Remeasured const& measured) {
  std::vector<std::int32_t> counts;
  for (std::size_t k = 1; k < measured.joints.size(); ++k) {
    counts.push_back(measured.joints[k] - measured.joints[k - 1] + 1);
  }
  return counts;
}

}  // namespace Vorn::Testing
