#include "geometry/elementary/Circumcentre.h"

#include "vorn/MathUtils.h"

namespace Vorn::Circles {

bool SolveCircumcentre(GeometryUtils::Point const& p0, GeometryUtils::Point const& p1,
                       GeometryUtils::Point const& p2, GeometryUtils::Point* center) {
  double const ax = 2.0 * (p0.x - p1.x);
  double const ay = 2.0 * (p0.y - p1.y);
  double const bx = 2.0 * (p1.x - p2.x);
  double const by = 2.0 * (p1.y - p2.y);
  double matrix[16] = {ax,  ay,  ax,  ay,   //
                       bx,  by,  bx,  by,   //
                       0.0, 0.0, 1.0, 0.0,  //
                       0.0, 0.0, 0.0, 1.0};
  double rhs[4] = {(p1.y + p0.y) * (p0.y - p1.y) + (p1.x + p0.x) * (p0.x - p1.x),
                   (p2.y + p1.y) * (p1.y - p2.y) + (p2.x + p1.x) * (p1.x - p2.x), 0.0, 0.0};
  double solution[4];
  if (!MathUtils::LinearEquationSystemSolve(4, matrix, rhs, solution)) return false;
  *center = {solution[0], solution[1]};
  return true;
}

}  // namespace Vorn::Circles
