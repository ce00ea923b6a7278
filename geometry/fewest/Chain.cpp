#include "geometry/fewest/Chain.h"

#include <vector>

#include "geometry/fewest/Levels.h"

namespace Vorn::Fewest {

namespace {

/// How many pieces more are tried to end where a path has to.
constexpr int kMostFailedEnds = 2;

constexpr std::size_t kNone = static_cast<std::size_t>(-1);

/// The state of the last level whose piece to the finish deviates least; kNone if there is none.
std::size_t FindLast(Path const& path, Levels* levels) {
  std::vector<State> const& last = levels->Last();
  PieceSearch& search = levels->Search();
  double least = 0.0;
  std::size_t at = kNone;
  search.MoveTo(last.front().opening.First(), path.Count());
  for (std::size_t i = 0; i < last.size(); ++i) {
    if (last[i].reach.end < path.Count()) continue;
    PieceFit const fit = search.FindBest(last[i].opening, path.finish,
                                         {last[i].reach.circle, 1.0, path.finish.isFree});
    if (fit.isFound && fit.ratio <= kWholeTolerance && (at == kNone || fit.ratio < least)) {
      least = fit.ratio;
      at = i;
    }
  }
  return at;
}

}  // namespace

Chain FindChain(Path const& path, double share, std::function<void(std::int32_t)> const& tell) {
  return FindChainWhile(path, share, [&](std::size_t, std::int32_t covered) {
    tell(covered);
    return true;
  });
}

Chain FindChainWhile(Path const& path, double share, GoesOn const& goesOn) {
  Levels levels(path, share);
  for (int failedEnds = 0; failedEnds <= kMostFailedEnds;) {
    std::int32_t farthest = levels.FindFarthest();
    if (!goesOn(levels.Count(), farthest)) return {};
    if (farthest == path.Count()) {
      std::size_t const last = FindLast(path, &levels);
      if (last != kNone) return PlacePieces(path, levels.LinksThrough(last), &levels.Search());
      // No piece ends where a closed path has to; one more may close it.
      ++failedEnds;
      farthest = path.Count() - 1;
    }
    if (!levels.Add(farthest)) return {};
  }
  return {};
}

}  // namespace Vorn::Fewest
