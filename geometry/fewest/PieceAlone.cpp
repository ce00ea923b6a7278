// Circles of some points alone, without the pieces beside them.

#include <algorithm>

#include "geometry/fewest/PieceSearch.h"

namespace Vorn::Fewest {

namespace {

/// Strides at which the search for the longest run begins.
constexpr std::int32_t kFirstStrides = 16;

}  // namespace

RunFit PieceSearch::FitAlone(std::int32_t first, std::int32_t last) {
  UseRows(first, last);
  Simplex simplex(slack_);
  Basis basis;
  RunFit fit = FitRun(programme_,
                      {LineThrough(PlaceOf(frame_.ToLocal(path_.At(first))),
                                   PlaceOf(frame_.ToLocal(path_.At(last - 1)))),
                       0.0, false},
                      false, &simplex, &basis);
  if (fit.isFound) fit.circle = FromLocal(fit.circle);
  return fit;
}

RunFit PieceSearch::FitLongestAlone(std::int32_t first) {
  std::int32_t const count = path_.Count();
  std::int32_t good = first + 2;
  std::int32_t bad = count + 1;
  std::int32_t target = first + kFirstStrides * StrideFrom(path_, first);
  RunFit longest;
  while (good + 1 < bad && good < count) {
    target = std::clamp(target, good + 1, std::min(bad - 1, count));
    RunFit const fit = FitAlone(first, target);
    if (fit.isFound && fit.ratio <= 1.0) {
      good = target;
      longest = fit;
    } else {
      bad = target;
    }
    target = bad <= count ? good + (bad - good) / 2 : good + (good - first);
  }
  return longest;
}

}  // namespace Vorn::Fewest
