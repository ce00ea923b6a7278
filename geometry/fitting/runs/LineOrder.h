// Whether points keep moving along a line.

#pragma once

#include "geometry/elementary/Points.h"

namespace Vorn::Fitting {

/// Whether points keep moving away from the first: the last is strictly farther from it than the
/// middle one, and the angle at the middle one is obtuse. Decided on squared distances.
inline bool MovesAway(Elementary::Point const& first, Elementary::Point const& middle,
                      Elementary::Point const& last) {
  double const toMiddle2 = Elementary::SquaredDistance(middle, first);
  double const toLast2 = Elementary::SquaredDistance(last, first);
  double const gap2 = Elementary::SquaredDistance(last, middle);
  if (toMiddle2 >= toLast2) return false;
  return gap2 + toMiddle2 - toLast2 < 0.0;
}

}  // namespace Vorn::Fitting
