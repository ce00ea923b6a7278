#pragma once

#include <algorithm>
#include <cmath>

#include "support/fewest/Scans.h"

/// Motions and scalings under which the number of pieces must not change.
namespace Vorn::Testing {

template <typename Change>
Scan Changed(Scan scan, Change const& change) {
  for (WPoint& p : scan) p = change(p);
  return scan;
}

inline Scan Rotated(Scan const& scan, double angle) {
  double const c = std::cos(angle);
  double const s = std::sin(angle);
  return Changed(scan, [c, s](WPoint const& p) {
    return WPoint{c * p.x - s * p.y, s * p.x + c * p.y, p.w};
  });
}

/// Exact.
inline Scan TurnedByAQuarter(Scan const& scan) {
  return Changed(scan, [](WPoint const& p) { return WPoint{-p.y, p.x, p.w}; });
}

/// Exact.
inline Scan Mirrored(Scan const& scan) {
  return Changed(scan, [](WPoint const& p) { return WPoint{p.x, -p.y, p.w}; });
}

inline Scan Shifted(Scan const& scan, double dx, double dy) {
  return Changed(scan, [dx, dy](WPoint const& p) { return WPoint{p.x + dx, p.y + dy, p.w}; });
}

/// Exact for powers of two.
inline Scan Magnified(Scan const& scan, double factor) {
  return Changed(scan, [factor](WPoint const& p) {
    return WPoint{p.x * factor, p.y * factor, p.w * factor};
  });
}

inline Scan WithTolerances(Scan const& scan, double factor) {
  return Changed(scan, [factor](WPoint const& p) { return WPoint{p.x, p.y, p.w * factor}; });
}

inline Scan Reversed(Scan scan) {
  std::reverse(scan.begin(), scan.end());
  return scan;
}

}  // namespace Vorn::Testing
