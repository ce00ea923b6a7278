// A first guess of a circle from the points alone, and which points are too close together for the
// deviation that the guess allows.

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "geometry/fitting/arc/PointSpread.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

namespace {

/// Points stay apart when the allowance reaches at most this part of their distance.
constexpr double kSpacingShare = 3.0;

/// A little below the limit, so that an allowance equal to it does not pass. Formed by a product:
/// a limit of zero equals its product and shows up as such.
constexpr double kGuardFactor = 0.99;

}  // namespace

bool GeometryUtils::GetEstimatedCircle(std::vector<WPoint> const& points, Point* first,
                                       Point* middle, Point* last, Point* center, double* radius,
                                       double* minSpacing) {
  auto const n = static_cast<std::int32_t>(points.size());
  if (n < 3) return false;

  auto const distance2 = [&points](std::int32_t i, std::int32_t j) {
    return GetDist2(ToPoint(At(points, i)), ToPoint(At(points, j)));
  };
  Fitting::PointSpread const spread = Fitting::FindSpread(points);

  std::int32_t nearestBisector = -1;
  double smallestOffset = 0.0;
  for (std::int32_t k = 0; k < n; ++k) {
    if (k == spread.i || k == spread.j) continue;
    double const offset =
        std::fabs(std::sqrt(distance2(k, spread.i)) - std::sqrt(distance2(k, spread.j)));
    if (nearestBisector < 0 || offset < smallestOffset) {
      smallestOffset = offset;
      nearestBisector = k;
    }
  }

  Point const start = ToPoint(At(points, spread.i));
  Point const mid = ToPoint(At(points, nearestBisector));
  Point const end = ToPoint(At(points, spread.j));
  Point foundCenter;
  double foundRadius = 0.0;
  if (!GetCircle(start, mid, end, &foundCenter, &foundRadius)) return false;
  *first = start;
  *middle = mid;
  *last = end;
  *center = foundCenter;
  *radius = foundRadius;
  *minSpacing = std::sqrt(spread.smallest2);
  return true;
}

bool GeometryUtils::GetEstimatedMaxDeviationForCircle(Point const& first, Point const& middle,
                                                      Point const& last, double radius,
                                                      double* deviation) {
  double const shorterChord2 = std::min(GetDist2(middle, last), GetDist2(first, middle));
  *deviation = std::min(radius * 0.25, shorterChord2 / (radius * 4.0));
  return true;
}

bool GeometryUtils::GetEstimatedDeviationForCircle(std::vector<WPoint> const& points,
                                                   double* tolerance,
                                                   std::vector<std::int32_t>* excluded,
                                                   Point* center, double* radius) {
  auto const n = static_cast<std::int32_t>(points.size());
  if (n < 3) return false;
  Point first;
  Point middle;
  Point last;
  Point estimate;
  double estimatedRadius = 0.0;
  double minSpacing = 0.0;
  double allowance = 0.0;
  if (!GetEstimatedCircle(points, &first, &middle, &last, &estimate, &estimatedRadius,
                          &minSpacing) ||
      !GetEstimatedMaxDeviationForCircle(first, middle, last, estimatedRadius, &allowance)) {
    return false;
  }
  double const limit = minSpacing / kSpacingShare;
  double const guard = limit * kGuardFactor;
  if (guard == limit || Numeric::IsZero(guard)) return false;

  excluded->clear();
  if (allowance > guard) {
    auto const isTooClose = [&](std::int32_t kept, std::int32_t candidate) {
      double const distance =
          std::sqrt(GetDist2(ToPoint(At(points, kept)), ToPoint(At(points, candidate))));
      return allowance > distance / kSpacingShare;
    };
    std::int32_t kept = 0;
    bool isLastTooClose = false;
    for (std::int32_t i = 1; i < n; ++i) {
      if (!isTooClose(kept, i)) {
        kept = i;
      } else if (i < n - 1) {
        excluded->push_back(i);
      } else {
        isLastTooClose = true;
      }
    }
    if (isLastTooClose && excluded->empty()) {
      if (n < 4) return false;
      excluded->push_back(n - 2);
    } else if (isLastTooClose) {
      // Backwards over the gaps between runs of dropped points: a kept point stands below each.
      // The second one met is where the last point is measured again.
      int gaps = 0;
      for (std::size_t pos = excluded->size() - 1; pos > 0; --pos) {
        if ((*excluded)[pos] == (*excluded)[pos - 1] + 1) continue;
        std::int32_t const keptBelow = (*excluded)[pos] - 1;
        if (++gaps < 2) continue;
        if (isTooClose(keptBelow, n - 1)) {
          excluded->push_back(n - 1);
        } else {
          excluded->insert(excluded->begin() + static_cast<std::ptrdiff_t>(pos), keptBelow);
        }
        break;
      }
    }
    if (static_cast<std::size_t>(n) - excluded->size() < 3) {
      excluded->clear();
      return false;
    }
  }
  *tolerance = allowance;
  *center = estimate;
  *radius = estimatedRadius;
  return true;
}

}  // namespace Vorn
