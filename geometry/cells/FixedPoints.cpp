#include "geometry/cells/FixedPoints.h"

#include "math/Assert.h"
#include "vorn/MathUtils.h"

namespace Vorn::Cells {

std::optional<Triangle> FixedPoints::FindCandidate(Rect const& rect) const {
  VORN_ASSERT(IsAny());
  auto const along = [this](Point const& p) { return swapped ? p.y : p.x; };
  auto const across = [this](Point const& p) { return swapped ? p.x : p.y; };
  if (!hasP1 || !hasP2) {
    // The lines through one point form a line of the cell's plane: u + v*x + y = 0.
    Point const& p = hasP1 ? p1 : p2;
    return ChordAcross(rect, {1.0, along(p), across(p)});
  }
  double matrix[4] = {1.0, along(p1),  //
                      1.0, along(p2)};
  double rhs[2] = {-across(p1), -across(p2)};
  double solution[2];
  if (!MathUtils::LinearEquationSystemSolve(2, matrix, rhs, solution)) return std::nullopt;
  Point const only{solution[0], solution[1]};
  return Triangle{{only, only, only}};
}

}  // namespace Vorn::Cells
