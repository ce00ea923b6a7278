// The noise of measured points without a model of the contour: whatever is smooth cancels in
// differences of neighbours, and what is left is noise.
//
// Each four consecutive points give one residual: their third divided difference over the length
// of chord, which is zero for every path of second degree, scaled to the variance of one
// coordinate and taken across the path, where the noise of the position along the path does not
// show. The spread of the residuals is their median absolute value, so that corners do not count.
//
//   T. Gasser, L. Sroka, C. Jennen-Steinmetz, "Residual Variance and Residual Pattern in Nonlinear
//   Regression", Biometrika 73(3), 1986: residuals of differences with unequal spacing.
//   F. R. Hampel, "The Influence Curve and its Role in Robust Estimation", JASA 69(346), 1974: the
//   median deviation.
#include "io/points/Noise.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "vorn/io/Spacing.h"

namespace Vorn::IO {

namespace {

constexpr std::size_t kPointsPerResidual = 4;
constexpr std::size_t kFewestResiduals = 8;

/// 1 over the third quartile of the normal distribution: makes the median absolute value of normal
/// residuals their standard deviation.
constexpr double kSpreadPerMedian = 1.482602218505602;

/// Weights of the third divided difference over the places `t`, of length 1; they sum up to zero.
std::array<double, kPointsPerResidual> Weights(std::array<double, kPointsPerResidual> const& t) {
  std::array<double, kPointsPerResidual> weights{};
  double sumOfSquares = 0.0;
  for (std::size_t i = 0; i < kPointsPerResidual; ++i) {
    double product = 1.0;
    for (std::size_t k = 0; k < kPointsPerResidual; ++k) {
      if (k != i) product *= t[i] - t[k];
    }
    weights[i] = 1.0 / product;
    sumOfSquares += weights[i] * weights[i];
  }
  for (double& weight : weights) weight /= std::sqrt(sumOfSquares);
  return weights;
}

/// The residual of four points; nothing where two of them coincide or nothing can be told.
std::optional<double> Residual(WPoint const* points) {
  std::array<double, kPointsPerResidual> t{};
  for (std::size_t i = 1; i < kPointsPerResidual; ++i) {
    t[i] = t[i - 1] + Distance(points[i - 1], points[i]);
    if (!(t[i] > t[i - 1])) return {};
  }
  // Measured in lengths of the stretch, so that no product leaves the range of doubles.
  double const whole = t.back();
  for (double& place : t) place /= whole;
  double const chordX = points[kPointsPerResidual - 1].x - points[0].x;
  double const chordY = points[kPointsPerResidual - 1].y - points[0].y;
  double const chord = std::hypot(chordX, chordY);
  std::array<double, kPointsPerResidual> const weights = Weights(t);
  double residual = 0.0;
  for (std::size_t i = 1; i < kPointsPerResidual; ++i) {
    // From the first point, not from the origin: far from it digits would be lost.
    double const x = points[i].x - points[0].x;
    double const y = points[i].y - points[0].y;
    residual += weights[i] * (y * (chordX / chord) - x * (chordY / chord));
  }
  if (!std::isfinite(residual)) return {};
  return std::fabs(residual);
}

}  // namespace

std::optional<double> EstimateNoise(std::vector<WPoint> const& points) {
  std::vector<double> residuals;
  for (std::size_t i = 0; i + kPointsPerResidual <= points.size(); ++i) {
    if (std::optional<double> const residual = Residual(&points[i])) {
      residuals.push_back(*residual);
    }
  }
  if (residuals.size() < kFewestResiduals) return {};
  auto const middle = residuals.begin() + static_cast<std::ptrdiff_t>(residuals.size() / 2);
  std::nth_element(residuals.begin(), middle, residuals.end());
  return kSpreadPerMedian * *middle;
}

}  // namespace Vorn::IO
