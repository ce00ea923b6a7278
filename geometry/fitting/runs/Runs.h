// Runs of measured points, and the ends that a piece fitted to a run must keep to.

#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn::Fitting {

using Point = GeometryUtils::Point;

/// A measured point without its tolerance.
inline Point ToPoint(WPoint const& p) { return {p.x, p.y}; }

/// Consecutive measured points: points[first] .. points[first + count - 1]. It may be asked of a
/// run whether it exists; everything else needs a run that does.
struct Run {
  std::vector<WPoint> const& points;
  std::int32_t first = 0;
  std::int32_t count = 0;

  /// Whether all of its points exist. An empty run at a valid start does; sums are taken in 64
  /// bits, so no count overflows.
  bool Exists() const {
    return first >= 0 && count >= 0 &&
           static_cast<std::uint64_t>(first) + static_cast<std::uint64_t>(count) <= points.size();
  }

  /// The measured point at a position within the run, 0 for the first.
  WPoint const& operator[](std::int32_t position) const {
    return points[static_cast<std::size_t>(first) + static_cast<std::size_t>(position)];
  }

  /// The same without its tolerance.
  Point PointAt(std::int32_t position) const { return ToPoint((*this)[position]); }

  /// The first point of a run that is not empty.
  Point FirstPoint() const { return PointAt(0); }

  /// The last point of a run that is not empty.
  Point LastPoint() const { return PointAt(count - 1); }

  /// The run over the same first point with another count.
  Run OfCount(std::int32_t otherCount) const { return {points, first, otherCount}; }
};

/// The run over all points.
inline Run RunOverAll(std::vector<WPoint> const& points) {
  return {points, 0, static_cast<std::int32_t>(points.size())};
}

/// The ends of a piece. A free end is placed near the run's own end point; a fixed one is a point
/// that the piece must begin or end at exactly.
struct Ends {
  /// Nothing for a free start.
  std::optional<Point> fixedStart;
  /// Nothing for a free end.
  std::optional<Point> fixedEnd;
};

/// An end as the interface passes it: a point that counts only when the flag is set.
inline std::optional<Point> FixedIf(bool isFixed, Point const& p) {
  return isFixed ? std::optional<Point>(p) : std::nullopt;
}

/// An arc needs three points; fewer do not turn.
inline constexpr std::int32_t kFewestArcPoints = 3;

}  // namespace Vorn::Fitting
