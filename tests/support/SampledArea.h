#pragma once

#include <cmath>
#include <cstddef>
#include <vector>

#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {

/// The area between the contour and the x axis by trapezoids over chords, the arcs cut into many.
inline double SampledArea(std::vector<GeometryUtils::Elem> const& contour, int chordsPerArc) {
  using Real = long double;
  Real const fullTurn = 8.0L * std::atan(1.0L);
  Real twice = 0.0L;
  auto x = Real(contour.front().end.x);
  auto y = Real(contour.front().end.y);
  auto const goTo = [&](Real nextX, Real nextY) {
    twice += (nextX - x) * (nextY + y);
    x = nextX;
    y = nextY;
  };
  for (std::size_t i = 1; i < contour.size(); ++i) {
    auto const& elem = contour[i];
    if (elem.type == GeometryUtils::ElemType::Arc) {
      auto const start = Real(elem.startAngle);
      Real sweep = Real(elem.endAngle) - start;
      if (elem.direction > 0.0 && sweep < 0.0L) sweep += fullTurn;
      if (elem.direction < 0.0 && sweep > 0.0L) sweep -= fullTurn;
      for (int step = 1; step < chordsPerArc; ++step) {
        Real const angle = start + sweep * Real(step) / Real(chordsPerArc);
        goTo(Real(elem.center.x) + Real(elem.radius) * std::cos(angle),
             Real(elem.center.y) + Real(elem.radius) * std::sin(angle));
      }
    }
    goTo(Real(elem.end.x), Real(elem.end.y));
  }
  return static_cast<double>(twice / 2.0L);
}

}  // namespace Vorn::Testing
