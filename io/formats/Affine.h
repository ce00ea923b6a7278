#pragma once

#include "vorn/io/Pieces.h"

namespace Vorn::IO {

/// x' = a x + c y + e, y' = b x + d y + f: the order in which SVG writes the six numbers.
struct Affine {
  double a = 1.0;
  double b = 0.0;
  double c = 0.0;
  double d = 1.0;
  double e = 0.0;
  double f = 0.0;

  /// Where a place goes.
  XY operator()(XY const& at) const;

  /// Where a direction goes.
  XY OfDirection(XY const& way) const;

  /// Above 0 where counter-clockwise stays so.
  double Determinant() const { return a * d - b * c; }

  /// Whether circles stay circles, but for rounding in the ninth digit.
  bool IsSimilarity() const;
};

/// First the second, then the first.
Affine operator*(Affine const& first, Affine const& second);

}  // namespace Vorn::IO
