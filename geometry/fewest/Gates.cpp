#include "geometry/fewest/Gates.h"

#include <cmath>

namespace Vorn::Fewest {

bool FindCrossing(Circle const& circle, Gate const& gate, double* offset) {
  double const f = ValueAt(circle, gate.origin);
  Place const gradient = GradientAt(circle, gate.origin);
  double const slope = gradient.x * gate.across.x + gradient.y * gate.across.y;
  double const discriminant = slope * slope - 4.0 * circle.a * f;
  if (!(discriminant >= 0.0)) return false;
  // Of the two crossings the one where f grows; the other is on the far side of the circle.
  double const root = std::sqrt(discriminant);
  if (slope > 0.0) {
    *offset = -2.0 * f / (slope + root);
    return true;
  }
  if (circle.a == 0.0) return false;
  *offset = (root - slope) / (2.0 * circle.a);
  return true;
}

bool FindCrossing(PlacedCircle const& circle, Gate const& gate, double* offset) {
  Gate near = gate;
  near.origin = {gate.origin.x - circle.origin.x, gate.origin.y - circle.origin.y};
  return FindCrossing(circle.about, near, offset);
}

}  // namespace Vorn::Fewest
