#include "geometry/fewest/Inverse.h"

#include <cmath>
#include <cstddef>

namespace Vorn::Fewest {

namespace {

/// A determinant below this share of its terms is rounding.
constexpr double kLeastDeterminant = 1e-14;

/// Steps of refinement. Cramer's rule misses a solution by a share of it that is the condition of
/// the rows times a few units in the last place; each step multiplies the miss by that share, down
/// to what the rounding of the residuals leaves (Skeel, Iterative refinement implies numerical
/// stability, 1980).
constexpr int kRefinements = 2;

}  // namespace

bool InvertRows(std::array<Row, 4> const& rows, std::array<Circle, 4>* inverse) {
  // Cofactors from the minors of the upper and the lower two rows.
  auto const& [p, q, r, s] = rows;
  double const u0 = p.a * q.bx - q.a * p.bx;
  double const u1 = p.a * q.by - q.a * p.by;
  double const u2 = p.a * q.d - q.a * p.d;
  double const u3 = p.bx * q.by - q.bx * p.by;
  double const u4 = p.bx * q.d - q.bx * p.d;
  double const u5 = p.by * q.d - q.by * p.d;
  double const l0 = r.a * s.bx - s.a * r.bx;
  double const l1 = r.a * s.by - s.a * r.by;
  double const l2 = r.a * s.d - s.a * r.d;
  double const l3 = r.bx * s.by - s.bx * r.by;
  double const l4 = r.bx * s.d - s.bx * r.d;
  double const l5 = r.by * s.d - s.by * r.d;
  double const terms[6] = {u0 * l5, -u1 * l4, u2 * l3, u3 * l2, -u4 * l1, u5 * l0};
  double determinant = 0.0;
  double size = 0.0;
  for (double term : terms) {
    determinant += term;
    size += std::fabs(term);
  }
  if (!(std::fabs(determinant) > kLeastDeterminant * size)) return false;
  double const f = 1.0 / determinant;
  *inverse = {
      Circle{(q.bx * l5 - q.by * l4 + q.d * l3) * f, (-q.a * l5 + q.by * l2 - q.d * l1) * f,
             (q.a * l4 - q.bx * l2 + q.d * l0) * f, (-q.a * l3 + q.bx * l1 - q.by * l0) * f},
      Circle{(-p.bx * l5 + p.by * l4 - p.d * l3) * f, (p.a * l5 - p.by * l2 + p.d * l1) * f,
             (-p.a * l4 + p.bx * l2 - p.d * l0) * f, (p.a * l3 - p.bx * l1 + p.by * l0) * f},
      Circle{(s.bx * u5 - s.by * u4 + s.d * u3) * f, (-s.a * u5 + s.by * u2 - s.d * u1) * f,
             (s.a * u4 - s.bx * u2 + s.d * u0) * f, (-s.a * u3 + s.bx * u1 - s.by * u0) * f},
      Circle{(-r.bx * u5 + r.by * u4 - r.d * u3) * f, (r.a * u5 - r.by * u2 + r.d * u1) * f,
             (-r.a * u4 + r.bx * u2 - r.d * u0) * f, (r.a * u3 - r.bx * u1 + r.by * u0) * f}};
  return true;
}

Circle Solve(InvertedRows const& inverted, std::array<double, 4> const& values) {
  Circle at;
  for (int round = 0; round <= kRefinements; ++round) {
    Circle correction;
    for (std::size_t j = 0; j < 4; ++j) {
      double const missing = values[j] - Apply(inverted.rows[j], at);
      correction = Sum(correction, missing, inverted.inverse[j]);
    }
    at = Sum(at, 1.0, correction);
  }
  return at;
}

}  // namespace Vorn::Fewest
