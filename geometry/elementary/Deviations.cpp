#include "geometry/elementary/Deviations.h"

#include <cmath>

#include "math/NumericConstants.h"

namespace Vorn::Elementary {

namespace {

/// Neighbours must be farther apart than this many times the sum of their tolerances. At 1.0 the
/// tolerance circles would touch, and the inner tangents that bound the line cell would fall
/// together; nearer than this the cell is so wide that it says little about the line.
constexpr double kSpacingFactor = 1.5;

double Square(double value) { return value * value; }

}  // namespace

std::optional<double> Deviation(ImplicitLine const& line, Point const& p) {
  double const norm = line.Norm();
  if (Numeric::IsZero(norm)) return std::nullopt;
  return std::fabs(line.At(p)) / norm;
}

std::optional<double> SignedDeviation(ImplicitLine const& line, Point const& p) {
  double const divisor = line.SignedNorm();
  if (Numeric::IsZeroMagnitude(divisor)) return std::nullopt;
  return line.At(p) / divisor;
}

std::optional<double> DeviationBySquares(Point const& lineStart, Point const& lineEnd,
                                         Point const& p) {
  double const base2 = SquaredDistance(lineStart, lineEnd);
  if (Numeric::IsZero(base2)) return std::nullopt;
  double const fromStart2 = SquaredDistance(lineStart, p);
  double const fromEnd2 = SquaredDistance(lineEnd, p);
  double const projection2 = Square(fromStart2 + base2 - fromEnd2) / (4.0 * base2);
  if (fromStart2 + projection2 < Numeric::kZero ||
      std::fabs((fromStart2 - projection2) / (projection2 + fromStart2)) < Numeric::kZero) {
    return 0.0;
  }
  // Deliberate: no clamp. A difference that rounding made negative gives a NaN, which the line
  // fitter takes for "too far".
  return std::sqrt(fromStart2 - projection2);
}

bool AreFarEnoughApart(WPoint const& a, WPoint const& b) {
  double const reach = (a.w + b.w) * kSpacingFactor;
  // Written as a negation so that a NaN passes here and is met by the fitters instead.
  return !(Square(reach) >= SquaredDistance({a.x, a.y}, {b.x, b.y}));
}

}  // namespace Vorn::Elementary
