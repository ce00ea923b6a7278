// A line through the points of a run that deviate most, in place of the run's oversized cell.

#include <cstdint>
#include <vector>

#include "geometry/fitting/Runs.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

bool GeometryUtils::ReduceOverlappedTrianglesQuantityForStraightLine(
    std::vector<WPoint> const& points, int start, int count, double /*tolerance*/,
    std::vector<Triangle>* cell) {
  if (count < 4 || !Fitting::HoldsRun(points, start, count)) return false;
  WPoint const& first = At(points, start);
  WPoint const& last = At(points, start + count - 1);
  double smallest = 0.0;
  double largest = 0.0;
  int smallestAt = 0;
  int largestAt = 0;
  for (int i = start + 1; i < start + count; ++i) {
    WPoint const& p = At(points, i);
    double const coords[6] = {first.x, first.y, last.x, last.y, p.x, p.y};
    double deviation = 0.0;
    if (!GetDeviation(coords, &deviation)) return false;
    if (i == start + 1 || deviation < smallest) {
      smallest = deviation;
      smallestAt = i;
    }
    if (i == start + 1 || deviation > largest) {
      largest = deviation;
      largestAt = i;
    }
  }
  std::vector<WPoint> shortRun = {first, At(points, smallestAt)};
  if (largestAt != smallestAt) shortRun.push_back(At(points, largestAt));
  shortRun.push_back(last);
  // Deliberate: the cell is emptied and stays empty; the caller rebuilds it.
  cell->clear();

  Point startPoint = ToPoint(first);
  Point endPoint = ToPoint(last);
  std::int32_t lineCount = 0;
  double lineDeviation = 0.0;
  std::int32_t lineDeviationIndex = -1;
  std::vector<std::int32_t> indexList;
  ErrorCode lineCode = ErrorCode::Ok;
  ProgressBase const silent{nullptr, 100, 100};
  return GetFittingLine(shortRun, 0, static_cast<std::int32_t>(shortRun.size()), false, &startPoint,
                        false, &endPoint, true, &lineCount, &lineDeviation, &lineDeviationIndex,
                        &indexList, &lineCode, silent) == ErrorCode::Ok;
}

}  // namespace Vorn
