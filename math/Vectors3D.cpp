// Points displaced at right angles from both ends of a segment in space.
//
// The displacement lies in a plane through the segment that averages the two planes through the
// segment and one further point each. The plane is A*x + B*y + C*z + D = 0 with the raw
// determinants as coefficients. Deliberate: the coefficients of the two planes are not normalised
// before they are averaged, so the farther point weighs more, and points that mirror each other at
// the segment cancel the plane to zero.

#include <algorithm>
#include <cmath>

#include "vorn/MathUtils.h"
#include "vorn/Matrix.h"

namespace Vorn {

namespace {

constexpr int kAxes = 3;

struct Plane {
  double normal[kAxes];
  double constant;
};

struct Segment3D {
  double direction[kAxes];
  double length;
};

double Dot(double const* u, double const* v) { return u[0] * v[0] + u[1] * v[1] + u[2] * v[2]; }

/// Determinants by rows, through one matrix that is overwritten each time.
class RowDeterminant {
 public:
  double operator()(double const* u, double const* v, double const* w) {
    matrix_ = Matrix(Mtrx{{u[0], u[1], u[2], v[0], v[1], v[2], w[0], w[1], w[2]}});
    return matrix_.Det();
  }

  /// The determinant of the rows (u[i], u[j], 1), the same of v and of w.
  double OfPair(double const* u, double const* v, double const* w, int i, int j) {
    double const rowU[kAxes] = {u[i], u[j], 1.0};
    double const rowV[kAxes] = {v[i], v[j], 1.0};
    double const rowW[kAxes] = {w[i], w[j], 1.0};
    return (*this)(rowU, rowV, rowW);
  }

 private:
  Matrix matrix_;
};

Plane MiddlePlane(double const* p1, double const* p2, double const* q1, double const* q2) {
  RowDeterminant det;
  Plane plane;
  for (int axis = 0; axis < kAxes; ++axis) {
    int const i = (axis + 1) % kAxes;
    int const j = (axis + 2) % kAxes;
    plane.normal[axis] = 0.5 * (det.OfPair(p1, p2, q1, i, j) + det.OfPair(p1, p2, q2, i, j));
  }
  plane.constant = 0.5 * (-det(p1, p2, q1) - det(p1, p2, q2));
  return plane;
}

/// The point of the plane that stands at right angles to the segment at p and is the segment's
/// length farther than p along one axis.
bool DisplaceAlongAxis(Plane const& plane, Segment3D const& segment, double const* p, int axis,
                       double* displaced) {
  double const* n = plane.normal;
  double const* d = segment.direction;
  double matrix[kAxes * kAxes] = {n[0], n[1], n[2], 0.0, 0.0, 0.0, d[0], d[1], d[2]};
  matrix[kAxes + axis] = 1.0;
  double rhs[kAxes] = {-plane.constant, p[axis] + segment.length, Dot(d, p)};
  return MathUtils::LinearEquationSystemSolve(kAxes, matrix, rhs, displaced);
}

double SquaredDistance(double const* u, double const* v) {
  double const difference[kAxes] = {u[0] - v[0], u[1] - v[1], u[2] - v[2]};
  return Dot(difference, difference);
}

/// Of the three axes the one that moves p least; false when no axis gives a solvable system.
bool DisplaceNearest(Plane const& plane, Segment3D const& segment, double const* p, double* out) {
  bool found = false;
  double nearest[kAxes] = {};
  double nearestDistance2 = 0.0;
  for (int axis = 0; axis < kAxes; ++axis) {
    double candidate[kAxes];
    if (!DisplaceAlongAxis(plane, segment, p, axis, candidate)) continue;
    double const distance2 = SquaredDistance(candidate, p);
    // The first solvable axis is taken as it is, also with a NaN, which then nothing replaces.
    if (found && !(distance2 < nearestDistance2)) continue;
    found = true;
    nearestDistance2 = distance2;
    std::copy_n(candidate, kAxes, nearest);
  }
  if (found) std::copy_n(nearest, kAxes, out);
  return found;
}

}  // namespace

bool MathUtils::CalcNormalized3DVectors(double const* p1, double const* p2, double const* q1,
                                        double const* q2, double* out1, double* out2) {
  Plane const plane = MiddlePlane(p1, p2, q1, q2);
  Segment3D segment{{p2[0] - p1[0], p2[1] - p1[1], p2[2] - p1[2]}, 0.0};
  segment.length = std::sqrt(Dot(segment.direction, segment.direction));
  return DisplaceNearest(plane, segment, p1, out1) && DisplaceNearest(plane, segment, p2, out2);
}

}  // namespace Vorn
