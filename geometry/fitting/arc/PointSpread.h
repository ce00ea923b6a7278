// The extreme distances between points.

#pragma once

#include <cstdint>
#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn::Fitting {

/// The farthest pair of points, i < j, and how far apart any two are. Of several farthest pairs the
/// first in the order of i and then j.
struct PointSpread {
  std::int32_t i = 0;
  std::int32_t j = 1;
  double largest2 = 0.0;
  double smallest2 = 0.0;
};

/// The spread of two or more points. Pairs are looked at in groups of neighbours, whose boxes tell
/// when none of them can matter: the cost grows with the number of points to the power of 4/3 when
/// they follow a curve, and with its square at worst.
PointSpread FindSpread(std::vector<WPoint> const& points);

}  // namespace Vorn::Fitting
