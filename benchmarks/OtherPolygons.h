#pragma once

#include <memory>
#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn::Benchmarks {

/// A closed polygon in the form that another library wants; making it is not timed.
class OtherPolygon {
 public:
  OtherPolygon() = default;
  virtual ~OtherPolygon() = default;
  OtherPolygon(OtherPolygon const&) = delete;
  OtherPolygon& operator=(OtherPolygon const&) = delete;

  /// Whether its boundary neither crosses nor touches itself.
  virtual bool IsSimple() const = 0;
};

using Vertices = std::vector<GeometryUtils::Point>;

/// boost::geometry::intersects of a ring with itself.
std::unique_ptr<OtherPolygon> MakeBoostPolygon(Vertices const& vertices);

/// CGAL::Polygon_2::is_simple, with exact predicates.
std::unique_ptr<OtherPolygon> MakeCgalPolygon(Vertices const& vertices);

/// GEOSisSimple of a linear ring.
std::unique_ptr<OtherPolygon> MakeGeosPolygon(Vertices const& vertices);

}  // namespace Vorn::Benchmarks
