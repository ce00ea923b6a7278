#pragma once

// Headers within this release of Boost.Geometry include deprecated ones of its own.
#define BOOST_ALLOW_DEPRECATED_HEADERS
#include <boost/geometry/algorithms/intersects.hpp>
#include <boost/geometry/geometries/point_xy.hpp>
#include <boost/geometry/geometries/segment.hpp>
#undef BOOST_ALLOW_DEPRECATED_HEADERS

#include "vorn/GeometryUtils.h"

/// Crossings of segments by a geometry library, for comparison.
namespace Vorn::Testing {

struct GridSegment {
  GeometryUtils::Point start;
  GeometryUtils::Point end;
};

/// Do two segments between small whole-number points meet, and not on parallel lines?
///
/// Documented difference from a plain geometry library: parallel segments never count, whether they
/// overlap or touch end to end.
inline bool MeetAtAnAngle(GridSegment const& first, GridSegment const& second) {
  auto const cross = (first.end.x - first.start.x) * (second.end.y - second.start.y) -
                     (first.end.y - first.start.y) * (second.end.x - second.start.x);
  if (cross == 0.0) return false;
  using BoostPoint = boost::geometry::model::d2::point_xy<double>;
  using BoostSegment = boost::geometry::model::segment<BoostPoint>;
  auto const toBoost = [](GridSegment const& s) {
    return BoostSegment({s.start.x, s.start.y}, {s.end.x, s.end.y});
  };
  return boost::geometry::intersects(toBoost(first), toBoost(second));
}

}  // namespace Vorn::Testing
