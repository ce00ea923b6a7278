// How far the points of a run lie from a line, and whether they move along it in order.

#include <cmath>
#include <cstdint>
#include <optional>
#include <utility>

#include "geometry/elementary/ImplicitLine.h"
#include "geometry/fitting/Runs.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

double GeometryUtils::GetMaxDeviationFromLine(std::vector<WPoint> const& points, std::int32_t start,
                                              std::int32_t count, Point const& a, Point const& b,
                                              std::int32_t* index) {
  *index = -1;
  if (count < 1 || !Fitting::HoldsRun(points, start, count)) return 0.0;
  double largest = 0.0;
  std::int32_t largestAt = 0;
  for (std::int32_t i = 0; i < count; ++i) {
    WPoint const& p = Fitting::At(points, start + i);
    double const coords[6] = {a.x, a.y, b.x, b.y, p.x, p.y};
    double deviation = 0.0;
    if (!GetDeviation(coords, &deviation)) return 0.0;
    double const relative = std::fabs(deviation) / p.w;
    if (i == 0 || relative > largest) {
      largest = relative;
      largestAt = i;
    }
  }
  *index = start + largestAt;
  return largest;
}

bool GeometryUtils::GetDeviationFromLineParameters(Point const& a, Point const& b,
                                                   std::vector<WPoint> const& points,
                                                   std::int32_t start, std::int32_t count,
                                                   double* minDeviation, double* maxDeviation,
                                                   std::int32_t* minIndex, std::int32_t* maxIndex) {
  if (!Fitting::HoldsRun(points, start, count)) return false;
  std::optional<Elementary::ImplicitLine> const line = Elementary::LineThrough(a, b);
  if (!line) return false;
  // Without a norm no point has a deviation, and there are no extremes to hand out.
  double const divisor = line->SignedNorm();
  if (Numeric::IsZeroMagnitude(divisor)) return false;
  bool isAnyMeasured = false;
  double smallest = 0.0;
  double largest = 0.0;
  std::int32_t smallestAt = -1;
  std::int32_t largestAt = -1;
  for (std::int32_t i = start; i < start + count; ++i) {
    WPoint const& p = Fitting::At(points, i);
    double const deviation = line->At({p.x, p.y}) / divisor;
    if (!isAnyMeasured || deviation < smallest) {
      smallest = deviation;
      smallestAt = i;
    }
    if (!isAnyMeasured || deviation > largest) {
      largest = deviation;
      largestAt = i;
    }
    isAnyMeasured = true;
  }
  if (!isAnyMeasured) return false;
  *minDeviation = smallest;
  *maxDeviation = largest;
  *minIndex = smallestAt;
  *maxIndex = largestAt;
  return true;
}

bool GeometryUtils::GetDeviationFromLineParameters(Point const& a, Point const& b,
                                                   std::vector<WPoint> const& points,
                                                   std::int32_t start, std::int32_t count,
                                                   std::vector<std::int32_t>* indices) {
  double smallest = 0.0;
  double largest = 0.0;
  std::int32_t lower = 0;
  std::int32_t upper = 0;
  if (!GetDeviationFromLineParameters(a, b, points, start, count, &smallest, &largest, &lower,
                                      &upper)) {
    return false;
  }
  if (lower > upper) std::swap(lower, upper);
  indices->push_back(lower);
  if (upper != lower) indices->push_back(upper);
  return true;
}

bool GeometryUtils::IsValidLineOrder(Point const& first, Point const& middle, Point const& last) {
  double const toMiddle2 = GetDist2(middle, first);
  double const toLast2 = GetDist2(last, first);
  double const gap2 = GetDist2(last, middle);
  if (toMiddle2 >= toLast2) return false;
  return gap2 + toMiddle2 - toLast2 < 0.0;
}

}  // namespace Vorn
