// Straight pieces between two openings.

#include "geometry/fewest/PieceSearch.h"

namespace Vorn::Fewest {

namespace {

/// A line that covers a run passes its middle point within the tolerance of that, and is no farther
/// from the chord between the ends, where it runs beside it, than the larger tolerance of the two.
/// So the middle is within the sum of the three; eight times that is beyond all rounding.
constexpr double kFarFromChord = 8.0;

/// Whether the middle point of [first, end) lies so far from the chord between the ends that no
/// line is within the tolerances of all. O(1).
bool IsClearlyBent(Path const& path, std::int32_t first, std::int32_t end) {
  WPoint const& a = path.At(first);
  WPoint const& b = path.At(end - 1);
  WPoint const& m = path.At(first + (end - first) / 2);
  double const dx = b.x - a.x;
  double const dy = b.y - a.y;
  double const along = dx * (m.x - a.x) + dy * (m.y - a.y);
  double const length2 = dx * dx + dy * dy;
  if (!(along >= 0.0 && along <= length2)) return false;
  double const across = dx * (m.y - a.y) - dy * (m.x - a.x);
  double const reach = kFarFromChord * (a.w + b.w + m.w);
  return across * across > reach * reach * length2;
}

}  // namespace

PieceFit PieceSearch::FindStraight(Opening const& from, Opening const& to) {
  if (path_.limits.segmentsOnly) return {};
  std::int32_t const first = from.First();
  std::int32_t const end = to.isFree ? path_.Count() : to.gate.split;
  if (IsClearlyBent(path_, first, end)) return {};
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
