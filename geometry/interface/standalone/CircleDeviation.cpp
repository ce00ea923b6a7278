// Standalone member: no other operation of the library uses it. The least and the greatest signed
// distance of points from a circle; the fit asks for the largest absolute one.

#include <cstdint>
#include <vector>

#include "geometry/elementary/Points.h"
#include "geometry/fitting/runs/Deviations.h"
#include "geometry/fitting/runs/Runs.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

bool GeometryUtils::GetMaxObtainedDeviation(std::vector<WPoint> const& points, std::int32_t first,
                                            std::int32_t count, Point const& center, double radius,
                                            double* minSigned, double* maxSigned) {
  Fitting::Run const run{points, first, count};
  double smallest = -1.0;
  double largest = -1.0;
  for (std::int32_t i = 0; run.Exists() && i < count; ++i) {
    double const deviation = radius - Elementary::Distance(run.PointAt(i), center);
    if (i == 0 || deviation < smallest) smallest = deviation;
    if (i == 0 || deviation > largest) largest = deviation;
  }
  *minSigned = smallest;
  *maxSigned = largest;
  return true;
}

}  // namespace Vorn
