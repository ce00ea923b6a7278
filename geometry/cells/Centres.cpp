#include "geometry/cells/Centres.h"

#include <vector>

#include "geometry/triangles/Overlap.h"

namespace Vorn::Cells {

void CentreSums::Add(TriangleCentre const& triangle) {
  auto const& [own, centre] = triangle;
  if (IsDegenerate(triangle)) {
    degenerate.x += centre.x;
    degenerate.y += centre.y;
    ++degenerateCount;
  } else {
    area += own;
    weighted.x += centre.x * own;
    weighted.y += centre.y * own;
  }
}

Point CentreSums::Centre() const {
  if (HasArea()) return {weighted.x / area, weighted.y / area};
  if (degenerateCount == 0) return weighted;
  auto const count = static_cast<double>(degenerateCount);
  return {degenerate.x / count, degenerate.y / count};
}

std::optional<Point> CentreOf(std::span<Triangle const> cell) {
  if (cell.empty()) return std::nullopt;
  CentreSums sums;
  for (Triangle const& triangle : cell) sums.Add(Triangles::CentreOf(triangle));
  return sums.Centre();
}

std::optional<Point> PlainCell::CentreOfOverlapWith(Triangle const& candidate) const {
  std::vector<Triangle> overlap;
  Triangles::AppendOverlaps(candidate, triangles, &overlap);
  return CentreOf(overlap);
}

}  // namespace Vorn::Cells
