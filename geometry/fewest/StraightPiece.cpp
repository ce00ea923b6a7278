// Straight pieces between two openings.

#include "geometry/fewest/Bends.h"
#include "geometry/fewest/PieceSearch.h"

namespace Vorn::Fewest {

PieceFit PieceSearch::FindStraight(Opening const& from, Opening const& to) {
  if (path_.limits.segmentsOnly) return {};
  std::int32_t const first = from.First();
  std::int32_t const end = to.isFree ? path_.Count() : to.gate.split;
  if (IsBent(path_.points, first, end)) return {};
  BeginProgramme(from, end);
  AddOpening(to);
  if (!programme_.Add({{1.0, 0.0, 0.0, 0.0}, Condition::Kind::Equality, 0.0})) return {};
  auto const endOf = [&](Opening const& opening, std::int32_t point) {
    return frame_.ToLocal(opening.isFree
                              ? Place{path_.At(point).x, path_.At(point).y}
                              : PlaceOn(opening.gate, 0.5 * (opening.low + opening.high)));
  };
  Circle const chord = LineThrough(endOf(from, first), endOf(to, end - 1));
  RunFit fit = FitAnyRadius({chord, 0.0, false}, false, {&from, &to, first, end});
  fit.circle.a = 0.0;  // but for rounding it is
  return FromLocal(fit);
}

}  // namespace Vorn::Fewest
