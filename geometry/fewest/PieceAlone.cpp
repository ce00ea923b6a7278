// Circles of some points alone, without the pieces beside them.

#include <algorithm>

#include "geometry/fewest/PieceSearch.h"

namespace Vorn::Fewest {

namespace {

/// Strides at which the search for the longest run begins.
constexpr std::int32_t kFirstStrides = 16;

/// By so many steps at most it is told in which sense points run along a circle.
constexpr std::int32_t kSteps = 32;

}  // namespace

PieceFit PieceSearch::FitAlone(std::int32_t first, std::int32_t last) {
  UseRows(first, last);
  Circle const chord = LineThrough(PlaceOf(frame_.ToLocal(path_.At(first))),
                                   PlaceOf(frame_.ToLocal(path_.At(last - 1))));
  PieceFit fit = FitRows({chord, 0.0, false});
  // The chord of an arc beyond half a turn runs against it, and so may a circle found from there.
  std::int32_t const step = (last - first - 1) / kSteps + 1;
  if (AdvanceAlong(path_, fit.circle, first, last, step) < 0.0) {
    fit.circle = Scaled(fit.circle, -1.0);
  }
  return fit;
}

PieceFit PieceSearch::FitAlone(std::int32_t first, std::int32_t last, PieceFit const& start) {
  UseRows(first, last);
  return FitRows({frame_.ToLocal(start.circle), start.ratio, start.isFound});
}

PieceFit PieceSearch::FitRows(RunFit const& start) {
  Simplex simplex(slack_);
  Basis basis;
  return FromLocal(FitRun(programme_, start, false, &simplex, &basis));
}

PieceFit PieceSearch::FitLongestAlone(std::int32_t first) {
  std::int32_t const count = path_.Count();
  std::int32_t good = first + 2;
  std::int32_t bad = count + 1;
  std::int32_t target = first + kFirstStrides * StrideFrom(path_, first);
  PieceFit longest;
  while (good + 1 < bad && good < count) {
    target = std::clamp(target, good + 1, std::min(bad - 1, count));
    PieceFit const fit = FitAlone(first, target);
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
