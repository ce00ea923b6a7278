#pragma once

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "support/ContourBuilder.h"
#include "support/fewest/Scans.h"

/// A nominal shape as a contour, with the points that a scan of it has on each piece.
namespace Vorn::Testing {

struct NominalContour {
  std::vector<GeometryUtils::Elem> contour;
  std::vector<double> joints;  ///< lengths from the start at which pieces begin and end
};

inline NominalContour MakeNominalContour(std::vector<NominalPiece> const& pieces) {
  Walk walk(pieces);
  NominalContour result;
  auto const origin = walk.At(0.0).at;
  ContourBuilder builder(origin.x, origin.y);
  result.joints.push_back(0.0);
  double along = 0.0;
  for (NominalPiece const& piece : pieces) {
    along += piece.length;
    result.joints.push_back(along);
    auto const [end, heading] = walk.At(along);
    if (piece.curvature == 0.0) {
      builder.To(end.x, end.y);
    } else {
      double const r = 1.0 / piece.curvature;
      builder.Around({end.x - r * std::sin(heading), end.y + r * std::cos(heading)}, end.x, end.y,
                     r > 0.0 ? 1.0 : -1.0);
    }
  }
  result.contour = builder.Build();
  return result;
}

}  // namespace Vorn::Testing
