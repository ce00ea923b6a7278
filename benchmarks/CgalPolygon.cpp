#include <CGAL/Exact_predicates_inexact_constructions_kernel.h>
#include <CGAL/Polygon_2.h>

#include "benchmarks/OtherPolygons.h"

namespace Vorn::Benchmarks {
namespace {

using Kernel = CGAL::Exact_predicates_inexact_constructions_kernel;

class CgalPolygon : public OtherPolygon {
 public:
  explicit CgalPolygon(Vertices const& vertices) {
    for (auto const& p : vertices) polygon_.push_back(Kernel::Point_2(p.x, p.y));
  }

  bool IsSimple() const override { return polygon_.is_simple(); }

 private:
  CGAL::Polygon_2<Kernel> polygon_;
};

}  // namespace

std::unique_ptr<OtherPolygon> MakeCgalPolygon(Vertices const& vertices) {
  return std::make_unique<CgalPolygon>(vertices);
}

}  // namespace Vorn::Benchmarks
