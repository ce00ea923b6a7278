#pragma once

#include <cmath>

#include "math/NumericConstants.h"
#include "vorn/Types.h"

namespace Vorn::Lines {

/// The line a*x + b*y + c = 0, not normalised.
struct ImplicitLine {
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;

  /// Becomes the line through two points; false, unchanged, where they coincide.
  bool Through(double x1, double y1, double x2, double y2) {
    if (Numeric::IsZeroMagnitude(x1 - x2) && Numeric::IsZeroMagnitude(y1 - y2)) return false;
    a = y1 - y2;
    b = x2 - x1;
    c = x1 * y2 - y1 * x2;
    return true;
  }

  double At(double x, double y) const { return a * x + b * y + c; }

  /// The length of (a, b), with the sign that makes the origin's deviation At(0, 0) / SignedNorm()
  /// no greater than zero.
  double SignedNorm() const {
    double const norm = std::sqrt(a * a + b * b);
    return c > 0.0 ? -norm : norm;
  }

  /// The perpendicular through a point; c is not needed for it.
  ImplicitLine NormalThrough(double x, double y) const { return {b, -a, a * y - b * x}; }
};

/// Where two lines cross. Parallel, nothing written, also for one line given twice.
SegmentsRelPosition Cross(ImplicitLine const& line1, ImplicitLine const& line2, double* x,
                          double* y);

}  // namespace Vorn::Lines
