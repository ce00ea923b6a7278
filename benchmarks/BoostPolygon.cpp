// Headers within this release of Boost.Geometry include deprecated ones of its own.
#define BOOST_ALLOW_DEPRECATED_HEADERS
#include <boost/geometry/algorithms/intersects.hpp>
#include <boost/geometry/geometries/point_xy.hpp>
#include <boost/geometry/geometries/ring.hpp>
#include <boost/geometry/strategies/strategies.hpp>

#include "benchmarks/OtherPolygons.h"

namespace Vorn::Benchmarks {
namespace {

using Ring = boost::geometry::model::ring<boost::geometry::model::d2::point_xy<double>>;

class BoostPolygon : public OtherPolygon {
 public:
  explicit BoostPolygon(Vertices const& vertices) {
    for (auto const& p : vertices) ring_.emplace_back(p.x, p.y);
    ring_.emplace_back(vertices.front().x, vertices.front().y);
  }

  bool IsSimple() const override { return !boost::geometry::intersects(ring_); }

 private:
  Ring ring_;
};

}  // namespace

std::unique_ptr<OtherPolygon> MakeBoostPolygon(Vertices const& vertices) {
  return std::make_unique<BoostPolygon>(vertices);
}

}  // namespace Vorn::Benchmarks
