#pragma once

#include <array>

#include "geometry/fewest/Columns.h"

/// Four linear equations in the four coefficients of a circle, solved by Cramer's rule.
namespace Vorn::Fewest {

/// The columns of the inverse of four rows: row i applied to column j is 1 for i = j and 0
/// otherwise. False, with `inverse` untouched, when the rows depend on each other.
bool InvertRows(std::array<Row, 4> const& rows, std::array<Circle, 4>* inverse);

/// Four rows with the columns of their inverse.
struct InvertedRows {
  std::array<Row, 4> rows;
  std::array<Circle, 4> inverse;
};

/// The circle on which four rows have given values, as accurate as doubles allow: each row r misses
/// its value by a few units in the last place of |r| |circle|, the sum of the sizes of its terms,
/// however badly the rows are conditioned.
Circle Solve(InvertedRows const& inverted, std::array<double, 4> const& values);

/// The circle plus a factor times another.
inline Circle Sum(Circle const& c, double factor, Circle const& o) {
  return {c.a + factor * o.a, c.bx + factor * o.bx, c.by + factor * o.by, c.d + factor * o.d};
}

}  // namespace Vorn::Fewest
