#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "support/GridCrossings.h"
#include "vorn/GeometryUtils.h"

/// Flat polylines of straight runs between grid points, and what the check must say of them.
namespace Vorn::Testing {

struct FlatPolyline {
  std::vector<double> coords;
  std::vector<std::int32_t> indices;

  FlatPolyline& Vertex(double x, double y) {
    coords.insert(coords.end(), {x, y});
    return *this;
  }

  FlatPolyline& Record(GeometryUtils::Point const& vertex, GeometryUtils::Point const& center,
                       double radius, double direction, double startAngle, double endAngle) {
    coords.insert(coords.end(), {vertex.x, vertex.y, center.x, center.y, radius, direction,
                                 startAngle, endAngle});
    return *this;
  }

  /// Ends a run at the vertex that comes next; the sign chooses the layout.
  FlatPolyline& EndRunHere(int sign) {
    indices.push_back(sign * static_cast<std::int32_t>(coords.size()));
    return *this;
  }
};

/// Crossings of straight runs, pairs as Boost.Geometry sees them. Documented differences from a
/// plain test for simplicity: parallel pieces never cross; the piece right after is passed over in
/// the same run but not at the joint of two runs; where the polyline closes, the shared vertex
/// counts as a crossing.
inline bool StraightRunsCross(std::vector<double> const& coords,
                              std::vector<std::int32_t> const& indices) {
  std::vector<GridSegment> pieces;
  std::vector<std::size_t> runOf;
  std::size_t offset = 0;
  for (std::size_t run = 0; run < indices.size(); ++run) {
    for (; offset < static_cast<std::size_t>(indices[run]); offset += 2) {
      pieces.push_back(
          {{coords[offset], coords[offset + 1]}, {coords[offset + 2], coords[offset + 3]}});
      runOf.push_back(run);
    }
  }
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    for (std::size_t k = i + 1; k < pieces.size(); ++k) {
      if (k == i + 1 && runOf[i] == runOf[k]) continue;
      if (MeetAtAnAngle(pieces[i], pieces[k])) return true;
    }
  }
  return false;
}

}  // namespace Vorn::Testing
