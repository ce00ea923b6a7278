#include "geometry/fewest/Mending.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace Vorn::Fewest {

namespace {

/// What a stretch is searched with.
struct Tightness {
  /// Of the tolerances.
  double share;
  /// Limits::jointRoom
  double jointRoom;
  bool segmentsOnly;
};

/// A little room is often enough and costs no piece; without room for joints pieces stay near the
/// path, within all of their tolerances. Segments keep to the path between the points.
constexpr Tightness kTightness[] = {{1.0, 1.0, false}, {0.93, 1.0, false}, {1.0, 0.0, false},
                                    {0.8, 0.5, false}, {0.6, 0.25, false}, {0.4, 0.0, false},
                                    {0.8, 0.0, true},  {0.2, 0.0, true},   {0.05, 0.0, true}};

/// Multiplies the tolerances of a stretch but for its first and last points: the joints beside them
/// stay where they are, perhaps at the very edge of what these allow.
void TightenInner(double share, Path* path) {
  auto const tighten = [&](WPoint& p) { p.w *= share; };
  std::int32_t const first = StrideFrom(*path, 0);
  std::int32_t const last = path->Count() - first;
  if (first >= last) return;
  std::for_each(path->points.begin() + first, path->points.begin() + last, tighten);
  path->leastTolerance *= share;
}

}  // namespace

Mending::Mending(Path const& path, double share, Chain chain)
    : path_(path), share_(share), chain_(std::move(chain)), tightness_(chain_.pieces.size()) {}

bool Mending::Mend(std::vector<Promises::Violation> const& violations) {
  Splicing splicing(chain_);
  std::vector<std::size_t> tightnesses;
  std::size_t next = 0;
  auto const keepUpTo = [&](std::size_t end) {
    for (; next < end; ++next) tightnesses.push_back(tightness_[next]);
  };
  bool isAnyLeft = false;
  for (Stretch const& stretch : StretchesAround(violations)) {
    auto const begin = tightness_.begin() + static_cast<std::ptrdiff_t>(stretch.first);
    auto const end = tightness_.begin() + static_cast<std::ptrdiff_t>(stretch.end);
    std::size_t const tightness = *std::max_element(begin, end) + 1;
    if (tightness >= std::size(kTightness)) continue;
    isAnyLeft = true;
    std::fill(begin, end, tightness);
    Chain const part = Search(stretch, tightness);
    if (part.pieces.empty()) continue;
    splicing.Replace(stretch, part);
    keepUpTo(stretch.first);
    tightnesses.insert(tightnesses.end(), part.pieces.size(), tightness);
    next = stretch.end;
  }
  keepUpTo(tightness_.size());
  tightness_ = std::move(tightnesses);
  chain_ = splicing.Finish();
  return isAnyLeft;
}

std::vector<Stretch> Mending::StretchesAround(
    std::vector<Promises::Violation> const& violations) const {
  std::size_t const count = chain_.pieces.size();
  std::vector<char> isBad(count);
  for (Promises::Violation const& violation : violations) {
    isBad[violation.piece] = 1;
    if (violation.otherPiece != Promises::kNone) isBad[violation.otherPiece] = 1;
  }
  std::vector<Stretch> stretches;
  for (std::size_t k = 0; k < count; ++k) {
    if (isBad[k] == 0) continue;
    std::size_t const reach = 1 + tightness_[k] / 2;
    Stretch const around{k - std::min(k, reach), std::min(k + 1 + reach, count)};
    if (!stretches.empty() && stretches.back().end > around.first) {
      stretches.back().end = around.end;
    } else {
      stretches.push_back(around);
    }
  }
  return stretches;
}

Chain Mending::Search(Stretch const& stretch, std::size_t tightness) const {
  if (!HasOuterPoints(chain_, stretch)) return {};
  Tightness const& tighter = kTightness[tightness];
  Path path = PathOf(path_, chain_, stretch);
  Limits& limits = path.limits;
  limits.jointRoom = tighter.jointRoom;
  limits.segmentsOnly = limits.segmentsOnly || tighter.segmentsOnly;
  if (tighter.jointRoom == 0.0) {
    limits.farthestBetweenPoints = std::min(limits.farthestBetweenPoints, path.leastTolerance);
  }
  TightenInner(tighter.share, &path);
  return FindChain(path, share_, [](std::int32_t) {});
}

}  // namespace Vorn::Fewest
