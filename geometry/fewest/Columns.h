#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "geometry/fewest/Circle.h"

/// The tolerance rows of a stretch of points, one array for each coefficient.
namespace Vorn::Fewest {

/// A linear function of the four coefficients of a circle.
struct Row {
  double a = 0.0;
  double bx = 0.0;
  double by = 0.0;
  double d = 0.0;
};

/// The row applied to a circle.
inline double Apply(Row const& r, Circle const& c) {
  return r.a * c.a + r.bx * c.bx + r.by * c.by + r.d * c.d;
}

/// The row times a factor above 0.
inline Row Weighted(Row const& r, double factor) {
  return {r.a * factor, r.bx * factor, r.by * factor, r.d * factor};
}

/// The row with the opposite signs.
inline Row Negated(Row const& r) { return {-r.a, -r.bx, -r.by, -r.d}; }

/// The row of f at a place.
inline Row ValueRow(Place const& p) { return {p.x * p.x + p.y * p.y, p.x, p.y, 1.0}; }

/// The row of Form(c, .).
inline Row FormRow(Circle const& c) { return {-2.0 * c.d, c.bx, c.by, -2.0 * c.a}; }

/// A point in local coordinates with its tolerance.
struct Sample {
  double x = 0.0;
  double y = 0.0;
  double w = 1.0;
};

/// Where a sample lies.
inline Place PlaceOf(Sample const& s) { return {s.x, s.y}; }

/// Rows of points, scaled so that a circle is within tolerance of point i exactly when
/// |row i applied to the circle| <= 1. Positions count from the first point appended.
class Columns {
 public:
  /// Forgets the rows but keeps the memory.
  void Clear();
  /// Appends the row of a sample.
  void Append(Sample const& sample);
  /// Number of rows.
  std::int32_t Size() const { return static_cast<std::int32_t>(a_.size()); }
  /// One row.
  Row At(std::int32_t i) const {
    auto const k = static_cast<std::size_t>(i);
    return {a_[k], bx_[k], by_[k], d_[k]};
  }

  /// The row that a circle breaks most.
  struct Worst {
    std::int32_t index = -1;
    double value = 0.0;  ///< |row applied to the circle|
  };
  /// The largest of |row| over [first, last), the first of equal ones; index -1 for no rows. O(n).
  Worst FindWorst(std::int32_t first, std::int32_t last, Circle const& circle) const;
  /// The first position in [first, last) with |row| > limit, last if there is none.
  std::int32_t FindFirstAbove(std::int32_t first, std::int32_t last, Circle const& circle,
                              double limit) const;

 private:
  std::vector<double> a_;
  std::vector<double> bx_;
  std::vector<double> by_;
  std::vector<double> d_;
};

}  // namespace Vorn::Fewest
