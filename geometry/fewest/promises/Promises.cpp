#include "geometry/fewest/promises/Promises.h"

#include <algorithm>
#include <cmath>

#include "geometry/fewest/promises/Coverage.h"
#include "geometry/fewest/promises/Crossings.h"
#include "geometry/fewest/promises/PieceChecks.h"

namespace Vorn::Promises {

namespace {

using Point = GeometryUtils::Point;
using Elem = GeometryUtils::Elem;

/// Between these the fourth powers of coordinates neither overflow nor vanish.
constexpr int kLeastExponent = -200;
constexpr int kGreatestExponent = 200;

double LargestCoordinate(Chain const& chain) {
  double largest = 0.0;
  auto const take = [&largest](double x, double y) {
    largest = std::max({largest, std::fabs(x), std::fabs(y)});
  };
  for (WPoint const& p : chain.points) take(p.x, p.y);
  for (Elem const& elem : chain.contour) take(elem.end.x, elem.end.y);
  return largest;
}

/// The exponent of the power of two that brings a chain near 1; 0 where that is not needed.
int ScalingExponent(Chain const& chain) {
  double const largest = LargestCoordinate(chain);
  if (largest == 0.0 || !std::isfinite(largest)) return 0;
  int const exponent = std::ilogb(largest);
  return kLeastExponent < exponent && exponent < kGreatestExponent ? 0 : -exponent;
}

Point Scaled(Point const& p, int exponent) {
  return {std::ldexp(p.x, exponent), std::ldexp(p.y, exponent)};
}

Report MeasureRegular(Chain const& chain) {
  Report report;
  auto const coverage = Coverage::Of(chain);
  if (!coverage) {
    report.violations.push_back({Promise::WellFormed, 0, kNone, kNone, {}, 0.0});
    return report;
  }
  for (std::size_t piece = 0; piece < coverage->PieceCount(); ++piece) {
    CheckPoints(*coverage, piece, &report);
    CheckArc(*coverage, piece, &report);
    CheckJoint(*coverage, piece, &report);
  }
  CheckClosing(*coverage, &report);
  CheckCrossings(*coverage, &report);
  return report;
}

bool IsLength(Promise promise) {
  return promise == Promise::InOrder || promise == Promise::NearPath ||
         promise == Promise::Joined || promise == Promise::Closed;
}

Report MeasureScaled(Chain const& chain, int exponent) {
  std::vector<WPoint> points = chain.points;
  for (WPoint& p : points) {
    p = {std::ldexp(p.x, exponent), std::ldexp(p.y, exponent), std::ldexp(p.w, exponent)};
  }
  std::vector<Elem> contour = chain.contour;
  for (Elem& elem : contour) {
    elem.end = Scaled(elem.end, exponent);
    elem.center = Scaled(elem.center, exponent);
    elem.radius = std::ldexp(elem.radius, exponent);
  }
  Report report = MeasureRegular({points, contour, chain.ranges, chain.isClosed, chain.largestStep,
                                  std::ldexp(chain.farthestBetweenPoints, exponent)});
  for (Violation& violation : report.violations) {
    violation.at = Scaled(violation.at, -exponent);
    if (IsLength(violation.promise)) violation.amount = std::ldexp(violation.amount, -exponent);
  }
  return report;
}

}  // namespace

Report Measure(Chain const& chain) {
  int const exponent = ScalingExponent(chain);
  return exponent == 0 ? MeasureRegular(chain) : MeasureScaled(chain, exponent);
}

}  // namespace Vorn::Promises
