#include <geos_c.h>

#include "benchmarks/OtherPolygons.h"

namespace Vorn::Benchmarks {
namespace {

class GeosPolygon : public OtherPolygon {
 public:
  explicit GeosPolygon(Vertices const& vertices) : context_(GEOS_init_r()) {
    auto const count = static_cast<unsigned>(vertices.size());
    GEOSCoordSequence* const coords = GEOSCoordSeq_create_r(context_, count + 1, 2);
    for (unsigned i = 0; i <= count; ++i) {
      auto const& p = vertices[i % count];
      GEOSCoordSeq_setXY_r(context_, coords, i, p.x, p.y);
    }
    ring_ = GEOSGeom_createLinearRing_r(context_, coords);
  }

  ~GeosPolygon() override {
    GEOSGeom_destroy_r(context_, ring_);
    GEOS_finish_r(context_);
  }

  bool IsSimple() const override { return GEOSisSimple_r(context_, ring_) == 1; }

 private:
  GEOSContextHandle_t context_;
  GEOSGeometry* ring_ = nullptr;
};

}  // namespace

std::unique_ptr<OtherPolygon> MakeGeosPolygon(Vertices const& vertices) {
  return std::make_unique<GeosPolygon>(vertices);
}

}  // namespace Vorn::Benchmarks
